// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/PeerContext.h"
#include "host/gtk/screens/LayerContent.h"
#include "host/gtk/screens/ScreenPeer.h"
#include "kit/controllers/SearchPresentation.h"

#include <memory>

namespace host::gtk {

/// A search field in a bar of its own, with the results below.
class SearchContent : public LayerContent {
public:
    SearchContent(
        const std::shared_ptr<PeerContext>& context, const std::shared_ptr<kit::SearchPresentation>& search);
    ~SearchContent() override;

    GtkWidget* widget() const override { return _box.get(); }
    void focus() override;

private:
    class Observer;
    void connectKeys();
    void buildBar(const kit::SearchPresentation& search);

    std::weak_ptr<kit::SearchPresentation> _search;
    ObjectRef<GtkWidget> _box;
    GtkWidget *_entry, *_cancel;
    std::shared_ptr<ScreenPeer> _results;
    std::shared_ptr<Observer> _observer;
    SignalConnection _onEdited;
    SignalConnections _connections;
};

} // namespace host::gtk
