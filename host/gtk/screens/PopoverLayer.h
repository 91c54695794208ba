// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ObjectRef.h"
#include "host/gtk/base/SignalConnection.h"
#include "host/gtk/screens/LayerContent.h"
#include "host/gtk/screens/PresentedLayer.h"

#include <memory>

namespace host::gtk {

/// A layer in a popover that points at a place in the window.
class PopoverLayer : public PresentedLayer {
public:
    /// `parent` is a widget that outlives the layer and can have a popover as its child. `onOutside` is
    /// called when the user leaves the popover. The popover stands on `side` of the anchor.
    PopoverLayer(GtkWidget* parent, const GdkRectangle& anchor, GtkPositionType side,
        std::unique_ptr<LayerContent> content, std::function<void()> onOutside);
    ~PopoverLayer() override;

    void show(bool animated, Done done) override;
    void hide(bool animated, Done done) override;
    void focus() override;
    void setCovered(bool) override { }

private:
    std::unique_ptr<LayerContent> _content;
    ObjectRef<GtkWidget> _popover;
    bool _shown = false;
    SignalConnection _onClosed;
};

} // namespace host::gtk
