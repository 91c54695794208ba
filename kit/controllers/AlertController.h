// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/AlertAction.h"
#include "kit/controllers/ViewController.h"

namespace kit {

class AlertController;
class TextField;

/// An Alert stands in the centre of the window. An ActionSheet stands at its bottom, or is a popover where
/// there is room.
enum class AlertStyle { ActionSheet, Alert };

/// Calls down: the texts, the actions or the fields of the alert have changed.
class AlertObserver {
public:
    virtual ~AlertObserver() = default;
    virtual void alertDidChange(AlertController& alert) = 0;
};

/// A question or a message with buttons.
class AlertController : public ViewController {
public:
    AlertController(std::string title, std::string message, AlertStyle style);

    void accept(ViewControllerVisitor& visitor) override;
    void setAlertObserver(std::weak_ptr<AlertObserver> observer) { _alertObserver.set(std::move(observer)); }

    AlertStyle alertStyle() const { return _alertStyle; }
    const std::string& message() const { return _message; }

    const std::vector<std::shared_ptr<AlertAction>>& actions() const { return _actions; }
    void addAction(const std::shared_ptr<AlertAction>& action);
    /// Answers the action that the return key presses, or null when it presses none.
    std::shared_ptr<AlertAction> preferredAction() const { return _preferredAction; }
    void setPreferredAction(std::shared_ptr<AlertAction> action);
    /// Answers the action that Escape and a tap beside the alert press: the one that was set, else the action
    /// in the cancel style, else the only action, else null.
    std::shared_ptr<AlertAction> escapeAction() const;
    void setEscapeAction(std::shared_ptr<AlertAction> action);

    const std::vector<std::shared_ptr<TextField>>& textFields() const { return _textFields; }
    /// `configure` is called at once with the new field.
    void addTextField(const std::function<void(TextField&)>& configure);
    /// The view of this screen is shown between the message and the fields. It takes no room while it is
    /// hidden.
    std::shared_ptr<ViewController> contentViewController() const { return _content; }
    void setContentViewController(const std::shared_ptr<ViewController>& content);

    // Events up: the host reports what the user did.
    /// The user pressed an action. Answers false when the action is disabled, is not one of this alert's, or
    /// refused to close.
    bool press(std::size_t actionIndex);
    bool press(const std::shared_ptr<AlertAction>& pressed);
    /// The user pressed Escape or tapped beside the alert.
    void userCancelled() override;

    void loadView() override;
    void viewDidAppear(bool animated) override; ///< the first field takes the focus

private:
    void alertChanged();

    AlertStyle _alertStyle;
    std::string _message;
    std::vector<std::shared_ptr<AlertAction>> _actions;
    std::shared_ptr<AlertAction> _preferredAction, _escapeAction;
    std::vector<std::shared_ptr<TextField>> _textFields;
    std::shared_ptr<ViewController> _content;
    ObserverSlot<AlertObserver> _alertObserver;
    bool _isClosing = false;
};

} // namespace kit
