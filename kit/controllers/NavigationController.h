// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/NavigationControllerDelegate.h"
#include "kit/controllers/NavigationObserver.h"
#include "kit/controllers/ViewController.h"
#include "kit/values/PlatformNames.h"
#include "platform/Geometry.h"

namespace kit {

/// Says how much of a screen lies under the bars. Both are zero where the host keeps screens between the
/// bars.
struct BarFrames {
    Rect navigationBar, toolbar;
    bool operator==(const BarFrames&) const = default;
};

/// A stack of screens of which the top one is shown, with a navigation bar above and a toolbar below. Every
/// change takes place in the model at once. The appearance callbacks and the delegate's did-show call come at
/// the end of the movement when a host shows one, else at once.
class NavigationController : public ViewController {
public:
    void accept(ViewControllerVisitor& visitor) override;
    void setNavigationObserver(std::weak_ptr<NavigationObserver> observer);
    void setDelegate(std::weak_ptr<NavigationControllerDelegate> delegate)
    {
        _delegate = std::move(delegate);
    }

    const std::vector<std::shared_ptr<ViewController>>& viewControllers() const { return children(); }
    std::shared_ptr<ViewController> topViewController() const; ///< null: empty stack
    /// Answers the topmost presented screen, else the top one.
    std::shared_ptr<ViewController> visibleViewController() const;

    void pushViewController(const std::shared_ptr<ViewController>& screen, bool animated);
    /// Answers the screen that was taken off, or null when only one is left.
    std::shared_ptr<ViewController> popViewController(bool animated);
    std::vector<std::shared_ptr<ViewController>> popToRootViewController(bool animated);
    void setViewControllers(std::vector<std::shared_ptr<ViewController>> screens, bool animated);

    bool isToolbarHidden() const { return _toolbarHidden; } ///< hidden at first
    void setToolbarHidden(bool hidden, bool animated = false);

    const BarFrames& barFrames() const { return _barFrames; }
    bool isTransitioning() const { return !_transition.isFinished(); }
    /// Ends a movement that is still being shown, and calls its callbacks at once.
    void completeTransition() { _transition.finish(); }
    /// Answers whether the back button, a swipe or a key may go back now.
    bool canGoBack() const;

    // Events up: the host reports what the user did.
    /// The user went back by the back button, a swipe or a key. Answers false when there is nothing to go
    /// back to. The host may show the other screen already, as after a swipe; its observer is told all the
    /// same.
    bool userWentBack(bool animated = true);
    /// The host gave a screen's area this size. Without a host a screen fills the controller's view.
    void screenResized(ViewController& screen, Size size);
    void barsResized(const BarFrames& frames);

    bool backRequested() override;

    // Classes that override these call them.
    void viewWillLayoutSubviews() override;
    std::vector<std::shared_ptr<ViewController>> appearingChildren() const override;
    void viewWillAppear(bool animated) override;
    void viewDidAppear(bool animated) override;

private:
    using Screens = std::vector<std::shared_ptr<ViewController>>;

    std::shared_ptr<NavigationController> asNavigationController() override;
    void replaceStack(Screens screens, NavigationKind kind, bool animated);
    void adopt(Screens screens, const std::shared_ptr<ViewController>& leaving);
    void startTransition(const NavigationTransition& transition);
    void endTransition(const NavigationTransition& transition);
    void showTopView();
    bool isShown() const;
    void tellDidShow(const std::shared_ptr<ViewController>& screen, bool animated);

    std::weak_ptr<NavigationControllerDelegate> _delegate;
    ObserverSlot<NavigationObserver> _navigationObserver;
    TransitionToken _transition;
    std::weak_ptr<ViewController> _announced; ///< the last screen that the delegate was told of
    BarFrames _barFrames;
    bool _toolbarHidden = true, _hostSizesScreens = false;
};

} // namespace kit
