// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file follows the changes that other programs make to the previewed item.

#include "items/DRItem.h"
#include "items/ItemMoves.h"
#include "kit/controllers/Window.h"
#include "platform/CloudDocumentService.h"
#include "platform/Dispatch.h"
#include "platform/FileCoordinator.h"
#include "platform/Localization.h"
#include "platform/Log.h"
#include "platform/Services.h"
#include "platform/Weakly.h"
#include "preview/LookwellItemController.h"
#include "preview/PreviewDetailsViewController.h"
#include "preview/PreviewItemManager.h"
#include "screens/DisplayName.h"
#include "screens/EndPresented.h"
#include "screens/FolderPlaces.h"

namespace tarrow {

using platform::localized;
using platform::Operation;
using platform::services;
using platform::Url;
using platform::weakly;

namespace {

/// Programs save in several steps, so one reading after the last step is enough.
constexpr auto refreshDelay = std::chrono::seconds(1);

std::string shownName(const std::optional<Url>& url)
{
    return url ? screens::displayName(url->lastPathComponent()) : std::string();
}

std::string deletedNotice(const std::optional<Url>& url)
{
    return localized("“%@” was deleted", {shownName(url)});
}

void reloadPreview()
{
    static constexpr Operation op{"-[PreviewItemManager refreshItem:]"};
    op.debug("LWPreviewController: refreshCurrentPreviewItem");
    LookwellItemController::defaultController()->refreshCurrentPreviewItem();
}

} // namespace

bool PreviewItemManager::filePresenterRegistered() const
{
    const std::lock_guard lock(_mutex);
    return _filePresenterRegistered;
}

void PreviewItemManager::registerAsFilePresenter()
{
    {
        const std::lock_guard lock(_mutex);
        if (!_filePresenterRegistered)
            services().fileCoordinator().addFilePresenter(shared_from_this());
        _filePresenterRegistered = true;
    }
    registerBatonneActivity();
}

void PreviewItemManager::unregisterAsFilePresenter()
{
    {
        const std::lock_guard lock(_mutex);
        if (_filePresenterRegistered)
            services().fileCoordinator().removeFilePresenter(*this);
        _filePresenterRegistered = false;
    }
    unregisterBatonneActivity();
}

std::optional<Url> PreviewItemManager::presentedItemURL()
{
    static constexpr Operation op{"-[PreviewItemManager presentedItemURL]"};
    auto url = itemURL();
    op.debug("presentedItemURL %@", url);
    return url;
}

bool PreviewItemManager::refreshPending() const
{
    const std::lock_guard lock(_mutex);
    return _refreshPending;
}

void PreviewItemManager::clearRefreshPending()
{
    const std::lock_guard lock(_mutex);
    _refreshPending = false;
}

void PreviewItemManager::presentedItemDidChange()
{
    static constexpr Operation op{"-[PreviewItemManager presentedItemDidChange]"};
    op.info("presentedItemDidChange: %@", itemURL());
    {
        const std::lock_guard lock(_mutex);
        if (std::exchange(_refreshPending, true))
            return;
    }
    auto& dispatch = services().dispatch();
    dispatch.after(refreshDelay, dispatch.mainQueue(), weakly(this, [](PreviewItemManager& self) {
        if (const auto url = self.itemURL())
            self.refreshItem(*url);
        self.clearRefreshPending();
    }));
}

void PreviewItemManager::refreshItem(const Url& url)
{
    static constexpr Operation op{"-[PreviewItemManager refreshItem:]"};
    const auto fresh = DRItem::initWithURL(url);
    if (!fresh)
        return;
    const auto old = item();
    const auto oldPath = old ? std::optional(old->url().path()) : std::nullopt;
    const bool isElsewhere = oldPath != fresh->url().path();
    if (isElsewhere)
        op.error("UNEXPECTED: path changed but we only got a presentedItemDidChange: %@ to %@", oldPath,
            fresh->url().path());
    const auto& date = fresh->contentModificationDate();
    op.debug("%@: modDate %{public}@ vs %{public}@", fresh->url(), _modifiedDate, date);
    const bool isNewer = _modifiedDate && date && *_modifiedDate < *date;
    _modifiedDate = date;
    setItemUpdatePreview(fresh, isElsewhere);
    op.info("Refreshing %@", itemURL());
    refreshScreens(old, *fresh, isNewer);
}

void PreviewItemManager::refreshScreens(
    const std::shared_ptr<DRItem>& before, const DRItem& item, bool isNewer)
{
    const auto preview = LookwellItemController::defaultController();
    preview->setTitle(screens::displayName(item.localizedName()));
    if (preview->isVisible() && isNewer)
        reloadPreview();
    const bool isOther = !before || before->url().path() != item.url().path()
        || (!before->isDownloaded() && item.isDownloaded()) || before->tags() != item.tags();
    if (_detailsViewController && (isOther || isNewer))
        _detailsViewController->refreshItem();
}

void PreviewItemManager::presentedItemDidMoveToURL(const Url& newURL)
{
    static constexpr Operation op{"-[PreviewItemManager presentedItemDidMoveToURL:]"};
    const auto& items = services().cloudDocumentService().items();
    const auto real = items.realURL(newURL);
    const auto url = itemURL();
    op.info("presentedItemDidMoveToURL: %@ changed to %@", url, real);
    if (items.isInTrash(real))
        return leaveItem(deletedNotice(url));
    if (!items.isInDocumentsArea(real))
        return leaveItem(localized("“%@” was moved out of the drive", {shownName(url)}));
    if (url && url->path() == real.path()) {
        op.warning("UNEXPECTED: duplicate calls to presentedItemDidMoveToURL: %@", real.path());
        return;
    }
    services().dispatch().mainQueue()->async(weakly(this, &PreviewItemManager::followTo, real));
}

/// Follows the item to its new place. A preview in a peek is only kept ready, because the user did not ask to
/// leave the list.
void PreviewItemManager::followTo(const Url& url)
{
    const auto navigation = navigationController();
    const bool isPeekedAt = filePresenterRegistered() && navigation
        && !isPreviewControllerDisplayed(navigation->topViewController());
    if (isPeekedAt) {
        prepareToPreviewItem(DRItem::initWithURL(url));
        return;
    }
    const auto before = itemURL();
    const auto progress =
        _detailsViewController ? std::optional(_detailsViewController->progress()) : std::nullopt;
    const auto window = navigation ? navigation->window() : nullptr;
    if (!warpToNewURL(url))
        return;
    if (progress && _detailsViewController)
        _detailsViewController->continueAt(*progress);
    // Who gave the name or chose the place here needs no words about it.
    const bool isKnown = (progress && progress->givenName == url.lastPathComponent()) || _movedTo == url;
    if (window && before && !isKnown)
        window->showNotice(movedSentence(*before, url));
}

void PreviewItemManager::accommodatePresentedItemDeletionWithCompletionHandler(CompletionHandler completion)
{
    static constexpr Operation op{
        "-[PreviewItemManager accommodatePresentedItemDeletionWithCompletionHandler:]"};
    const auto url = itemURL();
    op.info("Accommodate deletion: %@", url);
    completion(std::nullopt);
    leaveItem(deletedNotice(url));
}

void PreviewItemManager::leaveItem(const std::string& notice)
{
    unregisterAsFilePresenter();
    services().dispatch().mainQueue()->async(weakly(this, &PreviewItemManager::popPreview, notice));
}

/// Takes the preview off the stack. A preview that was only prepared, or was left meanwhile, has no screen
/// there.
void PreviewItemManager::popPreview(const std::string& notice)
{
    const auto navigation = navigationController();
    if (!navigation || !isPreviewControllerDisplayed(navigation->topViewController()))
        return;
    // The screens over the preview ask about the item that has gone.
    screens::endPresented(*navigation);
    navigation->popViewController(true);
    if (const auto window = navigation->window())
        window->showNotice(notice);
}

/// Looks at what happened to the item while nobody followed it.
void PreviewItemManager::lookAgain()
{
    const auto url = itemURL();
    if (!url)
        return;
    if (DRItem::initWithURL(*url))
        return refreshItem(*url);
    unregisterAsFilePresenter();
    popPreview(localized("“%@” is no longer there.", {shownName(url)}));
}

void PreviewItemManager::accommodatePresentedSubitemDeletionAtURLCompletionHandler(
    const Url& url, CompletionHandler completion)
{
    static constexpr Operation op{
        "-[PreviewItemManager accommodatePresentedSubitemDeletionAtURL:completionHandler:]"};
    op.info("%@ accommodate subitem deletion at %@", itemURL(), url);
    completion(std::nullopt);
    unregisterAsFilePresenter();
    auto& dispatch = services().dispatch();
    dispatch.after(
        refreshDelay, dispatch.mainQueue(), weakly(this, &PreviewItemManager::refreshAfterSubitemDeletion));
}

void PreviewItemManager::refreshAfterSubitemDeletion()
{
    static constexpr Operation op{
        "-[PreviewItemManager accommodatePresentedSubitemDeletionAtURL:completionHandler:]"};
    op.info("Refreshing %@", itemURL());
    if (LookwellItemController::defaultController()->isVisible())
        reloadPreview();
    clearRefreshPending();
}

} // namespace tarrow
