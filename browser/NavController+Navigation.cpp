// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file holds the ways through the drive: taps, links, jumps from outside and the search.

#include "browser/LookedUpItem.h"
#include "browser/NavController.h"
#include "items/DRItem.h"
#include "items/UrlResolution.h"
#include "kit/controllers/SearchPresentation.h"
#include "kit/controllers/Window.h"
#include "platform/CloudDocumentService.h"
#include "platform/Dispatch.h"
#include "platform/Localization.h"
#include "platform/Log.h"
#include "platform/Services.h"
#include "platform/Weakly.h"
#include "preview/PreviewItemManager.h"
#include "prompts/UIUtils.h"
#include "screens/DisplayName.h"
#include "screens/EndPresented.h"
#include "screens/FolderPlaces.h"
#include "screens/list/DocumentListController.h"

namespace tarrow {

using platform::weakly;
using screens::DocumentListController;

namespace {

/// The stack needs this long to settle before the search field can take the keyboard.
constexpr auto searchDelay = std::chrono::milliseconds(700);

const platform::CloudItems& cloudItems()
{
    return services().cloudDocumentService().items();
}

bool isInDocumentsArea(const std::optional<Url>& url)
{
    return url && cloudItems().isInDocumentsArea(*url);
}

std::string described(const std::shared_ptr<DRItem>& item)
{
    return item ? item->description() : "(null)";
}

} // namespace

namespace {

/// Says where a symbolic link leads.
struct LinkTarget {
    enum class Place { InDrive, OutsideDrive, Nowhere };
    Place place = Place::InDrive;
    std::shared_ptr<DRItem> item{}; ///< null unless the place lies in the drive
};

LinkTarget::Place placeOf(const std::optional<Url>& refused)
{
    return refused ? LinkTarget::Place::OutsideDrive : LinkTarget::Place::Nowhere;
}

/// Says why a link cannot be followed.
std::string refusal(LinkTarget::Place place, const Url& link)
{
    const auto name = screens::displayName(link.lastPathComponent());
    return place == LinkTarget::Place::OutsideDrive
        ? platform::localized("“%@” leads to a place outside the drive.", {name})
        : platform::localized("“%@” leads to something that is not there.", {name});
}

/// Answers the target of a symbolic link, one step further, when both ends lie in the drive's documents.
LinkTarget followLink(const DRItem& link, const Operation& op)
{
    const auto& target = link.resolvedURL();
    if (!isInDocumentsArea(target)) {
        op.debug("DLC Selection is symlink to outside target: %@", target);
        return {placeOf(target)};
    }
    auto item = DRItem::initWithURL(*target);
    if (!item) {
        op.debug("DLC Selection is symlink that didn't resolve to valid target: %@", target);
        return {LinkTarget::Place::Nowhere};
    }
    if (!isInDocumentsArea(item->resolvedURL())) {
        op.debug("DLC Selection is symlink to invalid target: %@", item->resolvedURL());
        return {placeOf(item->resolvedURL())};
    }
    return {LinkTarget::Place::InDrive, std::move(item)};
}

Error vanished(const Url& url)
{
    return Error(FileErrorCode::NoSuchFile,
        {{std::string(platform::errorKey::localizedDescription),
             platform::localized("“%@” is no longer there.", {url.lastPathComponent()})},
            {std::string(platform::errorKey::filePath), url.path()}});
}

} // namespace

NavController::List NavController::getTopDocumentListController() const
{
    static constexpr Operation op{"-[NavController getTopDocumentListController]"};
    const auto top = topViewController();
    if (!top)
        op.warning("ERROR: topViewController is nil");
    return std::dynamic_pointer_cast<DocumentListController>(top);
}

void NavController::navigationControllerDidShowViewControllerAnimated(
    NavigationController&, const Screen& screen, bool)
{
    const auto list = std::dynamic_pointer_cast<DocumentListController>(screen);
    if (!list)
        return;
    dropItemManager();
    if (_editMode)
        _editMode = list->editing();
    updateStatusUI(list);
    initNewListController(list);
    setToolbarHidden(false);
}

void NavController::dropItemManager()
{
    if (_itemManager)
        _itemManager->unregisterAsFilePresenter();
    _itemManager = nullptr;
}

void NavController::replaceItemManager(int mode)
{
    // The running transition is completed first. Otherwise a list that is still moving in would be reported
    // after the preview follows it, and the report would drop the manager.
    completeTransition();
    dropItemManager();
    _itemManager = PreviewItemManager::newItemManagerWithModeNavController(mode, self());
    _itemManager->setUndoHistory(_undoHistory);
    _itemManager->setDownloadVerbs(downloadVerbs());
    _itemManager->setPreviewVerbs(previewVerbs());
}

void NavController::showPreviewPreviewMode(const std::shared_ptr<DRItem>& item, int mode)
{
    if (!item)
        return;
    replaceItemManager(mode);
    // This call keeps the manager alive as well, because showing its screen may replace it.
    const auto manager = _itemManager;
    manager->previewItem(item);
}

bool NavController::isSearchPresented() const
{
    return std::dynamic_pointer_cast<kit::SearchPresentation>(presentedViewController()) != nullptr;
}

void NavController::endEverythingPresented()
{
    _look->forget();
    screens::endPresented(*this);
}

void NavController::tell(const std::string& notice) const
{
    if (const auto shown = window())
        shown->showNotice(notice);
}

bool NavController::warpToNewURLPreviewMode(const std::optional<Url>& url, int mode)
{
    static constexpr Operation op{"-[NavController warpToNewURL:previewMode:]"};
    endEverythingPresented();
    if (!url)
        return false;
    if (!cloudItems().isInDocumentsArea(*url)) {
        op.debug("Preview URL is not in the Mobile Documents dir: %@", *url);
        return false;
    }
    if (cloudItems().isInTrash(*url)) {
        op.debug("Preview URL is in Trash: %@", *url);
        return false;
    }
    const auto resolved = trw_URLByResolvingPromise(*url);
    replaceItemManager(mode);
    const auto manager = _itemManager;
    const bool warped = manager->warpToNewURL(resolved);
    if (!warped)
        op.warning("warpToNewURL failed: %@", resolved);
    const auto item = manager->item();
    if (warped && item && !item->isDirectory())
        _recentDocument.opened(*item);
    return warped;
}

bool NavController::warpToFolderForURL(const Url& url)
{
    const auto stack = PreviewItemManager::dlcStackForURL(url);
    if (stack)
        setViewControllers(asStack(*stack), false);
    return stack.has_value();
}

/// Ends edit mode before a search, because its results could not be opened.
void NavController::endChoiceOfItems()
{
    if (_editMode)
        setEditModeAndUpdateUIForViewController(false, getTopDocumentListController());
}

void NavController::startSearch(const std::string& query)
{
    endEverythingPresented();
    endChoiceOfItems();
    popToRootViewController(false);
    auto& dispatch = services().dispatch();
    dispatch.after(searchDelay, dispatch.mainQueue(), weakly(this, [query](NavController& self) {
        self.endChoiceOfItems();
        if (const auto list = self.getTopDocumentListController())
            list->startSearchWithQueryStringBecomeFirstResponder(query, true);
    }));
}

void NavController::documentListControllerDidSelectContainerWithViewController(
    const List&, const List& container)
{
    static constexpr Operation op{
        "-[NavController documentListController:didSelectContainerWithViewController:]"};
    op.userAction("Selected Folder (dlc)");
    if (!container || !container->presentedURL()) {
        op.warning("New DLC is nil");
        return;
    }
    op.info("User selected folder %@", *container->presentedURL());
    if (_editMode) {
        op.warning("DLC Navigation not allowed while in edit mode");
        return;
    }
    if (isSearchPresented()) {
        dismissViewController(true);
        // A search result is shown in its real place in the drive.
        lookThen([url = *container->presentedURL()] { return PreviewItemManager::foldersForURL(url); },
            [container](NavController& self, const std::vector<screens::TitledFolder>& folders) {
                if (folders.empty())
                    self.pushList(container);
                else
                    self.setViewControllers(asStack(DocumentListController::listsOf(folders)), false);
            },
            {});
        return;
    }
    pushList(container);
}

void NavController::pushList(const List& list)
{
    initNewListController(list);
    pushViewController(list, true);
}

void NavController::documentListControllerDidSelectItemAtURL(const List&, const Url& url)
{
    static constexpr Operation op{"-[NavController documentListController:didSelectItemAtURL:]"};
    op.userAction("Selected Item (dlc)");
    op.info("Picked URL: %@", url);
    lookThen([url, follows = !_editMode] { return lookAtPicked(url, follows); },
        [url](NavController& self, const PickedItem& picked) { self.openPicked(url, picked); }, {});
}

/// Looks at an item that was tapped and, for a link, at where it leads.
NavController::PickedItem NavController::lookAtPicked(const Url& url, bool followsLinks)
{
    static constexpr Operation op{"-[NavController documentListController:didSelectItemAtURL:]"};
    PickedItem picked{DRItem::initWithURL(url), {}, {}, {}, {}};
    picked.target = picked.item;
    if (picked.item && picked.item->isSymlink() && followsLinks) {
        auto target = followLink(*picked.item, op);
        picked.target = std::move(target.item);
        if (!picked.target)
            picked.refusal = refusal(target.place, url);
    }
    if (picked.target)
        picked.launch = LaunchUtils::factsOf(picked.target->url());
    if (picked.target && picked.target->isDirectory())
        picked.folders = PreviewItemManager::foldersForURL(picked.target->url());
    return picked;
}

void NavController::openPicked(const Url& url, const PickedItem& picked)
{
    static constexpr Operation op{"-[NavController documentListController:didSelectItemAtURL:]"};
    op.debug("DRItem: %@ (%{public}@ bytes %{public}@)", described(picked.item),
        picked.item ? picked.item->fileSize() : std::nullopt, url.pathExtension());
    if (!picked.item) {
        showVanishedItem(url);
        return;
    }
    if (_editMode) {
        op.debug("DLC Selection not allowed while in edit mode");
        return;
    }
    if (!picked.target)
        return tell(picked.refusal);
    if (isFolderInCloud(*picked.target)) {
        downloadItems({picked.target->url()});
    } else if (picked.target->isDirectory()) {
        op.debug("Building DLC stack for symlink to %@", picked.target->url());
        openFolder(picked, op);
    } else {
        openDocument(picked.target, picked.launch, op);
    }
}

void NavController::showVanishedItem(const Url& url)
{
    const auto top = topViewController();
    UIUtils::showErrorParentViewController(vanished(url), top ? top : self());
    // This runs later, so that the list first ends its handling of the tap.
    services().dispatch().mainQueue()->async(weakly(this, &NavController::setupInitialViewController));
}

void NavController::openFolder(const PickedItem& picked, const Operation& op)
{
    if (picked.folders.empty())
        op.error("Couldn't build DLC stack for %@. Not switching to folder", picked.target->url());
    else
        setViewControllers(asStack(DocumentListController::listsOf(picked.folders)), true);
}

void NavController::openDocument(
    const std::shared_ptr<DRItem>& item, const LaunchUtils::DocumentFacts& facts, const Operation& op)
{
    _recentDocument.opened(*item);
    if (LaunchUtils::openInDefaultAppFactsViewControllerRequireOpenIn(
            item->url(), facts, topViewController(), true)) {
        op.debug("openInDefaultApp returned YES, app launched");
        return;
    }
    op.debug("openInDefaultApp returned NO, showing preview");
    // This runs later, so that the list first ends its handling of the tap.
    services().dispatch().mainQueue()->async(weakly(this, [item](NavController& self) {
        self.showPreviewPreviewMode(item, item->canPreview() ? PreviewModeQuick : PreviewModeDetails);
    }));
}

void NavController::documentListControllerItemsChanged(const List& list)
{
    static constexpr Operation op{"-[NavController documentListControllerItemsChanged:]"};
    static std::size_t lastLoggedCount = 0;
    _pickerIsAlive = true;
    if (list != topViewController())
        return;
    const auto count = list->containedItemCount();
    if (_editMode) {
        op.debug("DLC selected item count is %{public}@", list->selectedItemCount());
    } else if (count != lastLoggedCount) {
        lastLoggedCount = count;
        op.debug("DLC items changed, count is %{public}@", count);
    }
    updateStatusUI(list);
}

void NavController::documentListControllerURLWasRemoved(const List& list)
{
    // The screens over the list ask about items that went with the folder.
    endEverythingPresented();
    if (viewControllers().size() > 1)
        tell(platform::localized("“%@” is no longer there.", {list->title()}));
    popViewController(true);
}

} // namespace tarrow
