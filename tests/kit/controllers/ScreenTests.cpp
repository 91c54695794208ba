// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/controllers/AlertController.h"
#include "kit/controllers/InterfaceState.h"
#include "kit/controllers/NavigationController.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/controllers/SearchPresentation.h"
#include "kit/controllers/Window.h"
#include "kit/views/View.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace kit {

namespace {

using Events = std::vector<std::string>;

/// Records the callbacks that it gets.
class Screen : public ViewController {
public:
    Screen(std::string name, Events& events)
        : _name(std::move(name))
        , _events(events)
    {
        setTitle(_name);
    }
    void viewDidLoad() override { note("load"); }
    void viewWillAppear(bool) override { note("will appear"); }
    void viewDidAppear(bool) override { note("did appear"); }
    void viewWillDisappear(bool) override { note(navigationController() ? "will go" : "will go, orphaned"); }
    void viewDidDisappear(bool) override { note("did go"); }
    void didMoveToParentViewController(const std::shared_ptr<ViewController>& parent) override
    {
        if (!parent)
            note("left");
    }
    void viewWillLayoutSubviews() override { note("layout"); }

private:
    void note(const std::string& what) { _events.push_back(_name + " " + what); }

    std::string _name;
    Events& _events;
};

class ShownScreens : public NavigationControllerDelegate {
public:
    explicit ShownScreens(Events& events)
        : _events(events)
    {
    }
    void navigationControllerWillShowViewControllerAnimated(
        NavigationController&, const std::shared_ptr<ViewController>& screen, bool) override
    {
        _events.push_back("will show " + screen->title());
    }
    void navigationControllerDidShowViewControllerAnimated(
        NavigationController&, const std::shared_ptr<ViewController>& screen, bool) override
    {
        _events.push_back("did show " + screen->title());
    }

private:
    Events& _events;
};

/// A host whose movements last until the test ends them.
class SlowHost : public NavigationObserver, public WindowObserver {
public:
    void navigationWillTransition(
        NavigationController&, const NavigationTransition& transition, TransitionToken token) override
    {
        kinds.push_back(transition.kind);
        tokens.push_back(std::move(token));
    }
    void stackDidChange(NavigationController&) override { ++stackChanges; }
    void toolbarVisibilityDidChange(NavigationController&, bool) override { }
    void rootDidChange(Window&) override { }
    void windowWillPresent(Window&, const Presentation&, TransitionToken token) override
    {
        tokens.push_back(std::move(token));
    }
    void windowWillDismiss(Window&, const Presentation&, TransitionToken token) override
    {
        tokens.push_back(std::move(token));
    }

    std::vector<NavigationKind> kinds;
    std::vector<TransitionToken> tokens;
    int stackChanges = 0;
};

class Screens : public testing::Test {
protected:
    std::shared_ptr<Screen> screen(const std::string& name) { return std::make_shared<Screen>(name, events); }

    void show()
    {
        navigation->setDelegate(delegate);
        window->setRootViewController(navigation);
        window->makeKeyAndVisible();
    }
    Events take() { return std::exchange(events, {}); }
    /// Makes an alert that records its answer.
    std::shared_ptr<AlertController> question()
    {
        const auto alert = std::make_shared<AlertController>("Title", "Message", AlertStyle::Alert);
        const auto note = [this](const auto& action) { events.push_back(action->title()); };
        alert->addAction(std::make_shared<AlertAction>("Cancel", AlertActionStyle::Cancel, note));
        alert->addAction(std::make_shared<AlertAction>("Create", AlertActionStyle::Default, note));
        return alert;
    }

    Events events;
    std::shared_ptr<ShownScreens> delegate = std::make_shared<ShownScreens>(events);
    std::shared_ptr<NavigationController> navigation = std::make_shared<NavigationController>();
    std::shared_ptr<Window> window = std::make_shared<Window>(Rect{0, 0, 360, 640});
};

} // namespace

TEST_F(Screens, AppearInOrderWhileTheStackChanges)
{
    const auto a = screen("a"), b = screen("b"), c = screen("c");
    navigation->setViewControllers({a}, false);
    EXPECT_TRUE(take().empty());
    show();
    EXPECT_EQ(take(), (Events{"a load", "a will appear", "will show a", "a did appear", "did show a"}));

    navigation->pushViewController(b, true);
    EXPECT_EQ(take(),
        (Events{"a will go", "b load", "b will appear", "will show b", "a did go", "b did appear",
            "did show b"}));
    EXPECT_TRUE(b->isVisible());
    EXPECT_FALSE(a->isVisible());

    navigation->setViewControllers({a, c, b}, true);
    EXPECT_TRUE(take().empty());

    EXPECT_EQ(navigation->popToRootViewController(true).size(), 2);
    EXPECT_EQ(take(),
        (Events{"c left", "b will go", "a will appear", "will show a", "b did go", "b left", "a did appear",
            "did show a"}));
    EXPECT_EQ(navigation->popViewController(true), nullptr);
    EXPECT_EQ(b->navigationController(), nullptr);

    window->closed();
    EXPECT_EQ(take(), (Events{"a will go", "a did go"}));
}

TEST_F(Screens, WaitForTheMovementOfAHost)
{
    const auto a = screen("a"), b = screen("b"), c = screen("c");
    const auto host = std::make_shared<SlowHost>();
    navigation->setNavigationObserver(host);
    navigation->setViewControllers({a}, false);
    EXPECT_EQ(host->stackChanges, 1);
    show();
    take();
    navigation->pushViewController(b, true);
    EXPECT_EQ(take(), (Events{"a will go", "b load", "b will appear", "will show b"}));
    EXPECT_EQ(navigation->topViewController(), b);
    EXPECT_TRUE(navigation->isTransitioning());

    // The next change first ends the movement of the change before.
    navigation->setViewControllers({c}, true);
    EXPECT_EQ(take(),
        (Events{"a did go", "b did appear", "did show b", "a left", "b will go", "c load", "c will appear",
            "will show c"}));
    host->tokens.front().finish();
    EXPECT_TRUE(take().empty());

    // When a host goes away, no callback is lost.
    host->tokens.clear();
    navigation->setNavigationObserver({});
    navigation->pushViewController(a, true);
    const auto after = take();
    EXPECT_EQ(after.front(), "b did go");
    EXPECT_EQ(after.back(), "did show a");
    EXPECT_EQ(host->kinds, (std::vector{NavigationKind::Push, NavigationKind::Replace}));
}

namespace {

/// Sets up its stack while its view is being loaded.
struct SelfMade : NavigationController {
    void viewDidLoad() override
    {
        setViewControllers({first}, false);
        NavigationController::viewDidLoad();
    }
    std::shared_ptr<ViewController> first;
};

} // namespace

TEST_F(Screens, OfAStackMadeWhileLoadingAppearOnce)
{
    const auto selfMade = std::make_shared<SelfMade>();
    selfMade->first = screen("a");
    navigation = selfMade;
    show();
    window->layoutIfNeeded();
    EXPECT_EQ(
        take(), (Events{"a load", "a will appear", "will show a", "a did appear", "did show a", "a layout"}));
    EXPECT_EQ(navigation->topViewController()->view()->frame(), (Rect{0, 0, 360, 640}));
}

TEST_F(Screens, GoBackWhereTheBarAllowsIt)
{
    const auto a = screen("a"), b = screen("b");
    navigation->setViewControllers({a, b}, false);
    show();
    b->navigationItem().setHidesBackButton(true);
    EXPECT_FALSE(window->backRequested());
    bool cancelled = false;
    b->navigationItem().setRightItem(
        std::make_shared<BarButtonItem>(SystemItem::Cancel, [&](const auto&) { cancelled = true; }));
    EXPECT_TRUE(window->backRequested());
    EXPECT_TRUE(cancelled);
    b->navigationItem().setRightItems({});
    b->navigationItem().setHidesBackButton(false);
    EXPECT_TRUE(window->backRequested());
    EXPECT_EQ(navigation->topViewController(), a);
    EXPECT_FALSE(window->backRequested());
}

TEST_F(Screens, LieOverEachOtherAndGoTogether)
{
    const auto list = screen("list");
    navigation->setViewControllers({list}, false);
    show();
    take();
    const auto search = std::make_shared<SearchPresentation>();
    const auto sheet = screen("sheet"), full = screen("full");
    sheet->setPresentationStyle(PresentationStyle::OverCurrentContext);
    list->presentViewController(search, true);
    EXPECT_EQ(navigation->presentedViewController(), search);
    navigation->presentViewController(sheet, true);
    EXPECT_EQ(sheet->presentingViewController(), search);
    EXPECT_EQ(navigation->visibleViewController(), sheet);
    EXPECT_EQ(take(), (Events{"sheet load", "sheet will appear", "sheet did appear"}));
    sheet->presentViewController(full, false);
    EXPECT_EQ(take(),
        (Events{
            "full load", "sheet will go, orphaned", "full will appear", "sheet did go", "full did appear"}));
    bool done = false;
    navigation->dismissViewController(true, [&] { done = true; });
    EXPECT_TRUE(done);
    EXPECT_EQ(window->presentedScreens().size(), 0);
    const auto left = take();
    EXPECT_EQ(std::ranges::count(left, "full did go"), 1);
    EXPECT_EQ(left.back(), "sheet did go");
    EXPECT_FALSE(full->isVisible());

    done = false;
    navigation->dismissViewController(true, [&] { done = true; });
    EXPECT_TRUE(done);
}

TEST_F(Screens, OnlyAFullScreenHidesTheOneBelow)
{
    navigation->setViewControllers({screen("list")}, false);
    show();
    const auto full = screen("full");
    take();
    navigation->presentViewController(full, true);
    EXPECT_EQ(
        take(), (Events{"full load", "list will go", "full will appear", "list did go", "full did appear"}));
    window->backRequested();
    EXPECT_EQ(
        take(), (Events{"full will go, orphaned", "list will appear", "full did go", "list did appear"}));
}

TEST_F(Screens, AnAlertAnswersOnceAfterItHasGone)
{
    const auto host = std::make_shared<SlowHost>();
    navigation->setViewControllers({screen("list")}, false);
    show();
    window->setObserver(host);
    take();
    const auto first = question(), next = question();
    navigation->presentViewController(first, true);
    host->tokens.back().finish();
    first->userCancelled();
    EXPECT_FALSE(first->press(1));
    EXPECT_TRUE(take().empty());

    // Presenting the next alert first delivers what the first one left pending.
    navigation->presentViewController(next, true);
    EXPECT_EQ(take(), Events{"Cancel"});
    EXPECT_EQ(navigation->presentedViewController(), next);
    host->tokens[1].finish();
    EXPECT_TRUE(take().empty());
}

namespace {

class Remembering : public ViewController {
public:
    explicit Remembering(std::string identifier) { setRestorationIdentifier(std::move(identifier)); }
    void encodeRestorableStateWithCoder(StateCoder& coder) override { coder.encode("value", value); }
    void decodeRestorableStateWithCoder(const StateCoder& coder) override
    {
        if (const auto* kept = coder.decode("value"))
            value = static_cast<int>(kept->asInteger().value_or(-1));
        addChildViewController(std::make_shared<ViewController>());
    }
    int value = 0;
};

} // namespace

TEST_F(Screens, KeepTheirStateByIdentifier)
{
    const auto root = std::make_shared<Remembering>("Root"), child = std::make_shared<Remembering>("Child"),
               nameless = std::make_shared<Remembering>("");
    root->addChildViewController(nameless);
    nameless->addChildViewController(child);
    root->value = 1;
    child->value = 2;
    nameless->value = 3;
    const auto state = encodeInterfaceState(*root);
    EXPECT_EQ(state.size(), 2);
    root->value = child->value = nameless->value = 0;
    decodeInterfaceState(*root, state);
    EXPECT_EQ(root->value, 1);
    EXPECT_EQ(child->value, 2);
    EXPECT_EQ(nameless->value, 0);
}

} // namespace kit
