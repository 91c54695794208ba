// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "browser/RecentDocument.h"
#include "items/AccountSession.h"
#include "items/LaunchUtils.h"
#include "kit/controllers/NavigationController.h"
#include "platform/Date.h"
#include "platform/NotificationCenter.h"
#include "platform/Weakly.h"
#include "preview/PreviewVerbs.h"
#include "prompts/DocumentListControllerStatusBar.h"
#include "prompts/QuotaFetcher.h"
#include "screens/DocumentInteractionSheet.h"
#include "screens/list/DocumentListControllerDelegate.h"
#include "screens/move/MoveTargetPicker.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace platform {
class Operation;
class PropertyValue;
} // namespace platform
namespace screens {
class DrivePlaces;
class UpgradeFlow;
struct DownloadVerbs;
} // namespace screens
namespace kit {
class BarButtonItem;
}

namespace tarrow {

class DRItem;
class FilenamePrompt;
class PreviewItemManager;
class ItemChange;
class Downloads;
class DownloadsScreen;
class RunningChanges;
struct FoundDocuments;
struct RemovedDownloads;
class TrashScreen;
struct TrashingOutcome;
struct AddingOutcome;
class UndoHistory;
struct UndoEntry;
struct UndoOutcome;

/// The progress that stands under a list, and what its Cancel button does.
struct ShownProgress {
    std::string text;
    std::function<void()> cancel;
};

/// The browser: a stack of the drive's folder lists with a preview on top of them, or the screen that says
/// that the drive is not available. It follows the cloud account and keeps the line under each list up to
/// date. Made with std::make_shared. Main thread only.
class NavController : public kit::NavigationController,
                      public kit::NavigationControllerDelegate,
                      public screens::DocumentListControllerDelegate,
                      public screens::MoveTargetPickerDelegate,
                      public screens::DocumentInteractionSheetDelegate,
                      public QuotaFetcherDelegate,
                      public DocumentListControllerStatusBarDelegate {
public:
    using Screen = std::shared_ptr<kit::ViewController>;

    ~NavController() override;

    // These are the items of the edit mode's toolbar; they are null outside edit mode.
    const std::shared_ptr<kit::BarButtonItem>& barButtonNewFolder() const { return _barButtonNewFolder; }
    const std::shared_ptr<kit::BarButtonItem>& barButtonMoveItem() const { return _barButtonMoveItem; }
    const std::shared_ptr<kit::BarButtonItem>& barButtonDeleteItem() const { return _barButtonDeleteItem; }
    /// Answers whether the user is selecting several items. Lists then neither open items nor navigate.
    bool editMode() const { return _editMode; }
    /// Answers whether a list has reported its contents since the last set-up. The status line waits for
    /// that.
    bool pickerIsAlive() const { return _pickerIsAlive; }
    /// An enclosing split view, for its owner's use, or null.
    Screen splitViewController() const { return _splitViewController.lock(); }
    void setSplitViewController(const Screen& screen) { _splitViewController = screen; }
    /// The title of the list that was configured last.
    const std::string& viewTitle() const { return _viewTitle; }
    /// The time of the last value of the free storage; absent before the first.
    const std::optional<platform::Date>& lastQuotaFetch() const { return _lastQuotaFetch; }
    /// Answers null while the drive is not available.
    const std::shared_ptr<QuotaFetcher>& quotaFetcher() const { return _quotaFetcher; }
    /// The manager of the current preview; null while a folder list is on top.
    const std::shared_ptr<PreviewItemManager>& itemManager() const { return _itemManager; }
    /// The name prompt that was shown last.
    const std::shared_ptr<FilenamePrompt>& folderPromptAlert() const { return _folderPromptAlert; }
    /// The share sheet that was shown last.
    const std::shared_ptr<screens::DocumentInteractionSheet>& documentInteractionController() const
    {
        return _documentInteractionController;
    }
    /// The completion of the last list action that deletes or shares.
    const Completion& performActionCompletionBlock() const { return _performActionCompletionBlock; }
    /// The storage upgrade that was started last.
    const std::shared_ptr<screens::UpgradeFlow>& upgradeFlowMgr() const { return _upgradeFlowMgr; }
    /// Answers null when there is no offer.
    const std::shared_ptr<const platform::StorageOffer>& upgradeOffer() const { return _upgradeOffer; }
    /// Free storage in bytes; 0 while the drive is not available.
    std::uint64_t quotaBytes() const { return _quotaBytes; }

    // The set-up and the account.
    void viewDidLoad() override;
    /// Shows the drive's top level, or the screen that says that the drive is not available, in place of the
    /// whole stack.
    void setupInitialViewController();
    /// Answers whether somebody is signed in.
    bool checkTarrowState() const;
    /// Sets the browser up again when the account is not the one of the last run.
    void handleAccountChanges();
    /// Saves the account's token for the next run; nothing means signed out.
    void saveTarrowToken(const std::optional<platform::PropertyValue>& token);
    void didBecomeActiveNotification();
    void tarrowAccountAvailabilityChanged();
    void offerChangedNotification();
    void upgradeStorageButtonPressed() override;
    void quotaFetcherDidUpdateValue(QuotaFetcher& fetcher, std::uint64_t freeBytes) override;
    /// Logs the location of the default container. It serves diagnosis; nothing calls it.
    void logContainerURL() const;

    // Folder lists and their status line.
    /// Answers the screen on top when it is a folder list, else null.
    List getTopDocumentListController() const;
    /// Configures a list that is about to be shown.
    void initNewListController(const List& list);
    void configureNavBar(const List& list);
    void configureToolbar(const List& list);
    /// Brings the status line of a list (null: the one on top) up to date.
    void updateStatusUI(const List& list);
    void driveIsPutRight();
    /// Answers a text with the number of items and, once it is known, the free storage; in their place that
    /// the drive is put right, while it is.
    std::string toolbarStatusText(std::size_t itemCount) const;
    std::string quotaAvailableString() const;
    bool okToShowQuota() const { return _lastQuotaFetch.has_value(); }

    /// The changes that the user can undo.
    const std::shared_ptr<UndoHistory>& undoHistory() const { return _undoHistory; }
    /// Undoes the latest change while a list or an item's details are on top.
    bool undoRequested() override;

    /// What is dropped on a list or pasted is copied into its folder.
    bool takesFiles() const override;
    bool filesOffered(const std::vector<platform::Url>& files) override;

    /// Holds what is being downloaded.
    const std::shared_ptr<Downloads>& downloads() const { return _downloads; }

    // In edit mode the user selects several items with check marks.
    using Sender = std::shared_ptr<kit::BarButtonItem>; ///< the button that was pressed; null: none
    void beginEditMode(const Sender& sender);
    void endEditMode(const Sender& sender);
    /// Selects everything that the list on top contains.
    void selectAllItems(const Sender& sender);
    /// Every change of the mode goes through here. With a null list only the browser changes.
    void setEditModeAndUpdateUIForViewController(bool editMode, const List& list);
    /// Configures the bars of the list on top for the mode.
    void configureVisibleControllerForMode();

    // The saved state is the previewed item and its preview mode.
    void encodeRestorableStateWithCoder(platform::StateCoder& coder) override;
    void decodeRestorableStateWithCoder(const platform::StateCoder& coder) override;

    // Navigation.
    void navigationControllerDidShowViewControllerAnimated(
        NavigationController&, const Screen& screen, bool animated) override;
    /// Replaces the whole stack by the lists that lead to an item of the drive and, for a document, its
    /// preview. Answers false, and keeps the stack, without a URL, for one outside the drive's documents or
    /// in its trash, and for one to which no lists lead.
    bool warpToNewURLPreviewMode(const std::optional<platform::Url>& url, int mode);
    /// Replaces the whole stack by the lists that lead to a folder. Answers false, and keeps the stack, when
    /// none do.
    bool warpToFolderForURL(const platform::Url& url);
    /// Shows an item in a preview; null does nothing.
    void showPreviewPreviewMode(const std::shared_ptr<DRItem>& item, int mode);
    /// Goes back to the top level, ends the choice of items and opens the search field with a query.
    void startSearch(const std::string& query);
    /// Opens the item of a peek.
    void knopPopToURL(const platform::Url& url);

    // The folder lists report these events.
    void documentListControllerDidSelectContainerWithViewController(
        const List& list, const List& container) override;
    void documentListControllerDidSelectItemAtURL(const List& list, const platform::Url& url) override;
    void documentListControllerItemsChanged(const List& list) override;
    void documentListControllerURLWasRemoved(const List& list) override;
    void documentListControllerRequestsEditing(const List& list) override;
    void documentListControllerPrepareToPreviewItemAtURL(
        const List& list, const platform::Url& url, const Completion& ready) override;
    Screen documentListControllerViewControllerForPreviewingItemAtURL(
        const List& list, const platform::Url& url) override;
    void documentListControllerPeekDidEnd(const List& list) override;
    void documentListControllerPerformActionURLOriginatingViewCompletion(const List& list, int action,
        const platform::Url& url, const std::shared_ptr<kit::View>& originatingView,
        const Completion& completion) override;
    void documentListControllerPerformActionURL(
        const List& list, int action, const platform::Url& url) override;
    std::vector<kit::TagDot> documentListControllerDotsForTagNames(
        const List& list, const std::vector<std::string>& names) override;

    // These act on items. Every change runs on the queue that all changes share, see ItemChange.
    /// Lets the user choose files, and copies them into the folder of the list on top.
    void chooseFilesToAdd();
    /// Copies items from anywhere on this machine into the folder of the list on top.
    void addItems(const std::vector<platform::Url>& items);
    /// Puts items on the clipboard, for other programs. What is in the cloud cannot be copied, and the user
    /// is told.
    void copyItems(const std::vector<platform::Url>& items);
    /// Asks for the name of a new folder in the folder of the list on top.
    void promtForNewFolderAndCreate(const Sender& sender);
    /// Asks for the name of a new folder, creates it and moves items into it.
    void showNewFolderPromptDuringMoveItemsToMove(
        const std::optional<platform::Url>& folder, const std::vector<platform::Url>& items);
    /// Asks for the destination of the selected items of the list on top.
    void showMoveTargetForSelectedItems(const Sender& sender);
    /// Asks for the destination of a folder's items or, when there is no other folder, for the name of a new
    /// one.
    void showMoveTargetForItemsInFolder(
        const std::vector<platform::Url>& items, const std::optional<platform::Url>& folder);
    void documentTargetSelectionControllerDidSelectItemAtURL(
        const std::shared_ptr<screens::MoveTargetPicker>& picker, const platform::Url& folder) override;
    /// Shows the share sheet of an item at a view or, without a view, at the browser's own.
    void showDICUrlCompletion(
        const std::shared_ptr<kit::View>& view, const platform::Url& url, const Completion& completion);
    PreviewVerbs previewVerbs();
    /// Asks for an item's new name.
    void showRenamePrompt(const platform::Url& url);
    /// Moves items into a folder one after the other, and answers the errors of those that could not be
    /// moved. This one blocks until they are moved.
    std::vector<platform::Error> moveItemsToDirectoryToDirectory(
        const std::vector<platform::Url>& items, const platform::Url& directory);
    /// Begins to move items into a folder like the operation above, and shows the user in the end which could
    /// not be moved.
    void moveItemsToDirectoryAndShowErrorsToDirectory(
        const std::vector<platform::Url>& items, const platform::Url& directory);
    /// Moves items to the trash, which can be undone.
    void moveItemsToTrash(const std::vector<platform::Url>& items);
    /// Shows what is in the trash.
    void showTrash();
    /// Asks before the selected items of the list on top are deleted.
    void showWarningAndDeleteDocument(const Sender& sender);
    /// Asks before items (documents and folders, or app libraries) are deleted; the sheet points at a view or
    /// at the toolbar's button. The finisher (may be empty) is called once, after the answer or a refusal.
    void showWarningAndDeleteURLsUsingViewWithDocumentListControllerFinishedCompletion(
        const std::vector<platform::Url>& urls, const std::shared_ptr<kit::View>& view, const List& list,
        const Completion& finished);

private:
    std::shared_ptr<NavController> self();
    void setupDrive();
    void setupUnavailableScreen();
    void observeAccount();
    std::optional<platform::PropertyValue> storedToken() const;
    void compareAccount(const std::optional<platform::PropertyValue>& token);
    void fetchQuotaAfter(int seconds);
    void replaceItemManager(int mode);
    void dropItemManager();
    /// Takes away every screen that lies over the stack (prompts, questions, pickers, peeks, the search).
    /// None of them is answered.
    void endEverythingPresented();
    /// Tells the user of something that needs no answer.
    void tell(const std::string& notice) const;
    bool isSearchPresented() const;
    void endChoiceOfItems();
    void showVanishedItem(const platform::Url& url);
    void pushList(const List& list);
    struct PickedItem;
    void openFolder(const PickedItem& picked, const platform::Operation& op);
    static PickedItem lookAtPicked(const platform::Url& url, bool followsLinks);
    /// Opens what a peek showed, and puts the peek's preview on the stack. In a search a document's folder is
    /// shown below it.
    void openPopped(const platform::Url& url, const PickedItem& popped, bool isFromSearch);
    void pushPeekedPreview(const PickedItem& popped, bool isFromSearch);
    /// Drops the manager of a peek that has ended, unless its preview is on the stack or about to be.
    void dropPeek();
    struct PeekedItem;
    static PeekedItem lookAtPeeked(const platform::Url& url);
    void openPicked(const platform::Url& url, const PickedItem& picked);
    void openDocument(const std::shared_ptr<DRItem>& item, const LaunchUtils::DocumentFacts& facts,
        const platform::Operation& op);
    void performDelete(
        const platform::Url& url, const std::shared_ptr<kit::View>& view, const Completion& completion);
    void showSharingMenu(
        const std::shared_ptr<kit::View>& originatingView, const LaunchUtils::SharedItem& shared);
    void performInfo(const platform::Url& url, const Completion& completion);
    void editTagsOfItems(const std::vector<platform::Url>& items);
    /// Looks at the disk on another thread and goes on with what was found, unless a person has asked for
    /// something else since or has left the screen. `dropped` is called in that case.
    template <typename Look, typename Then>
    void lookThen(Look look, Then then, const Completion& dropped);
    static void call(const Completion& completion);
    /// The facts that the program needs before it moves items.
    struct MoveFacts {
        bool holdsSpecialFolder = false, mayLeaveContainer = false, hasOtherFolder = true;
        std::shared_ptr<const screens::DrivePlaces> places{};
    };
    void askForTarget(const std::vector<platform::Url>& items, const std::optional<platform::Url>& folder,
        const Completion& completion);
    void showMoveTarget(const std::vector<platform::Url>& items, const std::optional<platform::Url>& folder,
        const MoveFacts& facts);
    void askForName(const platform::Url& url, const Completion& completion);
    void showNamePrompt(const platform::Url& url, const DRItem& item, bool isSpecialFolder);
    void askBeforeDeletion(const std::optional<std::string>& message, const std::vector<platform::Url>& urls,
        const std::shared_ptr<kit::View>& view, const List& list, const Completion& finished);
    /// Dims the rows of a change's items and shows its progress from now on.
    void changeBegun(const std::shared_ptr<ItemChange>& change);
    /// Some change has ended.
    void changeEnded();
    /// Shows in a list what is being changed and how far it has come.
    void showRunningChanges(const List& list);
    void showProgress(const List& list);
    void showInLists(void (NavController::*show)(const List&));
    void addItemsTo(const List& list, const std::vector<platform::Url>& items, const AccountSession& asked);
    void copyFound(const std::vector<platform::Url>& items, const FoundDocuments& inCloud);
    void addingEnded(const AddingOutcome& outcome);
    void makeFolderForItems(
        const platform::Url& folder, const std::vector<platform::Url>& items, const AccountSession& asked);
    void renameConfirmed(const platform::Url& url, const std::string& name, const AccountSession& asked);
    void deleteConfirmed(
        const std::vector<platform::Url>& urls, const Completion& finished, const AccountSession& asked);

    void beginDownloads();
    screens::DownloadVerbs downloadVerbs();
    void downloadItems(const std::vector<platform::Url>& items);
    void downloadFound(const FoundDocuments& found);
    void removeDownloadsOfItems(const std::vector<platform::Url>& items);
    void downloadsRemoved(const RemovedDownloads& outcome);
    void showDownloads();
    void downloadsChanged();
    void downloadsEnded(std::size_t arrived, const std::vector<platform::Error>& errors);
    /// Answers nothing while there is none, or only a short one.
    std::optional<ShownProgress> progressOfDownloads() const;
    void showProgressInLists() { showInLists(&NavController::showProgress); }
    void beginToTrash(const std::vector<platform::Url>& items);
    void trashingEnded(const TrashingOutcome& outcome);
    void removeOldTrash();
    void countTrash();
    void trashWasCounted(std::size_t count);
    void showTrashButton(const List& list);

    void beginUndoHistory();
    void offerUndo(std::uint64_t number, const UndoEntry& entry);
    void undoEnded(const UndoEntry& entry, const UndoOutcome& outcome);

    Sender makeToolbarButton(const std::string& title, void (NavController::*operation)(const Sender&));
    void configureEditToolbar(const List& list);
    void placeBecameKnown(const std::weak_ptr<screens::DocumentListController>& known);
    void enableNewFolder(const screens::DocumentListController& list) const;

    std::shared_ptr<kit::BarButtonItem> _barButtonNewFolder, _barButtonMoveItem, _barButtonDeleteItem;
    std::shared_ptr<screens::DocumentInteractionSheet> _documentInteractionController;
    bool _editMode = false;
    bool _pickerIsAlive = false;
    std::weak_ptr<kit::ViewController> _splitViewController;
    std::string _viewTitle;
    std::optional<platform::Date> _lastQuotaFetch;
    std::shared_ptr<QuotaFetcher> _quotaFetcher;
    std::shared_ptr<PreviewItemManager> _itemManager;
    std::weak_ptr<PreviewItemManager> _peekManager; ///< the manager of the latest peek
    bool _isPopping = false; ///< the item of the latest peek is being looked at, to be opened
    std::shared_ptr<PeekedItem> _peekedItem; ///< looked up for a peek that is about to be shown; null: none
    std::shared_ptr<FilenamePrompt> _folderPromptAlert;
    Completion _performActionCompletionBlock;
    std::shared_ptr<screens::UpgradeFlow> _upgradeFlowMgr;
    std::shared_ptr<const platform::StorageOffer> _upgradeOffer;
    std::uint64_t _quotaBytes = 0;
    RecentDocument _recentDocument;
    std::optional<AccountSession> _moveAsked; ///< who was asked last for the destination of a move
    const std::shared_ptr<platform::LatestLook> _look = std::make_shared<platform::LatestLook>();
    std::shared_ptr<RunningChanges> _runningChanges; ///< null before the first change
    std::shared_ptr<UndoHistory> _undoHistory;
    std::shared_ptr<Downloads> _downloads;
    std::weak_ptr<DownloadsScreen> _downloadsScreen; ///< the one that was shown last
    std::optional<platform::Date> _downloadsSince; ///< when the ones that run began
    std::weak_ptr<TrashScreen> _trashScreen; ///< the one that was shown last
    std::size_t _trashCount = 0;
    std::vector<platform::Observation> _observations;
};

template <typename Look, typename Then>
void NavController::lookThen(Look look, Then then, const Completion& dropped)
{
    const auto top = std::weak_ptr(topViewController());
    const auto found = [then = std::move(then), top, dropped](NavController& self, const auto& facts) {
        if (self.topViewController() == top.lock())
            then(self, facts);
        else if (dropped)
            dropped();
    };
    _look->begin(std::move(look), platform::weakly(this, found), dropped);
}

} // namespace tarrow
