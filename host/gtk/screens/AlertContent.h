// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ObjectRef.h"
#include "host/gtk/base/PeerContext.h"
#include "host/gtk/screens/LayerContent.h"
#include "kit/controllers/AlertController.h"

#include <memory>
#include <vector>

namespace host::gtk {

class TextFieldPeer;
class ViewPeer;

/// The card of an alert or an action sheet: texts, fields, content and buttons.
class AlertContent : public LayerContent {
public:
    AlertContent(std::shared_ptr<PeerContext> context, std::shared_ptr<kit::AlertController> alert);
    ~AlertContent() override;

    GtkWidget* widget() const override { return _card.get(); }
    void focus() override;

private:
    class Observer;
    using Alert = kit::AlertController;
    void buildBody();
    void addFields(const Alert& alert);
    void addContentView(const Alert& alert);
    void rebuildButtons(const Alert& alert);
    GtkWidget* makeActionButton(const std::shared_ptr<kit::AlertAction>& action, const Alert& alert);
    void mirror();
    void returnPressed();

    std::shared_ptr<PeerContext> _context;
    std::weak_ptr<Alert> _alert;
    ObjectRef<GtkWidget> _card;
    GtkWidget *_lines, *_body, *_title, *_message, *_buttonBox = nullptr;
    std::vector<GtkWidget*> _buttons; ///< in the order of the alert's actions
    std::vector<std::shared_ptr<ViewPeer>> _peers;
    std::shared_ptr<Observer> _observer;
    SignalConnections _connections;
};

} // namespace host::gtk
