// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/PeerContext.h"
#include "host/gtk/base/SignalConnection.h"
#include "kit/controllers/BarButtonItem.h"

#include <memory>

namespace host::gtk {

class ViewPeer;

/// Shows one item of a bar that is not a space: as a button, or as the item's own view. Main thread only.
class BarItemPeer : public kit::BarButtonItemObserver, public std::enable_shared_from_this<BarItemPeer> {
public:
    static std::shared_ptr<BarItemPeer> make(
        const std::shared_ptr<PeerContext>& context, const std::shared_ptr<kit::BarButtonItem>& item);
    BarItemPeer(std::shared_ptr<PeerContext> context, const std::shared_ptr<kit::BarButtonItem>& item);
    ~BarItemPeer() override;

    GtkWidget* widget() const { return _widget.get(); }
    std::shared_ptr<kit::BarButtonItem> item() const { return _item.lock(); }

    /// In a narrow bar an item with a compact image shows it in place of its title.
    void setNarrow(bool narrow);

    void barButtonItemDidChange(kit::BarButtonItem& item) override;

private:
    void showCustomView(const std::shared_ptr<kit::View>& view);
    void showButton();
    void mirror(const kit::BarButtonItem& shown);
    void showFace(const kit::BarButtonItem& shown);

    std::shared_ptr<PeerContext> _context;
    std::weak_ptr<kit::BarButtonItem> _item;
    const kit::BarButtonItem* _key;
    ObjectRef<GtkWidget> _widget;
    std::shared_ptr<ViewPeer> _customPeer;
    SignalConnection _onClicked;
    bool _isNarrow = false;
};

/// Places a view of the kit in the toolkit's layout. The place asks for the size that the view wants, at
/// least `minimumHeight` high, and the view gets the size of the place.
std::shared_ptr<ViewPeer> makeEmbeddedPeer(const std::shared_ptr<PeerContext>& context,
    const std::shared_ptr<kit::View>& view, double minimumHeight);

} // namespace host::gtk
