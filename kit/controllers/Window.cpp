// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/controllers/Window.h"

#include "kit/controllers/ViewController.h"
#include "kit/controllers/WindowHost.h"
#include "kit/values/TransitionCoordinator.h"
#include "kit/views/View.h"

#include <utility>

namespace kit {

namespace {

/// Answers whether a screen hides the one below it altogether.
bool covers(const Presentation& presentation)
{
    return presentation.presented->presentationStyle() == PresentationStyle::FullScreen;
}

} // namespace

Window::Window(const Rect& bounds)
    : _bounds(bounds)
    , _traits(TraitCollection::application())
{
}

Window::~Window() = default;

void Window::setBackground(std::optional<Color> color)
{
    _background = color;
    _observer.notify([this](WindowObserver& observer) { observer.rootDidChange(*this); });
}

InterfaceOrientation Window::interfaceOrientation() const
{
    return _bounds.width > _bounds.height ? InterfaceOrientation::LandscapeLeft
                                          : InterfaceOrientation::Portrait;
}

/// Adds the screen's view to the window. The view fills the window at first, because only a host knows the
/// real size of sheets and alerts.
void Window::attach(ViewController& screen)
{
    const auto& view = screen.view();
    view->setWindow(weak_from_this());
    view->overrideTraits(_traits);
    view->setFrame({0, 0, _bounds.width, _bounds.height});
}

void Window::setRootViewController(std::shared_ptr<ViewController> root)
{
    if (root == _root)
        return;
    _transition.finish();
    const auto before = std::exchange(_root, std::move(root));
    if (_visible) {
        if (before) {
            before->beginAppearance(false, false);
            before->endAppearance();
            before->view()->setWindow({});
        }
        if (_root) {
            attach(*_root);
            _root->beginAppearance(true, false);
            _root->endAppearance();
        }
    }
    _observer.notify([this](WindowObserver& observer) { observer.rootDidChange(*this); });
}

void Window::makeKeyAndVisible()
{
    if (_visible)
        return;
    _visible = true;
    if (_root)
        attach(*_root);
    if (const auto host = WindowHost::current())
        host->showWindow(shared_from_this());
    if (!_root)
        return;
    _root->beginAppearance(true, false);
    _root->endAppearance();
    auto presenting = _root;
    for (const auto& screen : presentedScreens()) {
        if (screen->appearanceState() == AppearanceState::Disappeared)
            show({screen, presenting, false}, {});
        presenting = screen;
    }
}

std::vector<std::shared_ptr<ViewController>> Window::presentedScreens() const
{
    Screens screens;
    for (auto screen = _root ? _root->_presented : nullptr; screen; screen = screen->_presented)
        screens.push_back(screen);
    return screens;
}

void Window::layoutIfNeeded()
{
    if (!_root || !_root->isViewLoaded())
        return;
    _root->view()->layoutIfNeeded();
    for (const auto& screen : presentedScreens()) {
        if (screen->isViewLoaded())
            screen->view()->layoutIfNeeded();
    }
}

void Window::resized(Size size, const TraitCollection& traits)
{
    const auto previous = std::exchange(_traits, traits);
    const bool isOtherSize = size != _bounds.size();
    Screens screens = presentedScreens();
    if (_root)
        screens.insert(screens.begin(), _root);
    TransitionCoordinator coordinator;
    for (const auto& screen : screens) {
        if (isOtherSize && screen->isViewLoaded())
            screen->viewWillTransitionToSizeWithTransitionCoordinator(size, coordinator);
    }
    _bounds = {_bounds.x, _bounds.y, size.width, size.height};
    for (const auto& screen : screens) {
        if (!screen->isViewLoaded() || !_visible)
            continue;
        screen->view()->overrideTraits(_traits);
        if (isOtherSize)
            screen->view()->setFrame({0, 0, size.width, size.height});
        if (previous != _traits)
            screen->tellTraits(previous);
    }
    coordinator.run();
}

void Window::showNotice(const std::string& text, const NoticeAction& action)
{
    if (_visible)
        _observer.notify([&](WindowObserver& observer) { observer.windowShowsNotice(*this, text, action); });
}

bool Window::backRequested()
{
    const auto screens = presentedScreens();
    if (screens.empty())
        return _root && _root->backRequested();
    screens.back()->userCancelled();
    return true;
}

bool Window::undoRequested()
{
    return _root && presentedScreens().empty() && _root->undoRequested();
}

bool Window::takesFiles() const
{
    return _root && presentedScreens().empty() && _root->takesFiles();
}

bool Window::filesOffered(const std::vector<platform::Url>& files)
{
    return takesFiles() && _root->filesOffered(files);
}

void Window::closed()
{
    if (!_visible)
        return;
    _transition.finish();
    _visible = false;
    Screens screens = presentedScreens();
    if (_root)
        screens.insert(screens.begin(), _root);
    for (const auto& screen : screens) {
        screen->beginAppearance(false, false);
        screen->endAppearance();
        screen->view()->setWindow({});
    }
}

void Window::present(const Presentation& presentation, std::function<void()> completion)
{
    if (_visible)
        show(presentation, std::move(completion));
    else if (completion)
        completion();
}

void Window::show(const Presentation& presentation, std::function<void()> completion)
{
    finishTransition();
    attach(*presentation.presented);
    if (covers(presentation))
        presentation.presenting->beginAppearance(false, presentation.animated);
    presentation.presented->beginAppearance(true, presentation.animated);
    const auto token = TransitionToken([presentation, completion = std::move(completion)] {
        if (covers(presentation))
            presentation.presenting->endAppearance();
        presentation.presented->endAppearance();
        if (completion)
            completion();
    });
    _transition = token;
    if (const auto observer = _observer.lock())
        observer->windowWillPresent(*this, presentation, token);
    else
        token.finish();
}

void Window::dismiss(std::vector<Presentation> presentations, std::function<void()> completion)
{
    for (; presentations.size() > 1; presentations.pop_back())
        dismissOne(presentations.back(), {});
    dismissOne(presentations.front(), std::move(completion));
}

void Window::dismissOne(const Presentation& presentation, std::function<void()> completion)
{
    _transition.finish();
    presentation.presented->beginAppearance(false, presentation.animated);
    if (covers(presentation))
        presentation.presenting->beginAppearance(true, presentation.animated);
    const auto token = TransitionToken([presentation, completion = std::move(completion)] {
        presentation.presented->endAppearance();
        if (presentation.presented->isViewLoaded())
            presentation.presented->view()->setWindow({});
        if (covers(presentation))
            presentation.presenting->endAppearance();
        if (completion)
            completion();
    });
    _transition = token;
    if (const auto observer = _observer.lock())
        observer->windowWillDismiss(*this, presentation, token);
    else
        token.finish();
}

} // namespace kit
