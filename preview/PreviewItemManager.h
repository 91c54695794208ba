// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/AccountSession.h"
#include "kit/controllers/NavigationController.h"
#include "kit/controllers/ViewController.h"
#include "platform/Date.h"
#include "platform/FilePresenter.h"
#include "platform/LatestLook.h"
#include "platform/NotificationCenter.h"
#include "platform/Url.h"
#include "platform/Weakly.h"
#include "preview/PreviewMode.h"
#include "preview/PreviewVerbs.h"
#include "screens/list/DocumentListController.h"
#include "screens/move/MoveTargetPicker.h"

#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace platform {
struct UserActivity;
} // namespace platform
namespace screens {
class DocumentInteractionSheet;
}

namespace tarrow {

class DRItem;
class LookwellItemController;
class PreviewDetailsViewController;
class UndoHistory;

/// Coordinates the preview of one document: it chooses the screen and puts it on the browser's stack, follows
/// the changes of other programs, moves and deletes the document, and offers it to the account's other
/// devices while it is shown. Main thread, except for the presenter's calls. It is destroyed on the main
/// thread, whichever thread releases it.
class PreviewItemManager : public platform::FilePresenter,
                           public screens::MoveTargetPickerDelegate,
                           public std::enable_shared_from_this<PreviewItemManager> {
public:
    using Screen = std::shared_ptr<kit::ViewController>;
    using ListStack = std::vector<std::shared_ptr<screens::DocumentListController>>;

    static std::shared_ptr<PreviewItemManager> newItemManagerWithModeNavController(
        int mode, const std::shared_ptr<kit::NavigationController>& navigationController);
    /// Makes a manager without a navigation controller, which prepares screens but shows none.
    static std::shared_ptr<PreviewItemManager> init();

    PreviewItemManager();
    ~PreviewItemManager() override;

    /// May be called on any thread.
    std::shared_ptr<DRItem> item() const;
    int mode() const { return _mode; }
    void setMode(int mode) { _mode = mode; }
    std::shared_ptr<kit::NavigationController> navigationController() const
    {
        return _navigationController.lock();
    }
    void setNavigationController(std::weak_ptr<kit::NavigationController> navigationController);
    /// The share sheet that was opened last. It is held only to keep it alive while it is shown.
    const std::shared_ptr<screens::DocumentInteractionSheet>& documentInteractionController() const
    {
        return _documentInteractionController;
    }
    void setDocumentInteractionController(std::shared_ptr<screens::DocumentInteractionSheet> sheet);
    /// What the details' menu does with the item's content. Without a function the menu does not offer it.
    const screens::DownloadVerbs& downloadVerbs() const { return _downloadVerbs; }
    void setDownloadVerbs(screens::DownloadVerbs verbs) { _downloadVerbs = std::move(verbs); }
    /// What the quick preview's menu does with the item; nothing at first.
    const PreviewVerbs& previewVerbs() const { return _previewVerbs; }
    void setPreviewVerbs(PreviewVerbs verbs) { _previewVerbs = std::move(verbs); }
    /// The history that gets the item's changes; null: none does.
    std::shared_ptr<UndoHistory> undoHistory() const { return _undoHistory.lock(); }
    void setUndoHistory(std::weak_ptr<UndoHistory> history) { _undoHistory = std::move(history); }
    /// The queue on which the presenter is called.
    const std::shared_ptr<platform::OperationQueue>& fcQueue() const { return _fcQueue; }
    /// The content's modification date at the last look.
    const std::optional<platform::Date>& modifiedDate() const { return _modifiedDate; }
    bool refreshPending() const;
    /// Answers null unless a details screen is shown or about to be shown.
    const std::shared_ptr<PreviewDetailsViewController>& detailsViewController() const
    {
        return _detailsViewController;
    }

    /// Shows an item. Null only forgets the current one.
    void previewItem(const std::shared_ptr<DRItem>& item);
    void setItem(const std::shared_ptr<DRItem>& item);
    /// With an item and `updatePreview` the item's screen is prepared and shown; otherwise the item is only
    /// stored.
    void setItemUpdatePreview(const std::shared_ptr<DRItem>& item, bool updatePreview);
    /// Makes an item the current one and answers the screen that shows it, or null when there is nothing to
    /// show.
    Screen prepareToPreviewItem(const std::shared_ptr<DRItem>& item);
    std::shared_ptr<PreviewDetailsViewController> createDetailsViewController();
    std::shared_ptr<LookwellItemController> createLookwellController();
    std::shared_ptr<LookwellItemController> currentLookwellController() const;
    /// Shows a screen in place of the preview on top of the stack, else on top of the stack. A search that
    /// lies over the stack is dismissed first.
    void replaceLastViewController(const Screen& screen);
    bool isPreviewControllerDisplayed(const Screen& screen) const;
    /// A preview screen calls this when it disappears.
    void viewControllerWillDisappear(const kit::ViewController& screen);

    /// Answers the lists from the drive's top level to the folder of a URL, or nothing when the URL leads to
    /// no folder of the drive.
    static std::optional<ListStack> dlcStackForURL(const platform::Url& url);
    /// Answers the folders of those lists, with their titles. Any thread.
    static std::vector<screens::TitledFolder> foldersForURL(const platform::Url& url);
    /// Replaces the whole stack by the lists that lead to a URL and, for a document, its preview. Answers
    /// false, and changes nothing, when no lists lead there.
    bool warpToNewURL(const platform::Url& url);
    /// Reads the item again from a URL and updates the screen that shows it.
    void refreshItem(const platform::Url& url);

    // The preview screens call these. Files are changed off the main thread.
    void showWarningAndDeleteDocumentBarButton(
        const Screen& screen, const std::shared_ptr<kit::BarButtonItem>& button);
    void showMoveTarget(const Screen& screen);
    void documentTargetSelectionControllerDidSelectItemAtURL(
        const std::shared_ptr<screens::MoveTargetPicker>& picker, const platform::Url& folder) override;

    // The file presenter follows what others do to the item while it is registered. Any thread.
    bool filePresenterRegistered() const;
    void registerAsFilePresenter();
    void unregisterAsFilePresenter();
    std::optional<platform::Url> presentedItemURL() override;
    std::shared_ptr<platform::OperationQueue> presentedItemOperationQueue() override { return _fcQueue; }
    void presentedItemDidChange() override;
    void presentedItemDidMoveToURL(const platform::Url& newURL) override;
    void accommodatePresentedItemDeletionWithCompletionHandler(CompletionHandler completion) override;
    void accommodatePresentedSubitemDeletionAtURLCompletionHandler(
        const platform::Url& url, CompletionHandler completion) override;

    // These hand the document over to other devices. Registering happens on the main thread.
    std::shared_ptr<const platform::UserActivity> batonneActivity() const;
    void registerBatonneActivity();
    void registerBatonneActivityForBookmark(const std::string& bookmark);
    void unregisterBatonneActivity();

private:
    void observeApplication();
    void didBecomeActiveNotification();
    void willResignActiveNotification();
    std::optional<platform::Url> itemURL() const;
    void keepItem(const std::shared_ptr<DRItem>& item);
    void followTo(const platform::Url& url);
    /// Forgets the item, which is gone from where it was shown, and tells the user why.
    void leaveItem(const std::string& notice);
    void popPreview(const std::string& notice);
    void lookAgain();
    void refreshAfterSubitemDeletion();
    void clearRefreshPending();
    void refreshScreens(const std::shared_ptr<DRItem>& before, const DRItem& item, bool isNewer);
    void removeItem(const Screen& screen, const AccountSession& asked);
    /// Looks at the disk on another thread and goes on with what was found, unless a person has asked for
    /// something else since, has left the screen, or the screen shows another item now.
    template <typename Look, typename Then>
    void lookThen(const Screen& screen, Look look, Then then)
    {
        const auto stillShown = [screen, url = itemURL(), stack = stackOf(screen), then = std::move(then)](
                                    PreviewItemManager& self, const auto& found) {
            if (self.itemURL() == url && stackOf(screen) == stack)
                then(self, found);
        };
        _look->begin(std::move(look), platform::weakly(this, stillShown));
    }
    static std::shared_ptr<kit::NavigationController> stackOf(const Screen& screen);

    int _mode = PreviewModeQuick;
    std::shared_ptr<platform::OperationQueue> _fcQueue;
    std::optional<platform::Date> _modifiedDate;
    std::shared_ptr<PreviewDetailsViewController> _detailsViewController;
    std::shared_ptr<screens::DocumentInteractionSheet> _documentInteractionController;
    std::weak_ptr<kit::NavigationController> _navigationController;
    std::vector<platform::Observation> _observations;
    std::weak_ptr<UndoHistory> _undoHistory;
    const std::shared_ptr<platform::LatestLook> _look = std::make_shared<platform::LatestLook>();
    screens::DownloadVerbs _downloadVerbs;
    PreviewVerbs _previewVerbs;
    std::optional<AccountSession> _moveAsked; ///< who was asked last for the destination of a move
    std::optional<platform::Url> _movedTo; ///< where the user of this program has moved the item last

    mutable std::mutex _mutex; ///< guards the fields below
    std::shared_ptr<DRItem> _item;
    std::shared_ptr<const platform::UserActivity> _batonneActivity;
    bool _filePresenterRegistered = false;
    bool _refreshPending = false;
};

} // namespace tarrow
