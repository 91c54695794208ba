// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "preview/PreviewBaseViewController.h"

#include "items/DRItem.h"
#include "items/LaunchUtils.h"
#include "kit/controllers/NavigationController.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/controllers/Window.h"
#include "kit/layout/VisualFormat.h"
#include "kit/values/Screen.h"
#include "kit/views/Button.h"
#include "kit/views/ScrollView.h"
#include "platform/Log.h"
#include "platform/Weakly.h"
#include "preview/PreviewItemManager.h"
#include "prompts/UIUtils.h"
#include "screens/DocumentInteractionSheet.h"

#include <algorithm>

namespace tarrow {

using kit::BarButtonItem;
using kit::InterfaceOrientation;
using kit::LayoutConstraint;
using kit::SizeClass;
using kit::SystemItem;
using kit::View;
using platform::Operation;
using platform::weakly;
using screens::DocumentInteractionSheet;

namespace {

// The first frame has the size of a phone's screen, until the first layout replaces it.
constexpr platform::Rect firstContentFrame{0, 0, 375, 667};
/// In portrait orientation the content ends this much above the bottom; points.
constexpr double portraitBottomMargin = 17;

bool isPortrait(int orientation)
{
    return orientation == static_cast<int>(InterfaceOrientation::Portrait)
        || orientation == static_cast<int>(InterfaceOrientation::PortraitUpsideDown);
}

} // namespace

std::shared_ptr<PreviewBaseViewController> PreviewBaseViewController::self()
{
    return std::static_pointer_cast<PreviewBaseViewController>(shared_from_this());
}

std::shared_ptr<UndoHistory> PreviewBaseViewController::undoHistory() const
{
    const auto manager = itemManager();
    return manager ? manager->undoHistory() : nullptr;
}

void PreviewBaseViewController::loadView()
{
    ViewController::loadView();
    _contentView = std::make_shared<View>(firstContentFrame);
    _contentView->setDebugName("ContentView");
    _wrapperView = std::make_shared<View>();
    _wrapperView->setPlacedByFrame(false);
    _wrapperView->setDebugName("WrapperView");
    _scrollView = std::make_shared<kit::ScrollView>();
    _scrollView->setPlacedByFrame(false);
    _scrollView->setScrollBehavior({.showsHorizontalIndicator = false,
        .showsVerticalIndicator = false,
        .horizontalBounce = kit::Bounce::Never,
        .verticalBounce = kit::Bounce::Always});
    view()->addSubview(_scrollView);
    _contentView->addSubview(_wrapperView);
    _scrollView->addSubview(_contentView);
}

void PreviewBaseViewController::viewDidLoad()
{
    ViewController::viewDidLoad();
    view()->setBackground(platform::Color::white());
}

void PreviewBaseViewController::viewWillAppear(bool animated)
{
    ViewController::viewWillAppear(animated);
    configureButtons();
    setupConstraints();
    refreshItem();
}

void PreviewBaseViewController::viewWillDisappear(bool animated)
{
    if (const auto manager = itemManager())
        manager->viewControllerWillDisappear(*this);
    ViewController::viewWillDisappear(animated);
}

/// Creates the constraints at the first appearance; they hold for all later ones.
void PreviewBaseViewController::setupConstraints()
{
    if (!navigationController() || _parentBottomConstraint)
        return;
    kit::VisualFormatInput input;
    input.views = {{"scrollView", _scrollView}, {"contentView", _contentView}};
    for (const auto* format : {"H:|[scrollView]|", "V:|[scrollView]|"})
        LayoutConstraint::activate(kit::VisualFormat::constraints(format, input));
    _parentLeadingConstraint = _wrapperView->leadingAnchor().equalTo(_contentView->leadingAnchor());
    _parentTrailingConstraint = _wrapperView->trailingAnchor().equalTo(_contentView->trailingAnchor());
    _parentTopConstraint = _wrapperView->topAnchor().equalTo(_contentView->topAnchor());
    _parentBottomConstraint = _wrapperView->bottomAnchor().equalTo(_contentView->bottomAnchor());
    LayoutConstraint::activate(
        {_parentLeadingConstraint, _parentTrailingConstraint, _parentTopConstraint, _parentBottomConstraint});
    configureMargins();
}

/// The window may grow to a tablet's size or shrink to a phone's while the screen is shown.
void PreviewBaseViewController::traitsDidChange(const kit::TraitCollection& previous)
{
    ViewController::traitsDidChange(previous);
    if (_barButtonActionItem && isVisible())
        configureButtons();
}

void PreviewBaseViewController::viewWillLayoutSubviews()
{
    ViewController::viewWillLayoutSubviews();
    const auto insets = scrollViewDefaultEdgeInsets();
    auto frame = view()->bounds();
    frame.height = contentHeight(std::max(0.0, frame.height - (insets.top + insets.bottom)));
    _contentView->setFrame(frame);
    _scrollView->setContentSize({frame.width, frame.height});
    configureMargins();
}

platform::EdgeInsets PreviewBaseViewController::scrollViewDefaultEdgeInsets() const
{
    platform::EdgeInsets insets;
    // The shorter side is the status bar's height, however the device is held.
    if (const auto& screen = kit::Screen::main())
        insets.top = std::min(screen->statusBarFrame.width, screen->statusBarFrame.height);
    if (const auto navigation = navigationController()) {
        insets.top += navigation->barFrames().navigationBar.height;
        insets.bottom = navigation->isToolbarHidden() ? 0 : navigation->barFrames().toolbar.height;
    }
    return insets;
}

void PreviewBaseViewController::configureMargins()
{
    if (_parentBottomConstraint)
        _parentBottomConstraint->setConstant(
            isPortrait(currentPseudoOrientation()) ? -portraitBottomMargin : 0);
}

int PreviewBaseViewController::currentPseudoOrientation() const
{
    const auto& shown = traits();
    if (shown.horizontalSizeClass == SizeClass::Compact && shown.verticalSizeClass == SizeClass::Regular)
        return static_cast<int>(InterfaceOrientation::Portrait);
    if (const auto inWindow = window())
        return static_cast<int>(inWindow->interfaceOrientation());
    // A screen that is being made is in no window yet, but it will be in the only one.
    const auto& screen = kit::Screen::main();
    const bool lies = screen && screen->bounds.width > screen->bounds.height;
    return static_cast<int>(lies ? InterfaceOrientation::LandscapeLeft : InterfaceOrientation::Portrait);
}

bool PreviewBaseViewController::hasItemURL() const
{
    const auto manager = itemManager();
    return manager && manager->item();
}

void PreviewBaseViewController::refreshItem()
{
    enableButtons();
}

void PreviewBaseViewController::enableButtons()
{
    const bool enabled = hasItemURL();
    for (const auto& button : {_barButtonActionItem, _barButtonDeleteItem, _barButtonMoveItem}) {
        if (button)
            button->setEnabled(enabled);
    }
}

PreviewBaseViewController::Button PreviewBaseViewController::makeButton(
    SystemItem symbol, void (PreviewBaseViewController::*action)(const Button&))
{
    return std::make_shared<BarButtonItem>(symbol, weakly(this, action));
}

PreviewBaseViewController::Button PreviewBaseViewController::wrappedOpenInButton()
{
    const auto button = openInAppNavControllerButton();
    if (!button)
        return nullptr;
    button->setAction(weakly(this, &PreviewBaseViewController::openInDefaultApp));
    button->sizeToFit();
    return std::make_shared<BarButtonItem>(button);
}

void PreviewBaseViewController::configureButtons()
{
    const auto flexible = std::make_shared<BarButtonItem>(SystemItem::FlexibleSpace);
    const auto otherFlexible = std::make_shared<BarButtonItem>(SystemItem::FlexibleSpace);
    const auto fixed = std::make_shared<BarButtonItem>(SystemItem::FixedSpace);
    const auto otherFixed = std::make_shared<BarButtonItem>(SystemItem::FixedSpace);
    _barButtonMoveItem = makeButton(SystemItem::Organize, &PreviewBaseViewController::showMoveTarget);
    _barButtonDeleteItem =
        makeButton(SystemItem::Trash, &PreviewBaseViewController::showWarningAndDeleteDocument);
    _barButtonActionItem = makeButton(SystemItem::Action, &PreviewBaseViewController::showDocumentActivities);
    const auto openIn = wrappedOpenInButton();
    enableButtons();
    const auto navigation = navigationController();
    const bool isTablet = UIUtils::tabulaMode();
    if (navigation)
        navigation->setToolbarHidden(isTablet);
    if (isTablet) {
        setToolbarItems({});
        showRightBarButtonItems(
            {_barButtonActionItem, fixed, _barButtonDeleteItem, otherFixed, _barButtonMoveItem});
        return;
    }
    setToolbarItems(
        {_barButtonActionItem, flexible, _barButtonDeleteItem, otherFlexible, _barButtonMoveItem});
    const bool showsOpenIn = openIn && _mode == PreviewModeDetails;
    showRightBarButtonItems(showsOpenIn ? kit::BarButtonItems{openIn} : kit::BarButtonItems{});
}

void PreviewBaseViewController::showRightBarButtonItems(kit::BarButtonItems items)
{
    navigationItem().setRightItems(std::move(items));
}

void PreviewBaseViewController::openInDefaultApp()
{
    static constexpr Operation op{"-[PreviewBaseViewController openInDefaultApp:]"};
    op.userAction("Pressed Open in <app>");
    const auto manager = itemManager();
    const auto item = manager ? manager->item() : nullptr;
    if (!item)
        return;
    lookThen([url = item->url()] { return LaunchUtils::factsOf(url); },
        [url = item->url()](PreviewBaseViewController& self, const LaunchUtils::DocumentFacts& facts) {
            if (!LaunchUtils::openInDefaultAppFactsViewControllerRequireOpenIn(url, facts, self.self(), true))
                op.warning("Failed to open document %@ in default app", url);
        });
}

void PreviewBaseViewController::showWarningAndDeleteDocument(const Button&)
{
    static constexpr Operation op{"-[PreviewBaseViewController showWarningAndDeleteDocument:]"};
    op.userAction("Pressed Delete (preview base)");
    if (const auto manager = itemManager())
        manager->showWarningAndDeleteDocumentBarButton(self(), _barButtonDeleteItem);
}

void PreviewBaseViewController::showDocumentActivities(const Button&)
{
    static constexpr Operation op{"-[PreviewBaseViewController showDocumentActivities:]"};
    op.userAction("Pressed Share (sheet) button (preview base)");
    const auto manager = itemManager();
    const auto item = manager ? manager->item() : nullptr;
    if (!item)
        return;
    const auto url = item->resolvedURL();
    if (!url) {
        op.warning("showDocumentActivities: url is wrong class: %{public}@", "(null)");
        return;
    }
    op.info("showDocumentActivities: %@", *url);
    lookThen([url = *url] { return LaunchUtils::sharedItemAt(url); },
        [url = *url](PreviewBaseViewController& self, const LaunchUtils::SharedItem& shared) {
            if (shared.url != url)
                op.info("URL resolved to %@", shared.url);
            const auto shownIn = self.itemManager();
            if (!shownIn)
                return;
            const auto sheet =
                DocumentInteractionSheet::interactionControllerWithURLFacts(shared.url, shared.facts);
            shownIn->setDocumentInteractionController(sheet);
            sheet->presentOptionsMenuFromBarButtonItem(self.self(), self._barButtonActionItem, true);
        });
}

void PreviewBaseViewController::showMoveTarget(const Button&)
{
    if (const auto manager = itemManager())
        manager->showMoveTarget(self());
}

} // namespace tarrow
