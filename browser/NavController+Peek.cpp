// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file holds what a peek at an item shows, and how a pop opens it.

#include "browser/LookedUpItem.h"
#include "browser/NavController.h"
#include "browser/PeekFolderViewController.h"
#include "items/DRItem.h"
#include "items/LaunchUtils.h"
#include "platform/CloudDocumentService.h"
#include "platform/Log.h"
#include "platform/Services.h"
#include "platform/Weakly.h"
#include "preview/LookwellItemController.h"
#include "preview/PreviewItemManager.h"
#include "screens/FolderPlaces.h"
#include "screens/list/DocumentListController.h"

#include <array>

namespace tarrow {

using platform::weakly;
using screens::DocumentListController;

NavController::PeekedItem NavController::lookAtPeeked(const Url& url)
{
    constexpr std::array keys{AttributeKey::IsPackage, AttributeKey::IsRegularFile, AttributeKey::IsDirectory,
        AttributeKey::DownloadingStatus};
    PeekedItem peeked{url, {}, {}};
    const auto values =
        services().cloudDocumentService().promisedItems().promisedItemResourceValues(url, keys).value;
    const auto* status =
        values ? values->get<platform::DownloadingStatus>(AttributeKey::DownloadingStatus) : nullptr;
    const bool isInCloud = status && *status == platform::DownloadingStatus::NotDownloaded;
    if (values
        && (isInCloud || values->flag(AttributeKey::IsPackage) || values->flag(AttributeKey::IsRegularFile)))
        peeked.document = DRItem::initWithURL(url);
    else if (values && values->flag(AttributeKey::IsDirectory))
        peeked.folderTitle = screens::folderTitle(url);
    return peeked;
}

void NavController::documentListControllerPrepareToPreviewItemAtURL(
    const List&, const Url& url, const Completion& ready)
{
    lookThen([url] { return lookAtPeeked(url); },
        [ready](NavController& self, const PeekedItem& peeked) {
            self._peekedItem = std::make_shared<PeekedItem>(peeked);
            ready();
        },
        {});
}

NavController::Screen NavController::documentListControllerViewControllerForPreviewingItemAtURL(
    const List&, const Url& url)
{
    static constexpr Operation op{
        "-[NavController documentListController:viewControllerForPreviewingItemAtURL:]"};
    op.userAction("DLC Action Firmtap Peek");
    op.debug("DLC asking for PeekVC for %@", url);
    const auto known = std::exchange(_peekedItem, nullptr);
    const auto peeked = known && known->url == url ? *known : lookAtPeeked(url);
    if (peeked.document) {
        completeTransition();
        _itemManager = PreviewItemManager::newItemManagerWithModeNavController(PreviewModeQuick, self());
        _itemManager->setUndoHistory(_undoHistory);
        _peekManager = _itemManager;
        return _itemManager->prepareToPreviewItem(peeked.document);
    }
    if (peeked.folderTitle)
        return PeekFolderViewController::initWithURLTitle(url, *peeked.folderTitle);
    op.debug("URL is not a regular file, package, or folder");
    return nullptr;
}

void NavController::documentListControllerPeekDidEnd(const List&)
{
    dropPeek();
}

void NavController::dropPeek()
{
    // A pop has put the preview on the stack, and any other preview has a manager of its own.
    const bool isStillPeeks = _itemManager && _itemManager == _peekManager.lock();
    if (isStillPeeks && !_isPopping && getTopDocumentListController())
        dropItemManager();
}

void NavController::knopPopToURL(const Url& url)
{
    const bool isFromSearch = isSearchPresented();
    if (isFromSearch)
        dismissViewController(true);
    const auto look = [url] {
        auto popped = lookAtPicked(url, false);
        popped.folders = PreviewItemManager::foldersForURL(url);
        return popped;
    };
    _look->forget();
    _isPopping = true;
    const auto end = [](NavController& self) {
        self._isPopping = false;
        self.dropPeek();
    };
    lookThen(
        look,
        [url, isFromSearch, end](NavController& self, const PickedItem& popped) {
            self.openPopped(url, popped, isFromSearch);
            end(self);
        },
        weakly(this, end));
}

void NavController::openPopped(const Url& url, const PickedItem& popped, bool isFromSearch)
{
    static constexpr Operation op{"-[NavController knopPopToURL:]"};
    if (!popped.item)
        return;
    if (isFolderInCloud(*popped.item))
        return downloadItems({url});
    if (popped.item->isDirectory()) {
        op.debug("Building DLC stack for Firmtap of %@", url);
        openFolder(popped, op);
        return;
    }
    _recentDocument.opened(*popped.item);
    if (LaunchUtils::openInDefaultAppFactsViewControllerRequireOpenIn(
            url, popped.launch, topViewController(), true)) {
        op.debug("openInDefaultApp returned YES, app launched");
        return;
    }
    op.debug("openInDefaultApp returned NO, showing cached Lookwell from Knop");
    pushPeekedPreview(popped, isFromSearch);
}

void NavController::pushPeekedPreview(const PickedItem& popped, bool isFromSearch)
{
    const auto preview = _itemManager ? _itemManager->currentLookwellController() : nullptr;
    if (isFromSearch && !popped.folders.empty()) {
        // The folder's list would drop the manager, which only the browser owns.
        const auto manager = std::exchange(_itemManager, nullptr);
        setViewControllers(asStack(DocumentListController::listsOf(popped.folders)), false);
        completeTransition();
        _itemManager = manager;
    }
    if (preview)
        pushViewController(preview, true);
}

} // namespace tarrow
