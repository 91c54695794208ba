// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file holds the order of a list and the menu in which the user chooses it.

#include "platform/Localization.h"
#include "platform/Weakly.h"
#include "screens/PlatformNames.h"
#include "screens/list/DocumentListController.h"

#include <algorithm>
#include <iterator>
#include <utility>

namespace screens {

namespace {

struct KeyEntry {
    OrderKey key;
    const char* title;
};

constexpr KeyEntry keyEntries[] = {
    {OrderKey::Name, "Name"},
    {OrderKey::Date, "Date"},
    {OrderKey::Size, "Size"},
    {OrderKey::Kind, "Kind"},
};

kit::MenuMark markIf(bool on)
{
    return on ? kit::MenuMark::On : kit::MenuMark::Off;
}

} // namespace

void DocumentListController::setOrder(const ListOrder& order)
{
    if (order == _order || !_presentedURL)
        return;
    _order = order;
    saveOrder(*_presentedURL, order);
    _isReordered = true;
    refresh();
}

std::vector<DocumentListController::FolderVerb> DocumentListController::possibleVerbs() const
{
    std::vector<FolderVerb> possible;
    std::ranges::copy_if(
        _folderVerbs, std::back_inserter(possible), [](const FolderVerb& verb) { return verb.isPossible(); });
    return possible;
}

void DocumentListController::folderVerbsMayHaveChanged()
{
    if (_state && isViewLoaded())
        showStateOfFolder();
}

void DocumentListController::addTagsEntry(kit::Menu& menu, std::vector<Url> items) const
{
    if (_editTags && !items.empty())
        menu.push_back({.title = localized("Tags…"),
            .handler = [edit = _editTags, items = std::move(items)] { edit(items); },
            .image = {}});
}

void DocumentListController::addCopyEntry(kit::Menu& menu, std::vector<Url> items) const
{
    if (_copyItems && !items.empty())
        menu.push_back({.title = localized("Copy"),
            .handler = [copy = _copyItems, items = std::move(items)] { copy(items); },
            .image = {}});
}

void DocumentListController::addTrashEntry(kit::Menu& menu, std::vector<Url> items) const
{
    const auto isRefused = [this](const Url& item) { return refuses(DocumentListAction::Delete, item); };
    if (_trashVerbs.moveToTrash && !items.empty() && std::ranges::none_of(items, isRefused))
        menu.push_back({.title = localized("Move to Trash"),
            .handler = [move = _trashVerbs.moveToTrash, items = std::move(items)] { move(items); },
            .image = {}});
}

kit::Menu DocumentListController::optionsMenu()
{
    kit::Menu menu;
    const auto choice = [&](const char* title, const ListOrder& order, bool isPresent) {
        kit::MenuAction action;
        action.title = localized(title);
        action.handler = weakly(this, &DocumentListController::setOrder, order);
        action.mark = markIf(isPresent);
        menu.push_back(std::move(action));
    };
    if (_editing) {
        menu.push_back({.title = localized("Select All"),
            .handler = weakly(this, &DocumentListController::selectAllItems)});
        menu.push_back({.title = localized("Select None"),
            .handler = weakly(this, &DocumentListController::deselectAllItems)});
        addDownloadEntries(menu, _downloadVerbs, selectedRowItems());
        addCopyEntry(menu, selectedItems());
        addTagsEntry(menu, selectedItems());
        addTrashEntry(menu, selectedItems());
    }
    if (!_editing) {
        for (auto& verb : possibleVerbs())
            menu.push_back({.title = std::move(verb.title), .handler = std::move(verb.run)});
    }
    const auto firstChoice = menu.size();
    for (const auto& entry : keyEntries)
        choice(entry.title, _order.key == entry.key ? _order : _order.sortedBy(entry.key),
            _order.key == entry.key);
    menu[firstChoice].beginsSection = firstChoice > 0;
    const auto directionStart = menu.size();
    for (const auto direction : {OrderDirection::Ascending, OrderDirection::Descending}) {
        const bool ascends = direction == OrderDirection::Ascending;
        choice(ascends ? "Ascending" : "Descending", {_order.key, direction, _order.grouping},
            _order.direction == direction);
    }
    menu[directionStart].beginsSection = true;
    const bool grouped = _order.grouping == FolderGrouping::FoldersFirst;
    choice("Folders First",
        {_order.key, _order.direction, grouped ? FolderGrouping::Mixed : FolderGrouping::FoldersFirst},
        grouped);
    menu.back().beginsSection = true;
    if (_downloadVerbs.showRunning)
        menu.push_back(
            {.title = localized("Downloads"), .handler = _downloadVerbs.showRunning, .beginsSection = true});
    if (_trashVerbs.show)
        menu.push_back({.title = localized("Trash"),
            .handler = _trashVerbs.show,
            .beginsSection = !_downloadVerbs.showRunning});
    return menu;
}

} // namespace screens
