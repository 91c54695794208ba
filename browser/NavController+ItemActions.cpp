// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file creates folders and moves, renames and deletes items, and asks the user before.

#include "browser/ItemDeletion.h"
#include "browser/NavController.h"
#include "items/DRItem.h"
#include "items/FileUtils.h"
#include "items/MenuEnableChecks.h"
#include "items/UrlResolution.h"
#include "kit/controllers/AlertController.h"
#include "kit/views/View.h"
#include "platform/Localization.h"
#include "platform/Log.h"
#include "preview/PreviewMode.h"
#include "prompts/NewFolderPrompt.h"
#include "prompts/RenamePrompt.h"
#include "prompts/UIUtils.h"
#include "screens/list/DocumentListController.h"

namespace tarrow {

using platform::localized;
using platform::localizedPlural;
using screens::DocumentListAction;
using screens::MoveTargetPicker;
using screens::MoveTargetScope;

namespace {

std::int64_t count(const auto& items)
{
    return static_cast<std::int64_t>(items.size());
}

void call(const NavController::Completion& completion)
{
    if (completion)
        completion();
}

/// Creates a folder if it does not exist yet.
std::optional<Error> makeFolder(const Url& folder, const Operation& op)
{
    if (FileUtils::exists(folder)) {
        op.info("Item exists at path: %@", folder);
        return Error(FileErrorCode::ItemExists);
    }
    return FileUtils::mkdir(folder);
}

/// Answers the prompt's message about items that could not be moved into the new folder.
std::string messageAbout(const std::vector<Error>& errors)
{
    return errors.size() == 1 ? UIUtils::bestMessage(errors.front())
                              : localizedPlural(".DICT.CANNOT_MOVE_ITEMS.%d", {count(errors)});
}

} // namespace

void NavController::documentListControllerPerformActionURL(const List& list, int action, const Url& url)
{
    documentListControllerPerformActionURLOriginatingViewCompletion(list, action, url, view(), [] {});
}

void NavController::documentListControllerPerformActionURLOriginatingViewCompletion(const List& list,
    int action, const Url& url, const std::shared_ptr<kit::View>& originatingView,
    const Completion& completion)
{
    static constexpr Operation op{
        "-[NavController documentListController:performAction:URL:originatingView:completion:]"};
    switch (static_cast<DocumentListAction>(action)) {
    case DocumentListAction::Delete:
        op.userAction("DLC Action Delete");
        performDelete(url, originatingView, completion);
        return;
    case DocumentListAction::More:
        op.userAction("DLC Action More");
        op.error("performAction:%{public}@ -- More is deprecated, unexpected value", action);
        return;
    case DocumentListAction::Info:
        op.userAction("DLC Action Info");
        performInfo(url);
        break;
    case DocumentListAction::Rename:
        op.userAction("DLC Action Rename");
        op.info("Rename action: %@", url);
        showRenamePrompt(url);
        break;
    case DocumentListAction::Share:
        op.userAction("DLC Action Share (share sheet)");
        op.info("Activity (share) action: %@", url);
        call(completion);
        showDICUrlCompletion(originatingView, url, completion);
        return;
    case DocumentListAction::Move:
        op.userAction("DLC Action Move");
        op.info("Move action: %@", url);
        showMoveTargetForItemsInFolder({url}, list ? list->presentedURL() : std::nullopt);
        break;
    case DocumentListAction::PressurePop:
        op.userAction("DLC Action Firmtap Pop");
        op.info("Preview action: %@", url);
        call(completion);
        knopPopToURL(url);
        return;
    default:
        op.error("performAction:%{public}@ -- unexpected value", action);
    }
    call(completion);
}

void NavController::performDelete(
    const Url& url, const std::shared_ptr<kit::View>& originatingView, const Completion& completion)
{
    _performActionCompletionBlock = completion;
    showWarningAndDeleteURLsUsingViewWithDocumentListControllerFinishedCompletion(
        {url}, originatingView, nullptr, [completion] { call(completion); });
}

void NavController::performInfo(const Url& url)
{
    static constexpr Operation op{
        "-[NavController documentListController:performAction:URL:originatingView:completion:]"};
    op.info("Info action: %@", url);
    const auto item = DRItem::initWithURL(url);
    op.info("Info action item: %@", item ? item->description() : "(null)");
    showPreviewPreviewMode(item, PreviewModeDetails);
}

void NavController::promtForNewFolderAndCreate(const Sender&)
{
    static constexpr Operation op{"-[NavController promtForNewFolderAndCreate:]"};
    op.userAction("Pressed NewFolder");
    op.info("Pressed NewFolder");
    if (const auto list = getTopDocumentListController())
        showNewFolderPromptDuringMoveItemsToMove(list->presentedURL(), {});
}

void NavController::showNewFolderPromptDuringMoveItemsToMove(
    const std::optional<Url>& folder, const std::vector<Url>& items)
{
    static constexpr Operation op{"-[NavController showNewFolderPromptDuringMove:itemsToMove:]"};
    op.userAction("Show New Folder Prompt (nav, during move)");
    if (!folder) {
        op.warning("dlc.presentedURL is nil");
        return;
    }
    const auto title =
        items.empty() ? localized("New Folder") : localizedPlural(".DICT.MOVE_ITEMS.%d", {count(items)});
    const auto confirmed = [weak = std::weak_ptr(self()), folder = *folder, items, asked = AccountSession()](
                               const std::string& name, bool& accepted) -> std::string {
        if (name.empty() || !asked.isCurrent())
            return {};
        op.userAction("New Folder name entry Confirmed");
        op.info("New folder entered: %@", name);
        const auto made = folder.appendingPathComponent(name, platform::PathKind::Directory);
        if (const auto error = makeFolder(made, op))
            return UIUtils::bestMessage(error);
        const auto browser = weak.lock();
        const auto errors = browser && !items.empty() ? browser->moveItemsToDirectoryToDirectory(items, made)
                                                      : std::vector<Error>();
        accepted = errors.empty();
        return accepted ? std::string() : messageAbout(errors);
    };
    _folderPromptAlert = NewFolderPrompt::newWithTitleDoneButtonTextCompletion(
        title, items.empty() ? localized("Create") : localized("Move"), confirmed);
    presentViewController(_folderPromptAlert->alert(), true);
}

void NavController::showMoveTargetForSelectedItems(const Sender&)
{
    static constexpr Operation op{"-[NavController showMoveTargetForSelectedItems:]"};
    op.userAction("Pressed Move");
    op.info("Pressed Move");
    const auto list = getTopDocumentListController();
    if (!list)
        return;
    const auto items = list->selectedItems();
    setEditModeAndUpdateUIForViewController(false, list);
    showMoveTargetForItemsInFolder(items, list->presentedURL());
}

void NavController::showMoveTargetForItemsInFolder(
    const std::vector<Url>& items, const std::optional<Url>& folder)
{
    static constexpr Operation op{"-[NavController showMoveTargetForItems:inFolder:]"};
    if (MenuEnableChecks::isDesktopOrDocumentsInURLArray(items)) {
        op.warning("Not moving items with special folder: %@", items);
        UIUtils::showUnsupportedError(visibleViewController());
        return;
    }
    op.info("Prompting for Move Target, %d items", items.size());
    const bool mayLeave = trw_canCrossZoneMoveURLs(items);
    if (!mayLeave && folder && !MenuEnableChecks::containerHasSubfolders(*folder)) {
        showNewFolderPromptDuringMoveItemsToMove(folder, items);
        return;
    }
    const auto picker = MoveTargetPicker::initWithItemsScope(
        items, mayLeave ? MoveTargetScope::AllContainers : MoveTargetScope::Container);
    picker->setDelegate(self());
    _moveAsked.emplace();
    picker->setPresentationStyle(kit::PresentationStyle::OverCurrentContext);
    visibleViewController()->presentViewController(picker, true, [] { op.debug("Presented moveTarget"); });
}

void NavController::documentTargetSelectionControllerDidSelectItemAtURL(
    const std::shared_ptr<MoveTargetPicker>& picker, const Url& folder)
{
    static constexpr Operation op{"-[NavController documentTargetSelectionController:didSelectItemAtURL:]"};
    op.userAction("Move Target Selected (nav)");
    op.info("Move Target Selected: %@", folder);
    picker->dismissViewController(true);
    if (_moveAsked.value_or(AccountSession()).isCurrent())
        moveItemsToDirectoryAndShowErrorsToDirectory(picker->itemsToMove(), folder);
}

std::vector<Error> NavController::moveItemsToDirectoryToDirectory(
    const std::vector<Url>& items, const Url& directory)
{
    static constexpr Operation op{"-[NavController moveItemsToDirectory:toDirectory:]"};
    op.debug("MoveTarget = %@", directory);
    op.debug("ItemsToMove = %@", items);
    std::vector<Error> errors;
    for (const auto& item : items) {
        if (auto error = FileUtils::moveTo(item, directory.appendingPathComponent(item.lastPathComponent())))
            errors.push_back(std::move(*error));
    }
    return errors;
}

void NavController::moveItemsToDirectoryAndShowErrorsToDirectory(
    const std::vector<Url>& items, const Url& directory)
{
    const auto errors = moveItemsToDirectoryToDirectory(items, directory);
    if (errors.size() == 1)
        UIUtils::showFriendlyMoveErrorParentViewController(errors.front(), topViewController());
    else if (!errors.empty())
        UIUtils::showAlertMessageParentViewController(
            localizedPlural(".DICT.CANNOT_MOVE_ITEMS.%d", {count(errors)}), {}, topViewController());
}

void NavController::showRenamePrompt(const Url& url)
{
    static constexpr Operation op{"-[NavController showRenamePrompt:]"};
    const auto item = DRItem::initWithURL(url);
    if (!item)
        return;
    if (trw_isDesktopOrDocumentsFolder(url)) {
        op.warning("Not renaming special folder: %@", url);
        UIUtils::showUnsupportedError(visibleViewController());
        return;
    }
    _folderPromptAlert = RenamePrompt::newWithFilenameCompletion(item->localizedName(),
        [url, asked = AccountSession()](const std::string& name, bool& accepted) -> std::string {
            if (name.empty() || !asked.isCurrent())
                return {};
            op.userAction("Rename entry confirmed (nav)");
            const auto error = UIUtils::renameItemAtURLToName(url, name);
            accepted = !error;
            return UIUtils::bestMessage(error);
        });
    visibleViewController()->presentViewController(_folderPromptAlert->alert(), true);
}

void NavController::showWarningAndDeleteDocument(const Sender&)
{
    static constexpr Operation op{"-[NavController showWarningAndDeleteDocument:]"};
    const auto list = getTopDocumentListController();
    if (!list)
        return;
    const auto items = list->selectedItems();
    op.userAction("Pressed Delete (nav)");
    op.info("Pressed Delete after selecting %{public}@ items: %@", items.size(), items);
    showWarningAndDeleteURLsUsingViewWithDocumentListControllerFinishedCompletion(items, nullptr, list, {});
}

void NavController::showWarningAndDeleteURLsUsingViewWithDocumentListControllerFinishedCompletion(
    const std::vector<Url>& urls, const std::shared_ptr<kit::View>& view, const List& list,
    const Completion& finished)
{
    static constexpr Operation op{
        "-[NavController showWarningAndDeleteURLs:usingView:withDocumentListController:finishedCompletion:]"};
    const auto libraries = MenuEnableChecks::numContainersInURLArray(urls);
    if (libraries != 0 && libraries != urls.size()) {
        op.error("Not Deleting: mix of containers and items: %@", urls);
        call(finished);
        return;
    }
    if (MenuEnableChecks::isDesktopOrDocumentsInURLArray(urls)) {
        op.warning("Not deleting special folder: %@", urls);
        call(finished);
        UIUtils::showUnsupportedError(visibleViewController());
        return;
    }
    UIUtils::showDeleteWarningAlertHasContainerViewControllerUsingViewUsingButtonCompletion(urls,
        libraries != 0, visibleViewController(), view, _barButtonDeleteItem,
        [browser = self(), urls, list, finished, asked = AccountSession()](const auto&, bool cancelled) {
            op.userAction(cancelled ? "Delete was Cancelled (nav)" : "Delete was Confirmed (nav)");
            const bool isConfirmed = !cancelled && asked.isCurrent();
            if (isConfirmed && list)
                browser->setEditModeAndUpdateUIForViewController(false, list);
            browser->deleteConfirmed(isConfirmed ? urls : std::vector<Url>(), finished);
        });
}

void NavController::deleteConfirmed(const std::vector<Url>& urls, const Completion& finished)
{
    const auto outcome = deleteItems(urls);
    call(finished);
    if (outcome.failures == 1)
        UIUtils::showErrorParentViewController(outcome.lastError, topViewController());
    else if (outcome.failures > 1)
        UIUtils::showAlertMessageParentViewController(
            localizedPlural(".DICT.CANNOT_DELETE_ITEMS.%d", {static_cast<std::int64_t>(outcome.failures)}),
            {}, topViewController());
}

void NavController::showDICUrlCompletion(
    const std::shared_ptr<kit::View>& originatingView, const Url& url, const Completion& completion)
{
    static constexpr Operation op{"-[NavController showDIC:url:completion:]"};
    op.userAction("Show Share Sheet (nav)");
    op.info("showDIC: %@", url);
    const auto resolved = trw_URLByResolvingBookmark(url).value_or(url);
    if (resolved != url)
        op.info("URL resolved to %@", resolved);
    _performActionCompletionBlock = completion;
    const auto anchor = originatingView ? originatingView : view();
    const auto bounds = anchor->bounds();
    const auto rect =
        originatingView ? platform::Rect{bounds.x, bounds.midY(), bounds.width, 0} : platform::Rect{};
    const auto sheet = screens::DocumentInteractionSheet::interactionControllerWithURL(resolved);
    const auto& containers = services().cloudDocumentService().containers();
    const auto container = containers.containerForItem(resolved);
    if (containers.isContainerTopFolder(resolved) && container && *container)
        sheet->setName((*container)->localizedName);
    sheet->setDelegate(self());
    _documentInteractionController = sheet;
    sheet->presentOptionsMenuFromRectInView(visibleViewController(), rect, anchor, true);
}

} // namespace tarrow
