// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/list/DocumentListController.h"

#include "kit/controllers/AlertAction.h"
#include "kit/controllers/AlertController.h"
#include "kit/controllers/Window.h"
#include "kit/views/ListView.h"
#include "platform/CloudDocumentService.h"
#include "platform/Localization.h"
#include "platform/Services.h"
#include "platform/Weakly.h"
#include "screens/DisplayName.h"
#include "screens/ErrorWords.h"
#include "screens/list/DocumentPeek.h"
#include "screens/list/DocumentRowSource.h"
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

} // namespace

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

std::vector<Url> DocumentListController::selectedItems() const
{
    std::vector<Url> items;
    if (selectedItemCount() == 0)
        return items;
    const auto& rows = *_contents->rows();
    for (std::size_t row = 0; row < rows.count() && items.size() < selectedItemCount(); ++row) {
        if (_listView->selection().contains(rows.ids()[row]))
            items.push_back(rows.url(row));
    }
    return items;
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
    const auto rows = _rows->rows();
    if (rows && index < rows->count())
        open(rows->url(index), rows->entry(index).kind);
}

void DocumentListController::open(const Url& url, FolderEntryKind kind)
{
    const auto told = delegate();
    if (!told)
        return;
    if (opensAsFolder(kind))
        told->documentListControllerDidSelectContainerWithViewController(self(), initWithURL(url));
    else
        told->documentListControllerDidSelectItemAtURL(self(), url);
}

kit::Menu DocumentListController::menuForRow(kit::ListView&, std::size_t index)
{
    kit::Menu menu;
    const auto rows = _rows->rows();
    if (_editing || !rows || index >= rows->count())
        return menu;
    const auto kind = rows->entry(index).kind;
    if (rows->entry(index).isPromise)
        menu.push_back(downloadEntry(rows->url(index)));
    for (const auto& entry : menuEntries) {
        if (!offers(entry.action, kind))
            continue;
        auto chosen = weakly(this, &DocumentListController::perform, entry.action, rows->url(index));
        menu.push_back({.title = localized(entry.title),
            .handler = std::move(chosen),
            .style = entry.style,
            .image = {}});
    }
    return menu;
}

kit::MenuAction DocumentListController::downloadEntry(const Url& url)
{
    const bool isRunning = services().cloudDocumentService().items().downloadProgress(url).has_value();
    if (isRunning)
        return {.title = localized("Cancel Download"),
            .handler = [url] { services().cloudDocumentService().items().cancelDownload(url); },
            .image = {}};
    return {.title = localized("Download"),
        .handler = weakly(this, &DocumentListController::download, url),
        .image = {}};
}

/// Downloads an item. The download goes on when the user leaves the list; the list reports only a failure.
void DocumentListController::download(const Url& url)
{
    services().cloudDocumentService().items().download(
        url, weakly(this, [](DocumentListController& self, const std::optional<Error>& error) {
            if (!error || error->is(FileErrorCode::Cancelled))
                return;
            const auto alert = std::make_shared<kit::AlertController>(
                localized("It could not be downloaded."), errorWords(*error), kit::AlertStyle::Alert);
            alert->addAction(
                std::make_shared<kit::AlertAction>(localized("OK"), kit::AlertActionStyle::Default));
            self.presentViewController(alert, true);
        }));
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
    const auto rows = _rows->rows();
    const auto [first, count] = _listView->visibleRows();
    for (std::size_t index = first; rows && index < std::min(first + count, rows->count()); ++index) {
        if (rows->url(index) != url)
            continue;
        const double top = static_cast<double>(index) * _listView->rowHeight() - _listView->contentOffset().y;
        const auto& list = _listView->frame();
        _rowAnchor->setFrame({list.x, list.y + top, list.width, _listView->rowHeight()});
        return _rowAnchor;
    }
    return _listView;
}

bool DocumentListController::offers(DocumentListAction action, FolderEntryKind kind) const
{
    const auto* entry = std::ranges::find(menuEntries, action, &ActionEntry::action);
    const bool isForKind =
        entry == std::end(menuEntries) || entry->forLibraries || kind != FolderEntryKind::Library;
    return isForKind && (_availableActions & actionBit(action)) != 0;
}

bool DocumentListController::rowCommand(kit::ListView& list, std::size_t index, kit::RowCommand command)
{
    if (command == kit::RowCommand::Peek)
        return rowHeld(list, index);
    constexpr std::pair<kit::RowCommand, DocumentListAction> actions[] = {
        {kit::RowCommand::Rename, DocumentListAction::Rename},
        {kit::RowCommand::Delete, DocumentListAction::Delete},
        {kit::RowCommand::Info, DocumentListAction::Info},
    };
    const auto* action =
        std::ranges::find(actions, command, &std::pair<kit::RowCommand, DocumentListAction>::first);
    const auto rows = _rows->rows();
    if (action == std::end(actions) || !rows || index >= rows->count()
        || !offers(action->second, rows->entry(index).kind))
        return false;
    perform(action->second, rows->url(index));
    return true;
}

bool DocumentListController::rowHeld(kit::ListView& list, std::size_t index)
{
    const auto told = delegate();
    const auto rows = _rows->rows();
    if (!told || _editing || !rows || index >= rows->count())
        return false;
    const auto url = rows->url(index);
    const auto screen = told->documentListControllerViewControllerForPreviewingItemAtURL(self(), url);
    if (!screen)
        return false;
    const auto open = weakly(this, &DocumentListController::openFromPeek, url, rows->entry(index).kind);
    const auto title = _listView->row(index).title;
    const auto peek = DocumentPeek::make(title, screen, menuForRow(list, index), open);
    _peek = peek;
    _peekedItem = url;
    presentViewController(peek, true);
    return true;
}

void DocumentListController::heldRowPressedOn(kit::ListView&)
{
    const auto peek = _peek.lock();
    if (peek && presentedViewController() == peek)
        peek->press(peek->preferredAction());
}

void DocumentListController::endPeekAtMissingItem()
{
    const auto peek = _peek.lock();
    if (!peek || !peek->presentingViewController())
        return;
    const auto& rows = *_contents->rows();
    if (std::ranges::find(rows.ids(), rows.idFor(*_peekedItem)) != rows.ids().end())
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
