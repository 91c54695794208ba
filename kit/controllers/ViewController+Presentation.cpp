// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/controllers/ViewController.h"

#include "kit/controllers/Window.h"
#include "platform/Log.h"

#include <utility>

namespace kit {

/// Answers the outermost screen around this one, because a presented screen lies over all of it.
std::shared_ptr<ViewController> ViewController::presentationRoot() const
{
    auto root = std::const_pointer_cast<ViewController>(shared_from_this());
    while (auto above = root->parent())
        root = std::move(above);
    return root;
}

/// Ends a movement that is still being shown, because its callbacks have to run before the model changes
/// again.
void ViewController::finishTransition() const
{
    const auto root = presentationRoot();
    if (const auto window = root->window())
        window->finishTransition();
}

void ViewController::presentViewController(
    const std::shared_ptr<ViewController>& presented, bool animated, std::function<void()> completion)
{
    static constexpr Operation op{"-[ViewController presentViewController:animated:completion:]"};
    if (!presented || presented->_presenting.lock() || presented->parent()) {
        op.warning("A screen that is shown already cannot be presented");
        return;
    }
    finishTransition();
    auto presenting = presentationRoot();
    while (presenting->_presented)
        presenting = presenting->_presented;
    if (presenting == presented)
        return;
    presenting->_presented = presented;
    presented->_presenting = presenting;
    if (const auto window = presenting->window())
        window->present({presented, presenting, animated}, std::move(completion));
    else if (completion)
        completion();
}

void ViewController::dismissViewController(bool animated, std::function<void()> completion)
{
    finishTransition();
    auto presenting = presentationRoot();
    if (!presenting->_presented)
        presenting = presenting->_presenting.lock();
    if (!presenting) {
        if (completion)
            completion();
        return;
    }
    const auto window = presenting->window();
    std::vector<Presentation> dismissed;
    for (auto below = presenting; below && below->_presented;) {
        auto above = std::exchange(below->_presented, nullptr);
        above->_presenting.reset();
        dismissed.push_back({above, below, animated});
        below = std::move(above);
    }
    if (window)
        window->dismiss(std::move(dismissed), std::move(completion));
    else if (completion)
        completion();
}

std::shared_ptr<ViewController> ViewController::presentedViewController() const
{
    return presentationRoot()->_presented;
}

std::shared_ptr<ViewController> ViewController::presentingViewController() const
{
    return presentationRoot()->_presenting.lock();
}

void ViewController::userCancelled()
{
    dismissViewController(true);
}

} // namespace kit
