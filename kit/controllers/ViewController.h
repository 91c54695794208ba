// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/BarButtonItem.h"
#include "kit/controllers/PopoverAnchor.h"
#include "kit/controllers/Presentation.h"
#include "kit/controllers/ViewControllerObserver.h"
#include "kit/values/ObserverSlot.h"
#include "kit/values/PlatformNames.h"
#include "kit/values/TraitCollection.h"
#include "kit/views/ViewOwner.h"
#include "platform/Geometry.h"
#include "platform/StateCoder.h"

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace kit {

class NavigationController;
class NavigationItem;
class TransitionCoordinator;
class View;
class ViewControllerVisitor;
class Window;

enum class AppearanceState { Disappeared, Appearing, Appeared, Disappearing };

/// One screen: a view that is made on first demand, the bars around it, and the screens that it contains or
/// presents. Made with std::make_shared. Main thread only.
class ViewController : public ViewOwner, public std::enable_shared_from_this<ViewController> {
public:
    ViewController();
    ~ViewController() override;
    ViewController(const ViewController&) = delete;
    ViewController& operator=(const ViewController&) = delete;

    virtual void accept(ViewControllerVisitor& visitor);
    void setObserver(std::weak_ptr<ViewControllerObserver> observer) { _observer.set(std::move(observer)); }

    /// Loads the view when it is not loaded yet.
    const std::shared_ptr<View>& view();
    bool isViewLoaded() const { return _view != nullptr; }
    void setView(std::shared_ptr<View> view);
    virtual void loadView(); ///< the default makes an empty view
    virtual void viewDidLoad() { }

    // These are called once for each appearance, in this order. A disappearance may begin before the
    // appearance has ended.
    virtual void viewWillAppear(bool /*animated*/) { }
    virtual void viewDidAppear(bool /*animated*/) { }
    virtual void viewWillDisappear(bool /*animated*/) { }
    virtual void viewDidDisappear(bool /*animated*/) { }
    /// The view is about to get this size. Overriders call the base class, which tells the contained screens.
    virtual void viewWillTransitionToSizeWithTransitionCoordinator(
        Size size, TransitionCoordinator& coordinator);
    virtual void traitsDidChange(const TraitCollection& /*previous*/) { }

    AppearanceState appearanceState() const { return _appearance; }
    bool isVisible() const; ///< loaded, and in a window
    std::shared_ptr<Window> window() const;
    const TraitCollection& traits() const;

    const std::string& title() const { return _title; }
    void setTitle(std::string title); ///< the navigation item's title as well
    NavigationItem& navigationItem() { return *_navigationItem; }
    const BarButtonItems& toolbarItems() const { return _toolbarItems; }
    void setToolbarItems(BarButtonItems items);

    // A container adds the child first, then the child's view, then tells the child.
    std::shared_ptr<ViewController> parent() const { return _parent.lock(); }
    const std::vector<std::shared_ptr<ViewController>>& children() const { return _children; }
    void addChildViewController(const std::shared_ptr<ViewController>& child);
    void removeFromParentViewController();
    virtual void didMoveToParentViewController(const std::shared_ptr<ViewController>& /*parent*/) { }
    std::shared_ptr<NavigationController>
    navigationController() const; ///< the nearest one around this screen

    /// Shows a screen over this one and over everything that it presents already. The completion runs once,
    /// when the screen is in place.
    void presentViewController(const std::shared_ptr<ViewController>& presented, bool animated,
        std::function<void()> completion = {});
    /// Dismisses every screen that this screen presents. When it presents none, it dismisses itself if it is
    /// presented. The completion runs once at the end, also when there was nothing to dismiss.
    void dismissViewController(bool animated, std::function<void()> completion = {});
    /// Answers the screen that is presented by this one or by a screen that contains it, or null.
    std::shared_ptr<ViewController> presentedViewController() const;
    std::shared_ptr<ViewController> presentingViewController() const;
    PresentationStyle presentationStyle() const { return _presentationStyle; }
    void setPresentationStyle(PresentationStyle style) { _presentationStyle = style; }
    const PopoverAnchor& popoverAnchor() const { return _popoverAnchor; }
    void setPopoverAnchor(PopoverAnchor anchor) { _popoverAnchor = std::move(anchor); }
    /// Event up: the user asks to leave this presented screen by Escape or by a tap beside it. The default
    /// dismisses it.
    virtual void userCancelled();
    /// Event up: the user asks to go back within this screen. The default presses the Cancel button of the
    /// navigation bar. Answers false when there is nothing to go back to.
    virtual bool backRequested();
    /// Event up: the user asks by Ctrl+Z to undo the latest change, while no text has the keyboard focus.
    /// Answers false when there is nothing to undo, as by default.
    virtual bool undoRequested() { return false; }
    /// Answers whether files of other programs may be dropped or pasted here; not by default.
    virtual bool takesFiles() const { return false; }
    /// Event up: the user drops or pastes files and folders, which lie anywhere on this machine. Answers
    /// false when they are not taken.
    virtual bool filesOffered(const std::vector<platform::Url>& /*files*/) { return false; }

    const std::string& restorationIdentifier() const
    {
        return _restorationIdentifier;
    } ///< empty: not restored
    void setRestorationIdentifier(std::string identifier) { _restorationIdentifier = std::move(identifier); }
    virtual void encodeRestorableStateWithCoder(StateCoder&) { }
    virtual void decodeRestorableStateWithCoder(const StateCoder&) { }

    // Containers and windows call these when an appearance begins and ends.
    void beginAppearance(bool appearing, bool animated);
    void endAppearance();
    /// Answers the contained screens that appear along with this one.
    virtual std::vector<std::shared_ptr<ViewController>> appearingChildren() const { return _children; }

protected:
    void barsChanged();

private:
    friend class NavigationController;
    friend class Window;

    virtual std::shared_ptr<NavigationController> asNavigationController() { return nullptr; }
    std::shared_ptr<ViewController> presentationRoot() const;
    void finishTransition() const;
    void tellTraits(const TraitCollection& previous);

    std::shared_ptr<View> _view;
    std::string _title, _restorationIdentifier;
    std::unique_ptr<NavigationItem> _navigationItem;
    BarButtonItems _toolbarItems;
    std::weak_ptr<ViewController> _parent, _presenting;
    std::vector<std::shared_ptr<ViewController>> _children;
    std::shared_ptr<ViewController> _presented;
    PresentationStyle _presentationStyle = PresentationStyle::FullScreen;
    PopoverAnchor _popoverAnchor;
    AppearanceState _appearance = AppearanceState::Disappeared;
    bool _animatedAppearance = false, _isLoading = false;
    ObserverSlot<ViewControllerObserver> _observer;
};

} // namespace kit
