// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/ViewController.h"
#include "kit/views/ListViewDelegate.h"
#include "platform/Date.h"
#include "platform/Error.h"
#include "platform/FolderSnapshot.h"
#include "platform/Url.h"
#include "screens/FolderPlaces.h"
#include "screens/PlatformNames.h"
#include "screens/list/DocumentListAction.h"
#include "screens/list/DocumentListControllerDelegate.h"
#include "screens/list/DownloadVerbs.h"
#include "screens/list/ListOrder.h"

#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace platform {
class FolderListing;
}
namespace kit {
class AlertController;
class ListView;
} // namespace kit

namespace screens {

class DocumentRowSource;
class DocumentRows;
class DocumentSearch;
class FolderContents;
class PlaceholderView;
struct FolderContentsUpdate;

/// The screen that shows one folder of the drive. It begins to list the folder when its view is loaded, and
/// follows every change from then on. Main thread only; slow work runs on other threads.
class DocumentListController : public kit::ViewController, private kit::ListViewDelegate {
public:
    /// Answers the list of the drive's top level, which shows the app libraries as well, or null when there
    /// is no default container because nobody is signed in.
    static std::shared_ptr<DocumentListController> createRootList();
    /// Reads the folder's name for the title.
    static std::shared_ptr<DocumentListController> initWithURL(const Url& url);
    /// Looks at nothing, for a folder whose name is known.
    static std::shared_ptr<DocumentListController> initWithURLTitle(const Url& url, const std::string& title);
    /// Answers a new list for each folder from the drive's top level down to the given one, in this order.
    /// Answers nothing when the folder lies neither in the default container nor in an app library.
    static std::vector<std::shared_ptr<DocumentListController>> hierarchyForURL(const Url& url);
    /// Answers a new list for each of these folders, and looks at nothing.
    static std::vector<std::shared_ptr<DocumentListController>> listsOf(
        const std::vector<TitledFolder>& folders);

    /// Derived classes call this. Without a folder the list stays empty.
    explicit DocumentListController(std::optional<Url> folder);
    DocumentListController(Url folder, const std::string& title);
    ~DocumentListController() override;

    void setDelegate(std::weak_ptr<DocumentListControllerDelegate> delegate);
    std::shared_ptr<DocumentListControllerDelegate> delegate() const { return _delegate.lock(); }

    const std::optional<Url>& presentedURL() const { return _presentedURL; }
    /// Answers the URLs of all items. Making 100,000 URLs is expensive; use `containedItemCount` where the
    /// number is enough.
    std::vector<Url> containedItems() const;
    /// Answers the number of items listed so far.
    std::size_t containedItemCount() const;

    /// Answers the URLs of the selected items in the order of the list.
    std::vector<Url> selectedItems() const;
    std::size_t selectedItemCount() const;
    /// Answers whether a folder (packages aside) or a library is among them, as far as the listing knows.
    bool selectionHoldsFolder() const;
    /// Selects items. URLs that are not items of the list are ignored. Only an editing list selects.
    void setSelectedItems(const std::vector<Url>& items);

    /// Selects every item without making URLs, and tells the delegate.
    void selectAllItems();
    void deselectAllItems();

    bool editing() const { return _editing; }
    /// While the list is editing, taps toggle check marks and nothing is opened. Leaving editing clears the
    /// selection.
    void setEditingAnimated(bool editing, bool animated);

    /// The actions that an item's menu offers. There are none at first.
    DocumentListActionSet availableActions() const { return _availableActions; }
    void setAvailableActions(DocumentListActionSet actions);
    /// The menus of an item and of the selected items offer to change their tags, and call this function with
    /// these items. Without a function they do not.
    using EditTags = std::function<void(const std::vector<Url>& items)>;
    void setEditTags(EditTags editTags) { _editTags = std::move(editTags); }
    /// The menus and Ctrl+C offer to copy an item or the selected items, and call this function with them.
    using CopyItems = std::function<void(const std::vector<Url>& items)>;
    void setCopyItems(CopyItems copyItems) { _copyItems = std::move(copyItems); }
    /// What the menus and keys offer to do with the trash. What has no function is not offered.
    struct TrashVerbs {
        std::function<void(const std::vector<Url>& items)> moveToTrash;
        std::function<void()> show; ///< shows what is in the trash
    };
    void setTrashVerbs(TrashVerbs verbs) { _trashVerbs = std::move(verbs); }

    /// What can be done in the list's folder, such as to make a folder. The list's menu and an empty list
    /// offer it while `isPossible` answers true.
    struct FolderVerb {
        std::string title;
        std::function<bool()> isPossible;
        std::function<void()> run;
    };
    void setFolderVerbs(std::vector<FolderVerb> verbs) { _folderVerbs = std::move(verbs); }
    /// Tells the list that `isPossible` may answer something else now.
    void folderVerbsMayHaveChanged();
    /// Says which actions would be refused for an item, so that its menu leaves them out. The function looks
    /// at no disk. The keys still lead to the refusal, which says why.
    using RefusedActions = std::function<DocumentListActionSet(const Url& item)>;
    void setRefusedActions(RefusedActions refused) { _refusedActions = std::move(refused); }

    /// What the menus offer to do with the contents of items; nothing at first.
    void setDownloadVerbs(DownloadVerbs verbs) { _downloadVerbs = std::move(verbs); }

    /// Presents the search field with a query over the list. With `becomeFirstResponder` the field takes the
    /// keyboard focus. The search looks through the names of the whole drive.
    void startSearchWithQueryStringBecomeFirstResponder(const std::string& query, bool becomeFirstResponder);
    /// Answers whether the list offers a search field of its own.
    virtual bool shouldShowSearch() const { return true; }

    /// Dims the rows of items that are being changed, in place of the ones before. Items of other folders are
    /// ignored.
    void setChangingItems(std::vector<Url> items);

    /// Runs an action that opens a document outside the program, after the questions that must be asked
    /// first. There are none here, so the action runs at once.
    static void openOutOfDriveViewControllerAction(const Url& document,
        const std::shared_ptr<kit::ViewController>& viewController, const std::function<void()>& action);

    /// Lists the folder again.
    void refresh();
    /// Scrolls to an item that the user has just made or renamed and gives its row the keyboard, as soon as
    /// the list has it. An item that does not come within some seconds is forgotten, and so is the one
    /// before. Items of other folders are ignored.
    void reveal(const Url& item);

    /// The order of the items. When the view is loaded it becomes the user's choice for this folder.
    const ListOrder& order() const { return _order; }
    /// Shows the items in another order and saves that order for the folder.
    void setOrder(const ListOrder& order);
    /// Answers the menu of orders and, while the list is editing, of selections.
    kit::Menu optionsMenu();
    void addTagsEntry(kit::Menu& menu, std::vector<Url> items) const;
    void addTrashEntry(kit::Menu& menu, std::vector<Url> items) const;
    void addCopyEntry(kit::Menu& menu, std::vector<Url> items) const;

    /// Other classes attach objects to the list, which keeps them as long as it lives; null removes one. Ask
    /// with the type with which the object was attached, because the type is not checked.
    void setAssociatedObject(const std::string& key, std::shared_ptr<void> object);
    template <typename T>
    std::shared_ptr<T> associatedObject(const std::string& key) const
    {
        const auto found = _associatedObjects.find(key);
        return found == _associatedObjects.end() ? nullptr : std::static_pointer_cast<T>(found->second);
    }

    void loadView() override;
    void viewDidLoad() override;
    void viewDidAppear(bool animated) override;

    /// The parts of the loaded view.
    const std::shared_ptr<kit::ListView>& listView() const { return _listView; }
    const std::shared_ptr<PlaceholderView>& placeholder() const { return _placeholder; }

private:
    void rowActivated(kit::ListView& list, std::size_t index) override;
    kit::Menu menuForRow(kit::ListView& list, std::size_t index) override;
    kit::Menu menuForList(kit::ListView&) override { return optionsMenu(); }
    void visibleRowsDidChange(kit::ListView& list, kit::RowRange range) override;
    void selectionDidChange(kit::ListView& list) override;
    void refreshRequested(kit::ListView& list) override;
    bool rowCommand(kit::ListView& list, std::size_t index, kit::RowCommand command) override;
    std::vector<Url> filesToDrag(kit::ListView& list, std::size_t index) override;
    bool rowHeld(kit::ListView& list, std::size_t index) override;
    void heldRowPressedOn(kit::ListView& list) override;
    void selectionRequested(kit::ListView& list) override;

    std::shared_ptr<DocumentListController> self();
    void contentsDidChange(const FolderContentsUpdate& update);
    void showStateOfFolder();
    void revealAwaited();
    std::vector<FolderVerb> possibleVerbs() const;
    void offerSearch();
    /// Takes the keyboard focus once for each appearance, as soon as there are rows.
    void takeKeyboard();
    void followLibraries();
    void librariesMayHaveChanged();
    std::vector<kit::TagDot> dotsForTags(const std::vector<std::string>& names);
    void showLoadingAfterDelay();
    void reportRemovalIfShown();
    void open(const Url& url, FolderEntryKind kind);
    void openFolder(const std::shared_ptr<DocumentListController>& folder);
    void perform(DocumentListAction action, const Url& url);
    void actionEnded(std::size_t number);
    void dimBusyRows();
    std::vector<RowItem> selectedRowItems() const;
    /// Answers the place of an item's row for a popover, or the list itself when the row is not visible.
    std::shared_ptr<kit::View> anchorFor(const Url& url);
    std::optional<RowItem> itemAt(std::size_t index) const;
    // These act on an item of the folder or of the search's results.
    kit::Menu menuFor(const RowItem& item);
    bool obey(kit::RowCommand command, const RowItem& item);
    bool moveToTrash(const RowItem& item);
    bool copy(const RowItem& item);
    /// Answers the selected items when this one is among them, else this one.
    std::vector<Url> meantBy(const RowItem& item) const;
    bool peekAt(const RowItem& item);
    bool showPeekAt(const RowItem& item);
    void peekEnded();
    /// Answers the latest peek while it is shown, else null.
    std::shared_ptr<kit::AlertController> shownPeek() const;
    /// Ends the peek at an item that is no longer among the rows that it was held in.
    void endPeekAtMissingItem(const DocumentRows& rows);
    bool isSearching() const;
    void openFromPeek(const Url& url, FolderEntryKind kind);
    /// Answers whether an action is enabled and applies to this kind of item.
    bool offers(DocumentListAction action, FolderEntryKind kind) const;
    /// Answers whether it would be refused for this item.
    bool refuses(DocumentListAction action, const Url& item) const;

    std::optional<Url> _presentedURL;
    std::weak_ptr<kit::AlertController> _peek; ///< the latest peek
    std::optional<Url> _peekedItem; ///< the item of the latest peek
    std::weak_ptr<DocumentListControllerDelegate> _delegate;
    std::shared_ptr<kit::ListView> _listView;
    std::shared_ptr<PlaceholderView> _placeholder;
    std::shared_ptr<kit::View> _rowAnchor; ///< an invisible view at the place of a row, for popovers
    std::shared_ptr<DocumentRowSource> _rows;
    std::shared_ptr<FolderContents> _contents;
    std::shared_ptr<DocumentSearch> _search;
    std::shared_ptr<FolderListing>
        _libraries; ///< the drive's top level; it reports libraries that come or go
    std::vector<FolderSnapshot::ExtraItem> _shownLibraries;
    std::map<std::string, std::shared_ptr<void>> _associatedObjects;
    std::vector<Url> _changingItems;
    std::map<std::size_t, Url> _actions; ///< by their numbers, the items whose actions have not ended
    std::size_t _lastAction = 0;
    DocumentListActionSet _availableActions = 0;
    EditTags _editTags;
    CopyItems _copyItems;
    DownloadVerbs _downloadVerbs;
    TrashVerbs _trashVerbs;
    std::vector<FolderVerb> _folderVerbs;
    RefusedActions _refusedActions;
    ListOrder _order;
    bool _editing = false;
    /// An item that is revealed when it comes, and until when it may come.
    struct Awaited {
        Url item;
        platform::Date until;
    };
    std::optional<Awaited> _awaited;
    std::optional<ListingStage> _state; ///< the stage of the latest update; absent before the first
    std::optional<Error> _failure;
    bool _wasRemoved = false, _reportedRemoval = false, _hasTakenKeyboard = false;
    bool _isReordered = false; ///< the next update brings another order
};

/// Answers the text that stands for a list in a log line.
std::string logText(const std::shared_ptr<DocumentListController>& list);

} // namespace screens
