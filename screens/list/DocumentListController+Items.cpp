// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/list/DocumentListController.h"

#include "kit/controllers/AlertController.h"
#include "kit/controllers/Window.h"
#include "kit/views/ListView.h"
#include "platform/Localization.h"
#include "platform/Services.h"
#include "platform/Weakly.h"
#include "screens/DisplayName.h"
#include "screens/list/DocumentPeek.h"
#include "screens/list/DocumentRowSource.h"
#include "screens/list/DocumentSearch.h"
#include "screens/list/FolderContents.h"

#include <algorithm>
#include <unordered_set>
#include <utility>

namespace screens {

namespace {

struct ActionEntry {
    DocumentListAction action;
    const char* title;
    kit::MenuActionStyle style;
    bool forLibraries; ///< whether an app library offers it
};

constexpr ActionEntry menuEntries[] = {
    {DocumentListAction::Info, "Info", kit::MenuActionStyle::Default, true},
    {DocumentListAction::Share, "Share", kit::MenuActionStyle::Default, true},
    {DocumentListAction::Rename, "Rename", kit::MenuActionStyle::Default, false},
    {DocumentListAction::Move, "Move", kit::MenuActionStyle::Default, false},
    {DocumentListAction::More, "More", kit::MenuActionStyle::Default, true},
    {DocumentListAction::Delete, "Delete", kit::MenuActionStyle::Destructive, true},
};

bool holds(const DocumentRows& rows, const Url& url)
{
    const auto has = [&](const kit::RowId id) {
        return std::ranges::find(rows.ids(), id) != rows.ids().end();
    };
    return has(rows.idFor(url)) || has(DocumentRows::idForExtraItem(url));
}

} // namespace

void DocumentListController::setAvailableActions(DocumentListActionSet actions)
{
    _availableActions = actions;
    if (_rows)
        _rows->setOffersMenus(actions != 0);
}

std::size_t DocumentListController::containedItemCount() const
{
    return _contents ? _contents->rows()->count() : 0;
}

std::vector<Url> DocumentListController::containedItems() const
{
    std::vector<Url> items;
    items.reserve(containedItemCount());
    for (std::size_t row = 0; row < containedItemCount(); ++row)
        items.push_back(_contents->rows()->url(row));
    return items;
}

std::size_t DocumentListController::selectedItemCount() const
{
    return _listView ? _listView->selection().count() : 0;
}

std::vector<RowItem> DocumentListController::selectedRowItems() const
{
    std::vector<RowItem> items;
    if (selectedItemCount() == 0)
        return items;
    const auto& rows = *_contents->rows();
    for (std::size_t row = 0; row < rows.count() && items.size() < selectedItemCount(); ++row) {
        const auto entry = rows.entry(row);
        if (_listView->selection().contains(rows.ids()[row]))
            items.push_back({rows.url(row), entry.kind, entry.isPromise, {}});
    }
    return items;
}

std::vector<Url> DocumentListController::selectedItems() const
{
    std::vector<Url> items;
    for (auto& item : selectedRowItems())
        items.push_back(std::move(item.url));
    return items;
}

bool DocumentListController::selectionHoldsFolder() const
{
    if (selectedItemCount() == 0)
        return false;
    const auto& rows = *_contents->rows();
    for (std::size_t row = 0; row < rows.count(); ++row) {
        if (_listView->selection().contains(rows.ids()[row]) && opensAsFolder(rows.entry(row).kind))
            return true;
    }
    return false;
}

void DocumentListController::setSelectedItems(const std::vector<Url>& items)
{
    if (!_editing || !_contents || !isViewLoaded())
        return;
    kit::SelectionModel selection;
    for (const auto& item : items)
        selection.select(_contents->rows()->idFor(item));
    _listView->setSelection(std::move(selection));
    selectionDidChange(*_listView);
}

void DocumentListController::selectAllItems()
{
    if (_editing && isViewLoaded())
        _listView->selectAllByUser();
}

void DocumentListController::deselectAllItems()
{
    setSelectedItems({});
}

void DocumentListController::setEditingAnimated(bool editing, bool)
{
    _editing = editing;
    if (isViewLoaded())
        offerSearch();
    if (isViewLoaded())
        _listView->setSelectionMode(editing ? kit::SelectionMode::Multiple : kit::SelectionMode::None);
}

void DocumentListController::selectionDidChange(kit::ListView&)
{
    if (const auto told = delegate())
        told->documentListControllerItemsChanged(self());
}

void DocumentListController::visibleRowsDidChange(kit::ListView&, kit::RowRange)
{
    _rows->visibleRowsDidChange();
}

void DocumentListController::refreshRequested(kit::ListView&)
{
    refresh();
}

void DocumentListController::rowActivated(kit::ListView&, std::size_t index)
{
    const auto item = itemAt(index);
    if (!item)
        return;
    // The row knows its folder's name, so a tap looks at nothing.
    if (opensAsFolder(item->kind))
        openFolder(initWithURLTitle(item->url, item->title));
    else
        open(item->url, item->kind);
}

void DocumentListController::open(const Url& url, FolderEntryKind kind)
{
    if (opensAsFolder(kind))
        openFolder(initWithURL(url));
    else if (const auto told = delegate())
        told->documentListControllerDidSelectItemAtURL(self(), url);
}

void DocumentListController::openFolder(const std::shared_ptr<DocumentListController>& folder)
{
    if (const auto told = delegate())
        told->documentListControllerDidSelectContainerWithViewController(self(), folder);
}

std::optional<RowItem> DocumentListController::itemAt(std::size_t index) const
{
    const auto& rows = _rows->rows();
    if (!rows || index >= rows->count())
        return std::nullopt;
    const auto entry = rows->entry(index);
    return RowItem{rows->url(index), entry.kind, entry.isPromise, _listView->row(index).title};
}

kit::Menu DocumentListController::menuForRow(kit::ListView&, std::size_t index)
{
    const auto item = itemAt(index);
    return item ? menuFor(*item) : kit::Menu();
}

kit::Menu DocumentListController::menuFor(const RowItem& item)
{
    kit::Menu menu;
    if (_editing)
        return menu;
    if (isSearching())
        menu.push_back({.title = localized("Show in Its Folder"),
            .handler = weakly(this, &DocumentListController::open, item.url.deletingLastPathComponent(),
                FolderEntryKind::Folder),
            .image = {}});
    if (item.isPromise)
        addDownloadEntries(menu, _downloadVerbs, {item});
    for (const auto& entry : menuEntries) {
        if (entry.action == DocumentListAction::Delete && !item.isPromise)
            addDownloadEntries(menu, _downloadVerbs, {item});
        if (entry.action == DocumentListAction::Delete && item.kind != FolderEntryKind::Library) {
            // What is in the cloud can be downloaded first.
            if (!item.isPromise)
                addCopyEntry(menu, {item.url});
            addTagsEntry(menu, {item.url});
            addTrashEntry(menu, {item.url});
        }
        if (!offers(entry.action, item.kind) || refuses(entry.action, item.url))
            continue;
        auto chosen = weakly(this, &DocumentListController::perform, entry.action, item.url);
        menu.push_back({.title = localized(entry.title),
            .handler = std::move(chosen),
            .style = entry.style,
            .image = {}});
    }
    return menu;
}

void DocumentListController::perform(DocumentListAction action, const Url& url)
{
    const auto told = delegate();
    if (!told)
        return;
    // The row is dimmed until the delegate says that the action has ended.
    const auto number = ++_lastAction;
    _actions.emplace(number, url);
    dimBusyRows();
    told->documentListControllerPerformActionURLOriginatingViewCompletion(self(), static_cast<int>(action),
        url, anchorFor(url), weakly(this, &DocumentListController::actionEnded, number));
}

void DocumentListController::actionEnded(std::size_t number)
{
    if (_actions.erase(number) > 0)
        dimBusyRows();
}

void DocumentListController::setChangingItems(std::vector<Url> items)
{
    if (items == _changingItems)
        return;
    _changingItems = std::move(items);
    dimBusyRows();
}

void DocumentListController::dimBusyRows()
{
    if (!_rows || !_rows->rows())
        return;
    std::unordered_set<kit::RowId> busy;
    for (const auto& item : _changingItems)
        busy.insert(_rows->rows()->idFor(item));
    for (const auto& [number, item] : _actions)
        busy.insert(_rows->rows()->idFor(item));
    _rows->setDimmed(std::move(busy));
}

std::shared_ptr<kit::View> DocumentListController::anchorFor(const Url& url)
{
    if (isSearching())
        return _search->anchorFor(url);
    const auto place = _rows->visiblePlaceOf(url);
    if (!place)
        return _listView;
    _rowAnchor->setFrame(*place);
    return _rowAnchor;
}

bool DocumentListController::refuses(DocumentListAction action, const Url& item) const
{
    return _refusedActions && (_refusedActions(item) & actionBit(action)) != 0;
}

bool DocumentListController::offers(DocumentListAction action, FolderEntryKind kind) const
{
    const auto* entry = std::ranges::find(menuEntries, action, &ActionEntry::action);
    const bool isForKind =
        entry == std::end(menuEntries) || entry->forLibraries || kind != FolderEntryKind::Library;
    return isForKind && (_availableActions & actionBit(action)) != 0;
}

bool DocumentListController::rowCommand(kit::ListView&, std::size_t index, kit::RowCommand command)
{
    const auto item = itemAt(index);
    return item && obey(command, *item);
}

std::vector<Url> DocumentListController::meantBy(const RowItem& item) const
{
    auto items = _editing ? selectedItems() : std::vector<Url>();
    if (std::ranges::find(items, item.url) == items.end())
        items = {item.url};
    return items;
}

/// Answers false for what does not go to the trash.
bool DocumentListController::moveToTrash(const RowItem& item)
{
    if (!_trashVerbs.moveToTrash || item.kind == FolderEntryKind::Library)
        return false;
    _trashVerbs.moveToTrash(meantBy(item));
    return true;
}

/// Only documents that are here are dragged, because a folder may hold what is still in the cloud, and there
/// is no time to look.
std::vector<Url> DocumentListController::filesToDrag(kit::ListView&, std::size_t index)
{
    const auto item = itemAt(index);
    if (!item)
        return {};
    auto dragged = _editing ? selectedRowItems() : std::vector<RowItem>();
    if (std::ranges::find(dragged, item->url, &RowItem::url) == dragged.end())
        dragged = {*item};
    const auto isDocumentHere = [](const RowItem& each) {
        return !each.isPromise
            && (each.kind == FolderEntryKind::Document || each.kind == FolderEntryKind::Package);
    };
    std::vector<Url> files;
    if (std::ranges::all_of(dragged, isDocumentHere))
        std::ranges::transform(dragged, std::back_inserter(files), &RowItem::url);
    return files;
}

bool DocumentListController::copy(const RowItem& item)
{
    if (!_copyItems || item.kind == FolderEntryKind::Library)
        return false;
    _copyItems(meantBy(item));
    return true;
}

bool DocumentListController::obey(kit::RowCommand command, const RowItem& item)
{
    if (command == kit::RowCommand::Peek)
        return peekAt(item);
    if (command == kit::RowCommand::Delete && moveToTrash(item))
        return true;
    if (command == kit::RowCommand::Copy)
        return copy(item);
    if (_editing)
        return false;
    constexpr std::pair<kit::RowCommand, DocumentListAction> actions[] = {
        {kit::RowCommand::Rename, DocumentListAction::Rename},
        {kit::RowCommand::Delete, DocumentListAction::Delete},
        {kit::RowCommand::DeleteForGood, DocumentListAction::Delete},
        {kit::RowCommand::Info, DocumentListAction::Info},
    };
    const auto* action =
        std::ranges::find(actions, command, &std::pair<kit::RowCommand, DocumentListAction>::first);
    if (action == std::end(actions) || !offers(action->second, item.kind))
        return false;
    perform(action->second, item.url);
    return true;
}

bool DocumentListController::rowHeld(kit::ListView&, std::size_t index)
{
    const auto item = itemAt(index);
    return item && peekAt(*item);
}

bool DocumentListController::peekAt(const RowItem& item)
{
    const auto told = delegate();
    if (!told || _editing)
        return false;
    // A slow disk leaves open for now whether there is something to show.
    const auto isShown = std::make_shared<bool>(true);
    told->documentListControllerPrepareToPreviewItemAtURL(self(), item.url,
        weakly(this, [item, isShown](DocumentListController& list) { *isShown = list.showPeekAt(item); }));
    return *isShown;
}

bool DocumentListController::showPeekAt(const RowItem& item)
{
    const auto told = delegate();
    if (!told || _editing)
        return false;
    const auto screen = told->documentListControllerViewControllerForPreviewingItemAtURL(self(), item.url);
    if (!screen)
        return false;
    const auto peek = DocumentPeek::make(item.title, screen, menuFor(item),
        {.open = weakly(this, &DocumentListController::openFromPeek, item.url, item.kind),
            .ended = weakly(this, &DocumentListController::peekEnded)});
    _peek = peek;
    _peekedItem = item.url;
    presentViewController(peek, true);
    return true;
}

std::shared_ptr<kit::AlertController> DocumentListController::shownPeek() const
{
    const auto peek = _peek.lock();
    return peek && peek->presentingViewController() ? peek : nullptr;
}

void DocumentListController::peekEnded()
{
    const auto told = delegate();
    if (told && !shownPeek())
        told->documentListControllerPeekDidEnd(self());
}

void DocumentListController::heldRowPressedOn(kit::ListView&)
{
    if (const auto peek = shownPeek())
        peek->press(peek->preferredAction());
}

void DocumentListController::endPeekAtMissingItem(const DocumentRows& rows)
{
    const auto peek = shownPeek();
    if (!peek || holds(rows, *_peekedItem))
        return;
    const auto shown = window();
    peek->dismissViewController(false);
    if (shown)
        shown->showNotice(
            localized("“%@” is no longer there.", {displayName(_peekedItem->lastPathComponent())}));
}

void DocumentListController::openFromPeek(const Url& url, FolderEntryKind kind)
{
    if (offers(DocumentListAction::PressurePop, kind))
        perform(DocumentListAction::PressurePop, url);
    else
        open(url, kind);
}

bool DocumentListController::isSearching() const
{
    return _search && _search->presentation()->presentingViewController();
}

void DocumentListController::selectionRequested(kit::ListView&)
{
    if (const auto told = delegate())
        told->documentListControllerRequestsEditing(self());
}

void DocumentListController::openOutOfDriveViewControllerAction(
    const Url&, const std::shared_ptr<kit::ViewController>&, const std::function<void()>& action)
{
    action();
}

} // namespace screens
