// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file makes the screen and brings it up to date. Its layout, the renaming and the keyboard have sources
// of their own.

#include "preview/PreviewDetailsViewController.h"

#include "drawing/PieProgressIndicatorView.h"
#include "drawing/ThumbnailImageView.h"
#include "items/DRItem.h"
#include "kit/controllers/NavigationController.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/values/Screen.h"
#include "kit/views/Button.h"
#include "kit/views/ScrollView.h"
#include "kit/views/TapRecognizer.h"
#include "kit/views/TextField.h"
#include "platform/CloudDocumentService.h"
#include "platform/Localization.h"
#include "platform/Log.h"
#include "platform/Services.h"
#include "platform/Weakly.h"
#include "preview/FileInfoStackView.h"
#include "preview/PreviewItemManager.h"
#include "prompts/TagEditing.h"
#include "prompts/UIUtils.h"

namespace tarrow {

using kit::InterfaceOrientation;
using platform::localized;
using platform::services;
using platform::weakly;
using platform::weaklyOr;

std::shared_ptr<PreviewDetailsViewController> PreviewDetailsViewController::self()
{
    return std::static_pointer_cast<PreviewDetailsViewController>(shared_from_this());
}

std::shared_ptr<DRItem> PreviewDetailsViewController::item() const
{
    const auto manager = itemManager();
    return manager ? manager->item() : nullptr;
}

void PreviewDetailsViewController::viewDidLoad()
{
    PreviewBaseViewController::viewDidLoad();
    setupViewsAndConstraints();
    lookUpApp();
    offerMenu();
    view()->addGestureRecognizer(std::make_shared<kit::TapRecognizer>(
        weakly(this, [](PreviewDetailsViewController& self) { self.viewWasTapped(); })));
    registerForKeyboardNotifications();
    _onDownloads = services().notificationCenter().observe(platform::Notification::DownloadsDidChange,
        weakly(this, [](PreviewDetailsViewController& self) { self.showDownload(); }));
}

void PreviewDetailsViewController::viewWillAppear(bool animated)
{
    // A swipe back that was taken back shows the screen again.
    registerForKeyboardNotifications();
    // The window may have been turned while another screen lay over this one.
    adjustViewsForOrientation(currentPseudoOrientation());
    PreviewBaseViewController::viewWillAppear(animated);
}

/// A name that is still being typed is dropped, because it then is the name that counts as unchanged.
void PreviewDetailsViewController::viewWillDisappear(bool animated)
{
    _originalFilename = _filenameTextField->text();
    unregisterForKeyboardNotifications();
    PreviewBaseViewController::viewWillDisappear(animated);
}

void PreviewDetailsViewController::viewWillTransitionToSizeWithTransitionCoordinator(
    platform::Size size, kit::TransitionCoordinator& coordinator)
{
    PreviewBaseViewController::viewWillTransitionToSizeWithTransitionCoordinator(size, coordinator);
    _fileDetailsView->invalidateIntrinsicContentSize();
    const auto orientation =
        size.width > size.height ? InterfaceOrientation::LandscapeLeft : InterfaceOrientation::Portrait;
    adjustViewsForOrientation(static_cast<int>(orientation));
    configureMargins();
    refreshItem();
}

void PreviewDetailsViewController::traitsDidChange(const kit::TraitCollection& previous)
{
    placeOpenInAppButton();
    PreviewBaseViewController::traitsDidChange(previous);
}

void PreviewDetailsViewController::lookUpApp()
{
    if (const auto shown = item())
        _appLook->begin([url = shown->url()] { return LaunchUtils::factsOf(url); },
            weakly(this, &PreviewDetailsViewController::offerApp));
}

void PreviewDetailsViewController::offerApp(const LaunchUtils::DocumentFacts& facts)
{
    const auto name = LaunchUtils::defaultAppNameForDocumentFactsRequireOpenIn(facts, true);
    if (!name)
        return;
    _openInAppButton = std::make_shared<kit::Button>(localized("Open in “%@”", {*name}));
    _openInAppButton->setAction(weakly(this, &PreviewBaseViewController::openInDefaultApp));
    placeOpenInAppButton();
    // The bars were made without the button if the disk was slow.
    const auto stack = navigationController();
    if (barButtonActionItem() && stack && stack->topViewController() == self())
        configureButtons();
}

bool PreviewDetailsViewController::shouldDisplayOpenInAppButtonInView() const
{
    return _openInAppButton && UIUtils::tabulaMode();
}

std::shared_ptr<kit::Button> PreviewDetailsViewController::openInAppNavControllerButton()
{
    return shouldDisplayOpenInAppButtonInView() ? nullptr : _openInAppButton;
}

/// A name that is being typed or given is left alone, because the item may be read again at any time.
void PreviewDetailsViewController::refreshItem()
{
    PreviewBaseViewController::refreshItem();
    const auto shown = item();
    _fileInfoView->setItem(shown);
    _thumbnailView->setItem(shown);
    if (!_filenameTextField->isEditing()) {
        _originalFilename = shown ? shown->localizedName() : std::string();
        _filenameTextField->setText(_originalFilename);
        _filenameTextField->setPlaceholder({});
    }
    showDownload();
}

void PreviewDetailsViewController::offerMenu()
{
    navigationItem().setMenu(
        localized("More"), weaklyOr(kit::Menu(), this, &PreviewDetailsViewController::menu));
}

kit::Menu PreviewDetailsViewController::menu()
{
    kit::Menu menu;
    const auto shown = item();
    const auto manager = itemManager();
    if (shown && manager && !shown->isSymlink()) {
        using Kind = platform::FolderEntryKind;
        const auto document = shown->isPackage() ? Kind::Package : Kind::Document;
        const auto kind = shown->isDirectory() ? Kind::Folder : document;
        screens::addDownloadEntries(
            menu, manager->downloadVerbs(), {{shown->url(), kind, shown->isPromise(), {}}});
    }
    menu.push_back({.title = localized("Tags…"),
        .handler = weakly(this, &PreviewDetailsViewController::editTags),
        .image = {}});
    return menu;
}

void PreviewDetailsViewController::editTags()
{
    static constexpr platform::Operation op{"-[PreviewDetailsViewController editTags]"};
    op.userAction("Edit Tags (details)");
    const auto shown = item();
    // The stack outlives the screen, which a new name replaces.
    if (const auto navigation = navigationController(); navigation && shown)
        TagEditing::begin({shown->url()}, navigation, undoHistory());
}

PreviewDetailsViewController::Progress PreviewDetailsViewController::progress() const
{
    const auto& field = *_filenameTextField;
    const bool isTyped = field.isEditing() && field.text() != _originalFilename;
    return {scrollView()->contentOffset(), isTyped ? std::optional(field.text()) : std::nullopt,
        field.selectedRange(), _givenName};
}

void PreviewDetailsViewController::continueAt(const Progress& progress)
{
    view();
    scrollView()->setContentOffset(progress.scrolledTo);
    // The notice of the item's new place may come before the answer to the renaming that was begun here.
    const bool isStillTyped = progress.typedName && *progress.typedName != _originalFilename;
    if (!isStillTyped || !_filenameTextField->becomeFirstResponder())
        return;
    _filenameTextField->setText(*progress.typedName);
    _filenameTextField->setSelectedRange(progress.selection);
}

void PreviewDetailsViewController::showDownload()
{
    const auto shown = item();
    const auto progress = shown && !shown->isDownloaded()
        ? services().cloudDocumentService().items().downloadProgress(shown->url())
        : std::nullopt;
    _downloadView->setHidden(!progress);
    if (!progress)
        return;
    const double share = progress->total && *progress->total > 0
        ? static_cast<double>(progress->done) / static_cast<double>(*progress->total)
        : 0;
    _downloadView->setProgress(static_cast<float>(share));
    _downloadView->setAccessibilityLabel(localized("Downloading…"));
}

} // namespace tarrow
