// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ObjectRef.h"
#include "host/gtk/base/SignalConnection.h"
#include "host/gtk/screens/LayerContent.h"
#include "host/gtk/screens/PresentedLayer.h"

#include <adwaita.h>

#include <memory>

namespace host::gtk {

/// The place of a layer's content in the window.
enum class LayerPlace {
    Center, ///< a card as large as its content
    Bottom, ///< a card along the lower edge
    Sheet, ///< a large card
    Cover, ///< the whole window
};

/// A layer within the window itself. The content below is dimmed and takes no input. It is not a window of
/// its own, because an alert must be able to refuse to close, which not every display server lets a window
/// do.
class OverlayLayer : public PresentedLayer {
public:
    /// `onOutside` is called when the user taps beside the content.
    OverlayLayer(GtkOverlay* overlay, std::unique_ptr<LayerContent> content, LayerPlace place,
        std::function<void()> onOutside);
    ~OverlayLayer() override;

    void show(bool animated, Done done) override;
    void hide(bool animated, Done done) override;
    void focus() override;
    void setCovered(bool covered) override;

private:
    void place(LayerPlace place);
    void connectOutside(std::function<void()> onOutside);
    void fadeTo(double opacity, bool animated, Done done);

    ObjectRef<GtkOverlay> _overlay;
    std::unique_ptr<LayerContent> _content;
    ObjectRef<GtkWidget> _backdrop;
    GtkWidget* _card = nullptr;
    ObjectRef<AdwAnimation> _fade;
    Done _done;
    SignalConnection _onFaded, _onPressed;
};

} // namespace host::gtk
