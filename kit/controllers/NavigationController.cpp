// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/controllers/NavigationController.h"

#include "kit/controllers/NavigationItem.h"
#include "kit/controllers/ViewControllerVisitor.h"
#include "kit/views/View.h"
#include "platform/Weakly.h"

#include <algorithm>
#include <utility>

namespace kit {

void NavigationController::accept(ViewControllerVisitor& visitor)
{
    visitor.visit(*this);
}

std::shared_ptr<NavigationController> NavigationController::asNavigationController()
{
    return std::static_pointer_cast<NavigationController>(shared_from_this());
}

void NavigationController::setNavigationObserver(std::weak_ptr<NavigationObserver> observer)
{
    _navigationObserver.set(std::move(observer));
}

std::shared_ptr<ViewController> NavigationController::topViewController() const
{
    return children().empty() ? nullptr : children().back();
}

std::shared_ptr<ViewController> NavigationController::visibleViewController() const
{
    auto visible = topViewController();
    for (auto above = presentedViewController(); above; above = above->presentedViewController())
        visible = above;
    return visible;
}

void NavigationController::pushViewController(const std::shared_ptr<ViewController>& screen, bool animated)
{
    _transition.finish();
    auto screens = children();
    if (!screen || std::ranges::find(screens, screen) != screens.end())
        return;
    screens.push_back(screen);
    replaceStack(std::move(screens), NavigationKind::Push, animated);
}

std::shared_ptr<ViewController> NavigationController::popViewController(bool animated)
{
    _transition.finish();
    auto screens = children();
    if (screens.size() < 2)
        return nullptr;
    auto popped = std::move(screens.back());
    screens.pop_back();
    replaceStack(std::move(screens), NavigationKind::Pop, animated);
    return popped;
}

std::vector<std::shared_ptr<ViewController>> NavigationController::popToRootViewController(bool animated)
{
    _transition.finish();
    auto screens = children();
    if (screens.size() < 2)
        return {};
    Screens popped(screens.begin() + 1, screens.end());
    screens.resize(1);
    replaceStack(std::move(screens), NavigationKind::Pop, animated);
    return popped;
}

void NavigationController::setViewControllers(Screens screens, bool animated)
{
    _transition.finish();
    const auto before = children();
    std::erase(screens, nullptr);
    if (screens == before)
        return;
    // When the new top was in the stack before, the movement is one back to it.
    const bool goesBack = !screens.empty() && std::ranges::find(before, screens.back()) != before.end();
    replaceStack(std::move(screens), goesBack ? NavigationKind::Pop : NavigationKind::Replace, animated);
}

/// Changes the children and their parents. A screen that the user sees leaving keeps its parent until the
/// movement ends.
void NavigationController::adopt(Screens screens, const std::shared_ptr<ViewController>& leaving)
{
    const auto before = std::exchange(_children, std::move(screens));
    for (const auto& screen : before) {
        const bool stays = std::ranges::find(_children, screen) != _children.end();
        if (stays || screen == leaving)
            continue;
        screen->_parent.reset();
        screen->didMoveToParentViewController(nullptr);
    }
    for (const auto& screen : _children) {
        if (screen->parent().get() == this)
            continue;
        screen->removeFromParentViewController();
        screen->_parent = weak_from_this();
    }
}

void NavigationController::replaceStack(Screens screens, NavigationKind kind, bool animated)
{
    const auto from = topViewController();
    const auto to = screens.empty() ? nullptr : screens.back();
    if (from == to || !isShown()) {
        adopt(std::move(screens), nullptr);
        if (isViewLoaded())
            showTopView();
        _navigationObserver.notify([this](NavigationObserver& observer) { observer.stackDidChange(*this); });
        return;
    }
    adopt(std::move(screens), from);
    startTransition({kind, from, to, animated});
}

void NavigationController::startTransition(const NavigationTransition& transition)
{
    const auto [kind, from, to, animated] = transition;
    if (from)
        from->beginAppearance(false, animated);
    showTopView();
    if (to)
        to->beginAppearance(true, animated);
    if (const auto delegate = _delegate.lock(); delegate && to)
        delegate->navigationControllerWillShowViewControllerAnimated(*this, to, animated);
    const auto token = TransitionToken(weakly(this, &NavigationController::endTransition, transition));
    _transition = token;
    if (const auto observer = _navigationObserver.lock())
        observer->navigationWillTransition(*this, transition, token);
    else
        token.finish();
}

void NavigationController::endTransition(const NavigationTransition& transition)
{
    const auto [kind, from, to, animated] = transition;
    if (from) {
        from->endAppearance();
        if (from->isViewLoaded() && from != topViewController())
            from->view()->removeFromSuperview();
        if (std::ranges::find(_children, from) == _children.end() && from->parent().get() == this) {
            from->_parent.reset();
            from->didMoveToParentViewController(nullptr);
        }
    }
    if (!to)
        return;
    to->endAppearance();
    to->didMoveToParentViewController(shared_from_this());
    // The screen may have shown another one from within the callback above.
    if (to == topViewController())
        tellDidShow(to, animated);
}

/// Puts the view of the top screen in front. A leaving screen's view is removed at the end of the movement.
void NavigationController::showTopView()
{
    const auto top = topViewController();
    const auto& root = view();
    if (top && top->view()->superview() != root) {
        top->view()->setLayoutBoundary(true);
        if (!_hostSizesScreens)
            top->view()->setFrame({0, 0, root->bounds().width, root->bounds().height});
        root->addSubview(top->view());
    }
    if (isShown())
        return;
    const auto views = root->subviews();
    for (const auto& view : views) {
        if (!top || view != top->view())
            view->removeFromSuperview();
    }
}

bool NavigationController::isShown() const
{
    return appearanceState() == AppearanceState::Appeared || appearanceState() == AppearanceState::Appearing;
}

void NavigationController::tellDidShow(const std::shared_ptr<ViewController>& screen, bool animated)
{
    _announced = screen;
    if (const auto delegate = _delegate.lock())
        delegate->navigationControllerDidShowViewControllerAnimated(*this, screen, animated);
}

void NavigationController::setToolbarHidden(bool hidden, bool animated)
{
    if (hidden == _toolbarHidden)
        return;
    _toolbarHidden = hidden;
    _navigationObserver.notify(
        [&](NavigationObserver& observer) { observer.toolbarVisibilityDidChange(*this, animated); });
}

bool NavigationController::canGoBack() const
{
    return children().size() > 1 && !topViewController()->navigationItem().hidesBackButton();
}

bool NavigationController::userWentBack(bool animated)
{
    return canGoBack() && popViewController(animated) != nullptr;
}

bool NavigationController::backRequested()
{
    const auto top = topViewController();
    return (top && top->backRequested()) || userWentBack();
}

void NavigationController::screenResized(ViewController& screen, Size size)
{
    _hostSizesScreens = true;
    screen.view()->setFrame({0, 0, size.width, size.height});
    screen.view()->layoutIfNeeded();
}

void NavigationController::barsResized(const BarFrames& frames)
{
    if (frames == _barFrames)
        return;
    _barFrames = frames;
    if (const auto top = topViewController(); top && top->isViewLoaded())
        top->view()->setNeedsLayout();
}

void NavigationController::viewWillLayoutSubviews()
{
    ViewController::viewWillLayoutSubviews();
    const auto top = topViewController();
    if (top && top->isViewLoaded() && !_hostSizesScreens)
        top->view()->setFrame({0, 0, view()->bounds().width, view()->bounds().height});
}

std::vector<std::shared_ptr<ViewController>> NavigationController::appearingChildren() const
{
    const auto top = topViewController();
    return top ? Screens{top} : Screens{};
}

void NavigationController::viewWillAppear(bool animated)
{
    ViewController::viewWillAppear(animated);
    showTopView();
    const auto top = topViewController();
    if (top)
        top->beginAppearance(true, animated);
    const auto delegate = _delegate.lock();
    if (top && delegate && _announced.lock() != top)
        delegate->navigationControllerWillShowViewControllerAnimated(*this, top, animated);
}

void NavigationController::viewDidAppear(bool animated)
{
    ViewController::viewDidAppear(animated);
    const auto top = topViewController();
    if (top)
        top->endAppearance();
    if (top && top == topViewController() && _announced.lock() != top && !isTransitioning())
        tellDidShow(top, animated);
}

} // namespace kit
