// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/controllers/AlertController.h"

#include "kit/controllers/ViewControllerVisitor.h"
#include "kit/views/TextField.h"
#include "platform/Weakly.h"

#include <algorithm>

namespace kit {

AlertController::AlertController(std::string title, std::string message, AlertStyle style)
    : _alertStyle(style)
    , _message(std::move(message))
{
    setTitle(std::move(title));
    setPresentationStyle(
        style == AlertStyle::Alert ? PresentationStyle::OverCurrentContext : PresentationStyle::Popover);
}

void AlertController::accept(ViewControllerVisitor& visitor)
{
    visitor.visit(*this);
}

void AlertController::alertChanged()
{
    _alertObserver.notify([this](AlertObserver& observer) { observer.alertDidChange(*this); });
}

void AlertController::addAction(const std::shared_ptr<AlertAction>& action)
{
    _actions.push_back(action);
    action->setOnChange(weakly(this, &AlertController::alertChanged));
    alertChanged();
}

void AlertController::setPreferredAction(std::shared_ptr<AlertAction> action)
{
    _preferredAction = std::move(action);
    alertChanged();
}

std::shared_ptr<AlertAction> AlertController::escapeAction() const
{
    if (_escapeAction)
        return _escapeAction;
    const auto cancel = std::ranges::find_if(
        _actions, [](const auto& action) { return action->style() == AlertActionStyle::Cancel; });
    if (cancel != _actions.end())
        return *cancel;
    return _actions.size() == 1 ? _actions.front() : nullptr;
}

void AlertController::setEscapeAction(std::shared_ptr<AlertAction> action)
{
    _escapeAction = std::move(action);
    alertChanged();
}

void AlertController::addTextField(const std::function<void(TextField&)>& configure)
{
    const auto field = std::make_shared<TextField>();
    _textFields.push_back(field);
    if (isViewLoaded())
        view()->addSubview(field);
    if (configure)
        configure(*field);
    alertChanged();
}

void AlertController::setContentViewController(const std::shared_ptr<ViewController>& content)
{
    if (content == _content)
        return;
    if (_content) {
        if (_content->isViewLoaded())
            _content->view()->removeFromSuperview();
        _content->removeFromParentViewController();
    }
    _content = content;
    if (content) {
        addChildViewController(content);
        if (isViewLoaded())
            view()->addSubview(content->view());
        content->didMoveToParentViewController(shared_from_this());
    }
    alertChanged();
}

void AlertController::loadView()
{
    ViewController::loadView();
    if (_content) {
        _content->view()->setLayoutBoundary(true);
        view()->addSubview(_content->view());
    }
    for (const auto& field : _textFields)
        view()->addSubview(field);
}

void AlertController::viewDidAppear(bool animated)
{
    ViewController::viewDidAppear(animated);
    if (!_textFields.empty())
        _textFields.front()->becomeFirstResponder();
}

bool AlertController::press(std::size_t actionIndex)
{
    return actionIndex < _actions.size() && press(_actions[actionIndex]);
}

bool AlertController::press(const std::shared_ptr<AlertAction>& pressed)
{
    // The functions that are asked here belong to the caller and may release the alert.
    const auto self = std::static_pointer_cast<AlertController>(shared_from_this());
    // NOLINTNEXTLINE(performance-unnecessary-copy-initialization): the alert may own what is referred to
    const auto action = pressed;
    const bool isKnown = std::ranges::find(_actions, action) != _actions.end();
    if (!isKnown || !action->isEnabled() || _isClosing || !action->mayClose())
        return false;
    if (!presentingViewController()) {
        action->run();
        return true;
    }
    _isClosing = true;
    dismissViewController(true, [self, action] {
        self->_isClosing = false;
        action->run();
    });
    return true;
}

void AlertController::userCancelled()
{
    if (const auto action = escapeAction())
        press(action);
}

} // namespace kit
