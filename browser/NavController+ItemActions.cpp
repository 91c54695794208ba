// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file creates folders, moves and renames items and changes their tags, and asks the user before.

#include "browser/NavController.h"
#include "browser/RunningChanges.h"
#include "items/DRItem.h"
#include "items/FileUtils.h"
#include "items/ItemMoves.h"
#include "items/MenuEnableChecks.h"
#include "items/UrlResolution.h"
#include "kit/controllers/AlertController.h"
#include "kit/views/View.h"
#include "platform/Localization.h"
#include "platform/Log.h"
#include "platform/Weakly.h"
#include "preview/PreviewMode.h"
#include "prompts/NewFolderPrompt.h"
#include "prompts/RenamePrompt.h"
#include "prompts/TagEditing.h"
#include "prompts/UIUtils.h"
#include "screens/DrivePlaces.h"
#include "screens/list/DocumentListController.h"

namespace tarrow {

using platform::localized;
using platform::localizedPlural;
using platform::weakly;
using screens::DocumentListAction;
using screens::MoveTargetPicker;
using screens::MoveTargetScope;

namespace {

std::int64_t count(const auto& items)
{
    return static_cast<std::int64_t>(items.size());
}

/// The outcome of making a folder and of moving items into it.
struct FolderOutcome {
    std::optional<Error> refused; ///< the folder was not made
    std::vector<Error> left; ///< items could not be moved
    std::optional<UndoEntry> undo;
};

/// Creates a folder if it does not exist yet, and moves the items of a change into it.
FolderOutcome makeFolder(const Url& folder, ItemChange& change, const Operation& op)
{
    if (FileUtils::exists(folder)) {
        op.info("Item exists at path: %@", folder);
        return {Error(FileErrorCode::ItemExists), {}, {}};
    }
    if (auto refused = FileUtils::mkdir(folder, change.stillWanted()))
        return {std::move(refused), {}, {}};
    auto moved = moveItems(change, folder);
    return {std::nullopt, std::move(moved.errors), undoOfNewFolder(madeFolder(folder), moved.moved)};
}

/// Answers a prompt's message about an error. What was taken back needs no words.
std::string messageAbout(const std::optional<Error>& error)
{
    return error && error->is(FileErrorCode::Cancelled) ? std::string() : UIUtils::bestMessage(error);
}

/// Answers the prompt's message about items that could not be moved into the new folder; empty without any.
std::string messageAbout(const std::vector<Error>& errors)
{
    if (errors.empty())
        return {};
    return errors.size() == 1 ? UIUtils::bestMessage(errors.front())
                              : localizedPlural(".DICT.CANNOT_MOVE_ITEMS.%d", {count(errors)});
}

/// Answers whether a person still looks at a prompt that waits. It may have gone with the screen under it.
bool isOnScreen(const FilenamePrompt& prompt)
{
    return prompt.isWaiting() && prompt.alert()->presentingViewController();
}

} // namespace

void NavController::call(const Completion& completion)
{
    if (completion)
        completion();
}

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
        performInfo(url, completion);
        return;
    case DocumentListAction::Rename:
        op.userAction("DLC Action Rename");
        op.info("Rename action: %@", url);
        askForName(url, completion);
        return;
    case DocumentListAction::Share:
        op.userAction("DLC Action Share (share sheet)");
        op.info("Activity (share) action: %@", url);
        call(completion);
        showDICUrlCompletion(originatingView, url, completion);
        return;
    case DocumentListAction::Move:
        op.userAction("DLC Action Move");
        op.info("Move action: %@", url);
        // A search finds items of other folders than the list's.
        askForTarget({url},
            list && !isSearchPresented() ? list->presentedURL() : url.deletingLastPathComponent(),
            completion);
        return;
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

void NavController::performInfo(const Url& url, const Completion& completion)
{
    static constexpr Operation op{
        "-[NavController documentListController:performAction:URL:originatingView:completion:]"};
    op.info("Info action: %@", url);
    lookThen([url] { return DRItem::initWithURL(url); },
        [completion](NavController& self, const std::shared_ptr<DRItem>& item) {
            op.info("Info action item: %@", item ? item->description() : "(null)");
            self.showPreviewPreviewMode(item, PreviewModeDetails);
            call(completion);
        },
        completion);
}

void NavController::editTagsOfItems(const std::vector<Url>& items)
{
    static constexpr Operation op{"-[NavController editTagsOfItems:]"};
    op.userAction("Edit Tags");
    TagEditing::begin(items, self(), _undoHistory);
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
                               const std::string& name, bool&) -> std::string {
        if (name.empty() || !asked.isCurrent())
            return {};
        op.userAction("New Folder name entry Confirmed");
        op.info("New folder entered: %@", name);
        if (const auto browser = weak.lock())
            browser->makeFolderForItems(
                folder.appendingPathComponent(name, platform::PathKind::Directory), items, asked);
        return {};
    };
    _folderPromptAlert = NewFolderPrompt::newWithTitleDoneButtonTextCompletion(
        title, items.empty() ? localized("Create") : localized("Move"), confirmed);
    presentViewController(_folderPromptAlert->alert(), true);
}

void NavController::changeBegun(const std::shared_ptr<ItemChange>& change)
{
    if (!_runningChanges) {
        _runningChanges = RunningChanges::create(
            weakly(this, &NavController::showInLists, &NavController::showRunningChanges),
            weakly(this, &NavController::showInLists, &NavController::showProgress));
    }
    _runningChanges->begun(change);
}

void NavController::changeEnded()
{
    _runningChanges->forgetEnded();
}

void NavController::makeFolderForItems(
    const Url& folder, const std::vector<Url>& items, const AccountSession& asked)
{
    static constexpr Operation op{"-[NavController showNewFolderPromptDuringMove:itemsToMove:]"};
    const auto change = ItemChange::begin(
        asked, items, [folder](ItemChange& begun) { return makeFolder(folder, begun, op); },
        weakly(this,
            [prompt = _folderPromptAlert, expected = UndoHistory::expect(_undoHistory, asked)](
                NavController& self, const FolderOutcome& outcome) {
                self.changeEnded();
                const auto message =
                    outcome.refused ? messageAbout(outcome.refused) : messageAbout(outcome.left);
                if (isOnScreen(*prompt))
                    prompt->answer(!outcome.refused && outcome.left.empty(), message);
                else if (prompt->isWaiting() && !message.empty())
                    UIUtils::showAlertMessageParentViewController(message, {}, self.topViewController());
                if (outcome.undo)
                    expected->add(*outcome.undo);
            }));
    changeBegun(change);
    _folderPromptAlert->waitForAnswer([change] { change->cancel(); });
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
    askForTarget(items, folder, {});
}

void NavController::askForTarget(
    const std::vector<Url>& items, const std::optional<Url>& folder, const Completion& completion)
{
    const auto look = [items, folder, shown = MoveTargetPicker::foldersToLookUp(items)] {
        MoveFacts facts;
        facts.holdsSpecialFolder = MenuEnableChecks::isDesktopOrDocumentsInURLArray(items);
        facts.mayLeaveContainer = !facts.holdsSpecialFolder && trw_canCrossZoneMoveURLs(items);
        facts.hasOtherFolder =
            facts.mayLeaveContainer || !folder || MenuEnableChecks::containerHasSubfolders(*folder);
        facts.places = screens::DrivePlaces::lookUp(shown);
        return facts;
    };
    lookThen(
        look,
        [items, folder, completion](NavController& self, const MoveFacts& facts) {
            self.showMoveTarget(items, folder, facts);
            call(completion);
        },
        completion);
}

void NavController::showMoveTarget(
    const std::vector<Url>& items, const std::optional<Url>& folder, const MoveFacts& facts)
{
    static constexpr Operation op{"-[NavController showMoveTargetForItems:inFolder:]"};
    if (facts.holdsSpecialFolder) {
        op.warning("Not moving items with special folder: %@", items);
        UIUtils::showUnsupportedError(visibleViewController());
        return;
    }
    op.info("Prompting for Move Target, %d items", items.size());
    if (!facts.hasOtherFolder) {
        showNewFolderPromptDuringMoveItemsToMove(folder, items);
        return;
    }
    const auto picker = MoveTargetPicker::initWithItemsScopePlaces(items,
        facts.mayLeaveContainer ? MoveTargetScope::AllContainers : MoveTargetScope::Container, facts.places);
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

namespace {

/// Says what became of moving items.
struct MovedOutcome {
    std::vector<Error> errors;
    std::optional<UndoEntry> undo;
};

MovedOutcome moveAll(ItemChange& change, const Url& directory)
{
    static constexpr Operation op{"-[NavController moveItemsToDirectory:toDirectory:]"};
    op.debug("MoveTarget = %@", directory);
    op.debug("ItemsToMove = %@", change.items());
    auto outcome = moveItems(change, directory);
    return {std::move(outcome.errors), undoOfMoves(outcome.moved)};
}

} // namespace

std::vector<Error> NavController::moveItemsToDirectoryToDirectory(
    const std::vector<Url>& items, const Url& directory)
{
    ItemChange change(AccountSession(), items);
    return moveAll(change, directory).errors;
}

void NavController::moveItemsToDirectoryAndShowErrorsToDirectory(
    const std::vector<Url>& items, const Url& directory)
{
    const AccountSession asked;
    const auto change = ItemChange::begin(
        asked, items, [directory](ItemChange& begun) { return moveAll(begun, directory); },
        weakly(this,
            [asked, expected = UndoHistory::expect(_undoHistory, asked)](
                NavController& self, const MovedOutcome& outcome) {
                self.changeEnded();
                if (!asked.isCurrent())
                    return;
                const auto& errors = outcome.errors;
                const auto top = self.topViewController();
                if (errors.size() == 1)
                    UIUtils::showFriendlyMoveErrorParentViewController(errors.front(), top);
                else if (!errors.empty())
                    UIUtils::showAlertMessageParentViewController(
                        localizedPlural(".DICT.CANNOT_MOVE_ITEMS.%d", {count(errors)}), {}, top);
                if (outcome.undo)
                    expected->add(*outcome.undo);
            }));
    changeBegun(change);
}

PreviewVerbs NavController::previewVerbs()
{
    return {
        .share = weakly(this,
            [](NavController& self, const Url& document) {
                self.showDICUrlCompletion(nullptr, document, {});
            }),
        .rename = weakly(this, &NavController::showRenamePrompt),
        .showInfo =
            weakly(this, [](NavController& self, const Url& document) { self.performInfo(document, {}); }),
        .moveToTrash =
            weakly(this, [](NavController& self, const Url& document) { self.moveItemsToTrash({document}); }),
    };
}

void NavController::showRenamePrompt(const Url& url)
{
    askForName(url, {});
}

void NavController::askForName(const Url& url, const Completion& completion)
{
    struct Facts {
        std::shared_ptr<DRItem> item;
        bool isSpecialFolder;
    };
    lookThen(
        [url] {
            return Facts{DRItem::initWithURL(url), trw_isDesktopOrDocumentsFolder(url)};
        },
        [url, completion](NavController& self, const Facts& facts) {
            if (facts.item)
                self.showNamePrompt(url, *facts.item, facts.isSpecialFolder);
            call(completion);
        },
        completion);
}

void NavController::showNamePrompt(const Url& url, const DRItem& item, bool isSpecialFolder)
{
    static constexpr Operation op{"-[NavController showRenamePrompt:]"};
    if (isSpecialFolder) {
        op.warning("Not renaming special folder: %@", url);
        UIUtils::showUnsupportedError(visibleViewController());
        return;
    }
    _folderPromptAlert = RenamePrompt::newWithFilenameCompletion(item.localizedName(),
        [weak = std::weak_ptr(self()), url, asked = AccountSession()](
            const std::string& name, bool&) -> std::string {
            if (name.empty() || !asked.isCurrent())
                return {};
            op.userAction("Rename entry confirmed (nav)");
            if (const auto browser = weak.lock())
                browser->renameConfirmed(url, name, asked);
            return {};
        });
    visibleViewController()->presentViewController(_folderPromptAlert->alert(), true);
}

void NavController::renameConfirmed(const Url& url, const std::string& name, const AccountSession& asked)
{
    const auto renamed = [prompt = _folderPromptAlert, name](
                             NavController& self, const std::optional<Error>& error) {
        self.changeEnded();
        if (isOnScreen(*prompt))
            prompt->answer(!error, messageAbout(error));
        else if (prompt->isWaiting() && error && !error->is(FileErrorCode::Cancelled))
            UIUtils::showFriendlyRenameErrorBasenameParentViewController(
                *error, name, self.topViewController());
    };
    const auto change =
        UIUtils::renameItemAtURLToNameCompletion(url, name, weakly(this, renamed), _undoHistory, asked);
    changeBegun(change);
    _folderPromptAlert->waitForAnswer([change] { change->cancel(); });
}

void NavController::showDICUrlCompletion(
    const std::shared_ptr<kit::View>& originatingView, const Url& url, const Completion& completion)
{
    static constexpr Operation op{"-[NavController showDIC:url:completion:]"};
    op.userAction("Show Share Sheet (nav)");
    op.info("showDIC: %@", url);
    _performActionCompletionBlock = completion;
    lookThen([url] { return LaunchUtils::sharedItemAt(url); },
        [url, originatingView](NavController& self, const LaunchUtils::SharedItem& shared) {
            if (shared.url != url)
                op.info("URL resolved to %@", shared.url);
            self.showSharingMenu(originatingView, shared);
        },
        {});
}

void NavController::showSharingMenu(
    const std::shared_ptr<kit::View>& originatingView, const LaunchUtils::SharedItem& shared)
{
    const auto anchor = originatingView ? originatingView : view();
    const auto bounds = anchor->bounds();
    const auto rect =
        originatingView ? platform::Rect{bounds.x, bounds.midY(), bounds.width, 0} : platform::Rect{};
    const auto sheet =
        screens::DocumentInteractionSheet::interactionControllerWithURLFacts(shared.url, shared.facts);
    sheet->setDelegate(self());
    _documentInteractionController = sheet;
    sheet->presentOptionsMenuFromRectInView(visibleViewController(), rect, anchor, true);
}

} // namespace tarrow
