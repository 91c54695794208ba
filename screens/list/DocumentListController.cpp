// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/list/DocumentListController.h"

#include "kit/controllers/NavigationController.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/views/ListView.h"
#include "platform/Dispatch.h"
#include "platform/FolderLister.h"
#include "platform/Localization.h"
#include "platform/Services.h"
#include "platform/Weakly.h"
#include "screens/ErrorWords.h"
#include "screens/FolderPlaces.h"
#include "screens/PlaceholderView.h"
#include "screens/list/DocumentRowSource.h"
#include "screens/list/DocumentSearch.h"
#include "screens/list/FolderContents.h"

#include <algorithm>
#include <chrono>
#include <utility>

namespace screens {

namespace {

/// The list shows that it is loading only after this time, because a short flash would disturb.
constexpr auto loadingDelay = std::chrono::milliseconds(300);
constexpr auto librarySettles = std::chrono::seconds(1);
/// A listing that takes longer than this comes when the user already does something else.
constexpr std::chrono::nanoseconds longestWait = std::chrono::seconds(5);

void fill(kit::View& parent, const std::shared_ptr<kit::View>& view)
{
    view->setAutoresizing({.flexibleWidth = true, .flexibleHeight = true});
    view->setFrame(parent.bounds());
    parent.addSubview(view);
}

} // namespace

std::shared_ptr<DocumentListController> DocumentListController::createRootList()
{
    const auto folder = rootFolder();
    return folder ? initWithURL(*folder) : nullptr;
}

std::shared_ptr<DocumentListController> DocumentListController::initWithURL(const Url& url)
{
    return std::make_shared<DocumentListController>(url);
}

std::shared_ptr<DocumentListController> DocumentListController::initWithURLTitle(
    const Url& url, const std::string& title)
{
    return std::make_shared<DocumentListController>(url, title);
}

std::vector<std::shared_ptr<DocumentListController>> DocumentListController::hierarchyForURL(const Url& url)
{
    return listsOf(titledFoldersDownTo(url));
}

std::vector<std::shared_ptr<DocumentListController>> DocumentListController::listsOf(
    const std::vector<TitledFolder>& folders)
{
    std::vector<std::shared_ptr<DocumentListController>> lists;
    lists.reserve(folders.size());
    for (const auto& [folder, title] : folders)
        lists.push_back(initWithURLTitle(folder, title));
    return lists;
}

DocumentListController::DocumentListController(std::optional<Url> folder)
    : _presentedURL(std::move(folder))
{
    if (_presentedURL)
        setTitle(folderTitle(*_presentedURL));
}

DocumentListController::DocumentListController(Url folder, const std::string& title)
    : _presentedURL(std::move(folder))
{
    setTitle(title);
}

DocumentListController::~DocumentListController() = default;

std::shared_ptr<DocumentListController> DocumentListController::self()
{
    return std::static_pointer_cast<DocumentListController>(shared_from_this());
}

void DocumentListController::setDelegate(std::weak_ptr<DocumentListControllerDelegate> delegate)
{
    _delegate = std::move(delegate);
    if (!_rows)
        return;
    _rows->setTagDots(weaklyOr(std::vector<kit::TagDot>(), this, &DocumentListController::dotsForTags));
}

std::vector<kit::TagDot> DocumentListController::dotsForTags(const std::vector<std::string>& names)
{
    const auto dots = delegate();
    return dots ? dots->documentListControllerDotsForTagNames(self(), names) : std::vector<kit::TagDot>();
}

void DocumentListController::loadView()
{
    const auto view = std::make_shared<kit::View>();
    _listView = std::make_shared<kit::ListView>();
    _listView->setAccessibility({.label = title(), .hint = {}});
    _listView->setRefreshable(true);
    _placeholder = PlaceholderView::create();
    _placeholder->setHidden(true);
    fill(*view, _listView);
    fill(*view, _placeholder);
    _rowAnchor = std::make_shared<kit::View>();
    _rowAnchor->setHidden(true);
    view->addSubview(_rowAnchor);
    setView(view);
}

void DocumentListController::viewDidLoad()
{
    _rows = DocumentRowSource::create(_listView);
    _rows->setOffersMenus(_availableActions != 0);
    setDelegate(_delegate);
    _listView->setDataSource(_rows);
    _listView->setListDelegate(
        std::shared_ptr<kit::ListViewDelegate>(self(), static_cast<kit::ListViewDelegate*>(this)));
    _listView->setSelectionMode(_editing ? kit::SelectionMode::Multiple : kit::SelectionMode::None);
    offerSearch();
    if (!_presentedURL)
        return;
    _order = savedOrder(*_presentedURL);
    navigationItem().setMenu(
        localized("Order and Options"), weaklyOr(kit::Menu(), this, &DocumentListController::optionsMenu));
    _contents =
        FolderContents::create(*_presentedURL, weakly(this, &DocumentListController::contentsDidChange));
    refresh();
    followLibraries();
    showLoadingAfterDelay();
}

void DocumentListController::takeKeyboard()
{
    // The list takes the keyboard focus only on top of its stack: a list in a peek leaves it to the peek, and
    // a list under a search or an alert leaves it to that.
    const auto stack = navigationController();
    const bool isOnTop = stack && stack->topViewController().get() == this && !presentedViewController();
    if (_hasTakenKeyboard || !isOnTop || appearanceState() != kit::AppearanceState::Appeared
        || containedItemCount() == 0)
        return;
    _hasTakenKeyboard = true;
    _listView->becomeFirstResponder();
}

void DocumentListController::offerSearch()
{
    // The search button goes while the user selects items, because a result could not be opened then and a
    // narrow bar has no room to spare.
    if (!shouldShowSearch() || _editing)
        return navigationItem().setSearchAction({});
    navigationItem().setSearchAction(weakly(this, [](DocumentListController& self) {
        // A shortcut triggers the button also while another screen lies over the list.
        if (!self.presentedViewController())
            self.startSearchWithQueryStringBecomeFirstResponder({}, true);
    }));
}

void DocumentListController::refresh()
{
    if (!_contents)
        return;
    _shownLibraries = extraItemsOf(*_presentedURL);
    _contents->start(_shownLibraries, _order);
}

void DocumentListController::followLibraries()
{
    if (!isRootFolder(*_presentedURL))
        return;
    _libraries = services().folderLister().list(_presentedURL->deletingLastPathComponent(), {},
        FolderGrouping::FoldersFirst, weakly(this, [](DocumentListController& self) {
            self.librariesMayHaveChanged();
            // A library's name may be written to the disk after its folder.
            auto& dispatch = services().dispatch();
            dispatch.after(librarySettles, dispatch.mainQueue(),
                weakly(&self, &DocumentListController::librariesMayHaveChanged));
        }));
}

void DocumentListController::librariesMayHaveChanged()
{
    if (extraItemsOf(*_presentedURL) != _shownLibraries)
        refresh();
}

void DocumentListController::viewDidAppear(bool animated)
{
    kit::ViewController::viewDidAppear(animated);
    _hasTakenKeyboard = false;
    takeKeyboard();
    // The subfolders may have got or lost items since the list was last shown.
    if (_rows) {
        _rows->invalidateDetails(std::vector<kit::RowId>());
        _rows->visibleRowsDidChange();
    }
    // The delegate takes the list off the stack, which must not happen while the stack is still changing.
    if (_wasRemoved)
        services().dispatch().mainQueue()->async(weakly(this, &DocumentListController::reportRemovalIfShown));
}

void DocumentListController::reveal(const Url& item)
{
    if (!_presentedURL || item.deletingLastPathComponent().path() != _presentedURL->path())
        return;
    _awaited = Awaited{item, {services().dispatch().now().nanoseconds + longestWait.count()}};
    revealAwaited();
}

void DocumentListController::revealAwaited()
{
    if (!_awaited || !_rows || !_rows->rows())
        return;
    if (services().dispatch().now().nanoseconds > _awaited->until.nanoseconds)
        return _awaited.reset();
    const auto& ids = _rows->rows()->ids();
    const auto found = std::ranges::find(ids, _rows->rows()->idFor(_awaited->item));
    if (found == ids.end())
        return;
    _awaited.reset();
    const auto row = static_cast<std::size_t>(found - ids.begin());
    if (!_listView->visibleRows().contains(row))
        _listView->scrollToRow(row, kit::RowPosition::Middle, true);
    _listView->focusRow(row);
}

void DocumentListController::contentsDidChange(const FolderContentsUpdate& update)
{
    const auto keepsAlive = self();
    _state = update.stage;
    _failure = update.error;
    const bool isFirst = !_rows->rows();
    _rows->setRows(update.rows);
    if (isFirst)
        dimBusyRows();
    _rows->invalidateDetails(update.touched);
    if (std::exchange(_isReordered, false)) {
        // Nearly every row has moved, so the list scrolls to the top.
        _hasTakenKeyboard = false;
        _listView->reloadAll();
        _listView->scrollToRow(0, kit::RowPosition::Top, false);
    } else {
        _listView->apply(update.changes);
    }
    _rows->visibleRowsDidChange();
    if (update.stage != ListingStage::FirstRows) {
        _listView->endRefreshing();
        if (!update.error && !isSearching())
            endPeekAtMissingItem(*update.rows);
    }
    showStateOfFolder();
    revealAwaited();
    takeKeyboard();
    if (const auto told = delegate())
        told->documentListControllerItemsChanged(keepsAlive);
    _wasRemoved = update.error && saysItemIsGone(*update.error);
    reportRemovalIfShown();
}

void DocumentListController::showStateOfFolder()
{
    const bool isEmpty = containedItemCount() == 0;
    _placeholder->setHidden(!isEmpty || _state == ListingStage::FirstRows);
    _placeholder->setActions({});
    if (!isEmpty) {
        navigationItem().setSubtitle(_failure ? localized("Some items could not be read") : std::string());
    } else if (_failure) {
        _placeholder->setContent({.iconName = "dialog-warning-symbolic",
            .title = localized("This folder cannot be shown"),
            .message = errorWords(*_failure)});
        _placeholder->setActions(
            {{localized("Try Again"), weakly(this, &DocumentListController::refresh), true}});
    } else {
        _placeholder->setContent({.iconName = "folder-open-symbolic",
            .title = localized("Folder is empty"),
            .message = localized("What you put into this folder appears here.")});
        std::vector<PlaceholderView::Action> actions;
        for (auto& verb : possibleVerbs())
            actions.push_back({std::move(verb.title), std::move(verb.run)});
        _placeholder->setActions(actions);
    }
}

void DocumentListController::showLoadingAfterDelay()
{
    auto& dispatch = services().dispatch();
    dispatch.after(loadingDelay, dispatch.mainQueue(), weakly(this, [](DocumentListController& self) {
        if (self._state)
            return;
        self._placeholder->setContent({.message = localized("Loading…"), .isBusy = true});
        self._placeholder->setHidden(false);
    }));
}

void DocumentListController::reportRemovalIfShown()
{
    if (!_wasRemoved || _reportedRemoval || appearanceState() != kit::AppearanceState::Appeared)
        return;
    const auto told = delegate();
    _reportedRemoval = told != nullptr;
    if (told)
        told->documentListControllerURLWasRemoved(self());
}

void DocumentListController::startSearchWithQueryStringBecomeFirstResponder(
    const std::string& query, bool becomeFirstResponder)
{
    view();
    _search = DocumentSearch::create({
        .chosen = weakly(this, &DocumentListController::open),
        .menu = weaklyOr(kit::Menu(), this, &DocumentListController::menuFor),
        .command = weaklyOr(false, this,
            [](DocumentListController& self, const RowItem& item, kit::RowCommand command) {
                return self.obey(command, item);
            }),
        .held = weaklyOr(false, this, &DocumentListController::peekAt),
        .heldPressedOn = weakly(
            this, [](DocumentListController& self) { self.heldRowPressedOn(*self._search->results()); }),
        .dots = weaklyOr(std::vector<kit::TagDot>(), this, &DocumentListController::dotsForTags),
        .completed = weakly(this, &DocumentListController::endPeekAtMissingItem),
    });
    const auto presentation = _search->presentation();
    presentation->setQuery(query);
    presentation->setFocus(becomeFirstResponder);
    presentViewController(presentation, true);
}

void DocumentListController::setAssociatedObject(const std::string& key, std::shared_ptr<void> object)
{
    if (object)
        _associatedObjects.insert_or_assign(key, std::move(object));
    else
        _associatedObjects.erase(key);
}

std::string logText(const std::shared_ptr<DocumentListController>& list)
{
    if (!list || !list->presentedURL())
        return "<DocumentListController>";
    return "<DocumentListController " + list->presentedURL()->path() + ">";
}

} // namespace screens
