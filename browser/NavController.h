// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/NavigationController.h"
#include "platform/Date.h"
#include "platform/NotificationCenter.h"
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
class UpgradeFlow;
}
namespace kit {
class BarButtonItem;
}

namespace tarrow {

class DRItem;
class FilenamePrompt;
class PreviewItemManager;

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

    // The edit mode's toolbar; null outside it.
    const std::shared_ptr<kit::BarButtonItem>& barButtonNewFolder() const
    {
        return _barButtonNewFolder;
    }
    const std::shared_ptr<kit::BarButtonItem>& barButtonMoveItem() const
    {
        return _barButtonMoveItem;
    }
    const std::shared_ptr<kit::BarButtonItem>& barButtonDeleteItem() const
    {
        return _barButtonDeleteItem;
    }
    /// Whether several items are being chosen; lists then neither open nor navigate.
    bool editMode() const { return _editMode; }
    /// Whether a list has reported its contents since the last set-up; the status line waits for that.
    bool pickerIsAlive() const { return _pickerIsAlive; }
    /// An enclosing split view, for its owner's use; null: none.
    Screen splitViewController() const { return _splitViewController.lock(); }
    void setSplitViewController(const Screen& screen) { _splitViewController = screen; }
    /// The title of the list that was configured last.
    const std::string& viewTitle() const { return _viewTitle; }
    /// When the free storage was heard of last; nothing before that.
    const std::optional<platform::Date>& lastQuotaFetch() const { return _lastQuotaFetch; }
    /// Null while the drive is not available.
    const std::shared_ptr<QuotaFetcher>& quotaFetcher() const { return _quotaFetcher; }
    /// The manager of the current preview; null while a folder list is on top.
    const std::shared_ptr<PreviewItemManager>& itemManager() const { return _itemManager; }
    /// The name prompt that was shown last.
    const std::shared_ptr<FilenamePrompt>& folderPromptAlert() const { return _folderPromptAlert; }
    /// The share sheet that was shown last.
    const std::shared_ptr<screens::DocumentInteractionSheet>&
    documentInteractionController() const
    {
        return _documentInteractionController;
    }
    /// The completion of the last list action that deletes or shares.
    const Completion& performActionCompletionBlock() const { return _performActionCompletionBlock; }
    /// The storage upgrade that was started last.
    const std::shared_ptr<screens::UpgradeFlow>& upgradeFlowMgr() const
    {
        return _upgradeFlowMgr;
    }
    /// Null: no offer.
    const std::shared_ptr<const platform::StorageOffer>& upgradeOffer() const { return _upgradeOffer; }
    /// Free storage in bytes; 0 while the drive is not available.
    std::uint64_t quotaBytes() const { return _quotaBytes; }

    // Set-up and account.
    void viewDidLoad() override;
    /// Shows the drive's top level, or that the drive is not available; whatever was shown before is gone.
    void setupInitialViewController();
    /// Whether somebody is signed in.
    bool checkTarrowState() const;
    /// Sets the browser up again when the account is not the one of the last time.
    void handleAccountChanges();
    /// Keeps the account's token for the next time; nothing: signed out.
    void saveTarrowToken(const std::optional<platform::PropertyValue>& token);
    void didBecomeActiveNotification();
    void tarrowAccountAvailabilityChanged();
    void offerChangedNotification();
    void upgradeStorageButtonPressed() override;
    void quotaFetcherDidUpdateValue(QuotaFetcher& fetcher, std::uint64_t freeBytes) override;
    /// Logs where the default container lies. For diagnosis; nothing calls it.
    void logContainerURL() const;

    // Lists and their status line.
    /// The screen on top when it is a folder list; else null.
    List getTopDocumentListController() const;
    /// Configures a list that is about to be shown.
    void initNewListController(const List& list);
    void configureNavBar(const List& list);
    void configureToolbar(const List& list);
    /// Brings the status line of a list (null: the one on top) up to date.
    void updateStatusUI(const List& list);
    /// The number of items and, once it is known, the free storage.
    std::string toolbarStatusText(std::size_t itemCount) const;
    std::string quotaAvailableString() const;
    bool okToShowQuota() const { return _lastQuotaFetch.has_value(); }

    // Edit mode: several items are chosen with check marks.
    using Sender = std::shared_ptr<kit::BarButtonItem>; ///< what was pressed; null: nothing
    void beginEditMode(const Sender& sender);
    void endEditMode(const Sender& sender);
    /// Selects everything that the list on top contains.
    void selectAllItems(const Sender& sender);
    /// The one place that changes the mode; a null list changes the browser alone.
    void setEditModeAndUpdateUIForViewController(bool editMode, const List& list);
    /// Configures the bars of the list on top for the mode.
    void configureVisibleControllerForMode();

    // Saved state: the previewed item and its preview mode.
    void encodeRestorableStateWithCoder(platform::StateCoder& coder) override;
    void decodeRestorableStateWithCoder(const platform::StateCoder& coder) override;

    // Navigation.
    void navigationControllerDidShowViewControllerAnimated(
        NavigationController&, const Screen& screen, bool animated) override;
    /// Replaces the whole stack by the way to an item of the drive and, for a document, its preview. False,
    /// and the stack stays, for no URL, one outside the drive's documents or in its trash, and one without a
    /// way to it.
    bool warpToNewURLPreviewMode(const std::optional<platform::Url>& url, int mode);
    /// Replaces the whole stack by the lists that lead to a folder; false, and it stays, when none do.
    bool warpToFolderForURL(const platform::Url& url);
    /// Shows an item in a preview; null does nothing.
    void showPreviewPreviewMode(const std::shared_ptr<DRItem>& item, int mode);
    /// Goes back to the top level and opens its search field with a query.
    void startSearch(const std::string& query);
    /// Opens the item of a peek.
    void knopPopToURL(const platform::Url& url);

    // What a folder list reports.
    void documentListControllerDidSelectContainerWithViewController(
        const List& list, const List& container) override;
    void documentListControllerDidSelectItemAtURL(const List& list, const platform::Url& url) override;
    void documentListControllerItemsChanged(const List& list) override;
    void documentListControllerURLWasRemoved(const List& list) override;
    void documentListControllerRequestsEditing(const List& list) override;
    Screen documentListControllerViewControllerForPreviewingItemAtURL(
        const List& list, const platform::Url& url) override;
    void documentListControllerPerformActionURLOriginatingViewCompletion(const List& list, int action,
        const platform::Url& url, const std::shared_ptr<kit::View>& originatingView,
        const Completion& completion) override;
    void documentListControllerPerformActionURL(
        const List& list, int action, const platform::Url& url) override;
    std::vector<platform::Color> documentListControllerColorsForTagNames(
        const List& list, const std::vector<std::string>& names) override;

    // Item actions. The file operations block until they are done.
    /// Asks for the name of a new folder in the folder of the list on top.
    void promtForNewFolderAndCreate(const Sender& sender);
    /// Asks for the name of a new folder, and moves items into it once it is made.
    void showNewFolderPromptDuringMoveItemsToMove(
        const std::optional<platform::Url>& folder, const std::vector<platform::Url>& items);
    /// Asks where the selected items of the list on top shall go.
    void showMoveTargetForSelectedItems(const Sender& sender);
    /// Asks where items of a folder shall go, or, when there is no other folder, for the name of a new one.
    void showMoveTargetForItemsInFolder(
        const std::vector<platform::Url>& items, const std::optional<platform::Url>& folder);
    void documentTargetSelectionControllerDidSelectItemAtURL(
        const std::shared_ptr<screens::MoveTargetPicker>& picker,
        const platform::Url& folder) override;
    /// Shows what can be done with an item outside the drive, at a view or, without one, at the browser's.
    void showDICUrlCompletion(const std::shared_ptr<kit::View>& view, const platform::Url& url,
        const Completion& completion);
    /// Asks for an item's new name.
    void showRenamePrompt(const platform::Url& url);
    /// Moves items into a folder, one after the other; answers the errors of those that stayed.
    std::vector<platform::Error> moveItemsToDirectoryToDirectory(
        const std::vector<platform::Url>& items, const platform::Url& directory);
    /// The same, and tells the user what stayed.
    void moveItemsToDirectoryAndShowErrorsToDirectory(
        const std::vector<platform::Url>& items, const platform::Url& directory);
    /// Asks before the selected items of the list on top are deleted.
    void showWarningAndDeleteDocument(const Sender& sender);
    /// Asks before items (documents and folders, or app libraries) are deleted, at a view or at the toolbar's
    /// button. The finisher (may be empty) is called once, after the answer or a refusal.
    void showWarningAndDeleteURLsUsingViewWithDocumentListControllerFinishedCompletion(
        const std::vector<platform::Url>& urls, const std::shared_ptr<kit::View>& view,
        const List& list, const Completion& finished);

private:
    std::shared_ptr<NavController> self();
    void setupDrive();
    void setupUnavailableScreen();
    void observeAccount();
    std::optional<platform::PropertyValue> storedToken() const;
    void fetchQuotaAfter(int seconds);
    void replaceItemManager(int mode);
    void dropItemManager();
    void dismissPresentedScreen();
    bool isSearchPresented() const;
    void showVanishedItem(const platform::Url& url);
    void openFolder(const platform::Url& url, const platform::Operation& op);
    void openDocument(const std::shared_ptr<DRItem>& item, const platform::Operation& op);
    void performDelete(const platform::Url& url, const std::shared_ptr<kit::View>& view,
        const Completion& completion);
    void performInfo(const platform::Url& url);
    void deleteConfirmed(const std::vector<platform::Url>& urls, const Completion& finished);

    Sender makeToolbarButton(const std::string& title, void (NavController::*operation)(const Sender&));
    void configureEditToolbar(const List& list);

    std::shared_ptr<kit::BarButtonItem> _barButtonNewFolder, _barButtonMoveItem,
        _barButtonDeleteItem;
    std::shared_ptr<screens::DocumentInteractionSheet> _documentInteractionController;
    bool _editMode = false;
    bool _pickerIsAlive = false;
    std::weak_ptr<kit::ViewController> _splitViewController;
    std::string _viewTitle;
    std::optional<platform::Date> _lastQuotaFetch;
    std::shared_ptr<QuotaFetcher> _quotaFetcher;
    std::shared_ptr<PreviewItemManager> _itemManager;
    std::shared_ptr<FilenamePrompt> _folderPromptAlert;
    Completion _performActionCompletionBlock;
    std::shared_ptr<screens::UpgradeFlow> _upgradeFlowMgr;
    std::shared_ptr<const platform::StorageOffer> _upgradeOffer;
    std::uint64_t _quotaBytes = 0;
    std::vector<platform::Observation> _observations;
};

} // namespace tarrow
