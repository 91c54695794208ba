// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/controllers/ViewController.h"

#include "kit/controllers/NavigationController.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/controllers/ViewControllerVisitor.h"
#include "kit/controllers/Window.h"
#include "kit/values/TransitionCoordinator.h"
#include "kit/views/View.h"

#include <algorithm>

namespace kit {

ViewController::ViewController()
    : _navigationItem(std::make_unique<NavigationItem>([this] { barsChanged(); }))
{
}

ViewController::~ViewController() = default;

void ViewController::accept(ViewControllerVisitor& visitor)
{
    visitor.visit(*this);
}

const std::shared_ptr<View>& ViewController::view()
{
    if (!_view && !_isLoading) {
        _isLoading = true;
        loadView();
        if (!_view)
            setView(std::make_shared<View>());
        _isLoading = false;
        viewDidLoad();
    }
    return _view;
}

void ViewController::setView(std::shared_ptr<View> view)
{
    _view = std::move(view);
    if (_view)
        _view->setOwner(weak_from_this());
}

void ViewController::loadView()
{
    setView(std::make_shared<View>());
}

void ViewController::viewWillTransitionToSizeWithTransitionCoordinator(
    Size size, TransitionCoordinator& coordinator)
{
    const auto children = _children;
    for (const auto& child : children)
        child->viewWillTransitionToSizeWithTransitionCoordinator(size, coordinator);
}

bool ViewController::isVisible() const
{
    return window() != nullptr;
}

std::shared_ptr<Window> ViewController::window() const
{
    return _view ? _view->window() : nullptr;
}

const TraitCollection& ViewController::traits() const
{
    if (_view)
        return _view->traits();
    const auto above = parent();
    return above ? above->traits() : TraitCollection::application();
}

void ViewController::tellTraits(const TraitCollection& previous)
{
    traitsDidChange(previous);
    const auto children = _children;
    for (const auto& child : children)
        child->tellTraits(previous);
}

void ViewController::barsChanged()
{
    _observer.notify([this](ViewControllerObserver& observer) { observer.barsDidChange(*this); });
}

void ViewController::setTitle(std::string title)
{
    if (title == _title && title == _navigationItem->title())
        return;
    _title = title;
    _navigationItem->setTitle(std::move(title));
    barsChanged();
}

void ViewController::setToolbarItems(BarButtonItems items)
{
    if (items == _toolbarItems)
        return;
    _toolbarItems = std::move(items);
    barsChanged();
}

void ViewController::addChildViewController(const std::shared_ptr<ViewController>& child)
{
    if (!child || child->parent().get() == this)
        return;
    child->removeFromParentViewController();
    child->_parent = weak_from_this();
    _children.push_back(child);
}

void ViewController::removeFromParentViewController()
{
    const auto above = parent();
    if (!above)
        return;
    const auto self = shared_from_this();
    std::erase(above->_children, self);
    _parent.reset();
    didMoveToParentViewController(nullptr);
}

std::shared_ptr<NavigationController> ViewController::navigationController() const
{
    for (auto above = parent(); above; above = above->parent()) {
        if (auto navigation = above->asNavigationController())
            return navigation;
    }
    return nullptr;
}

void ViewController::beginAppearance(bool appearing, bool animated)
{
    const bool isUnderWay = appearing
        ? _appearance == AppearanceState::Appeared || _appearance == AppearanceState::Appearing
        : _appearance == AppearanceState::Disappeared || _appearance == AppearanceState::Disappearing;
    if (isUnderWay)
        return;
    // The view is loaded first, so that a screen is not marked as appearing while it is being loaded.
    view();
    _appearance = appearing ? AppearanceState::Appearing : AppearanceState::Disappearing;
    _animatedAppearance = animated;
    if (appearing) {
        viewWillAppear(animated);
    } else {
        viewWillDisappear(animated);
        _view->endEditing();
    }
    for (const auto& child : appearingChildren())
        child->beginAppearance(appearing, animated);
}

void ViewController::endAppearance()
{
    if (_appearance == AppearanceState::Appearing) {
        _appearance = AppearanceState::Appeared;
        viewDidAppear(_animatedAppearance);
    } else if (_appearance == AppearanceState::Disappearing) {
        _appearance = AppearanceState::Disappeared;
        viewDidDisappear(_animatedAppearance);
    }
    for (const auto& child : appearingChildren())
        child->endAppearance();
}

bool ViewController::backRequested()
{
    for (const auto* items : {&_navigationItem->leftItems(), &_navigationItem->rightItems()}) {
        for (const auto& item : *items) {
            if (item->systemItem() == SystemItem::Cancel) {
                const auto keepAlive = item;
                return keepAlive->press();
            }
        }
    }
    return false;
}

} // namespace kit
