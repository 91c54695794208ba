// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/move/MoveTargetRows.h"

#include "platform/Localization.h"
#include "screens/DisplayName.h"
#include "screens/DrivePlaces.h"

#include <functional>
#include <string>
#include <string_view>
#include <utility>

namespace screens {

namespace {

constexpr const char* folderIcon = "folder";

/// Identifiers are hashes of what the rows show, so that a row keeps its identifier wherever it stands.
kit::RowId idOf(std::string_view group, std::string_view name)
{
    return std::hash<std::string>{}(std::string(group) + '/' + std::string(name));
}

} // namespace

MoveTargetRows::MoveTargetRows(
    Libraries libraries, IsToBeMoved isToBeMoved, std::shared_ptr<const DrivePlaces> places)
    : _libraries(libraries)
    , _isToBeMoved(std::move(isToBeMoved))
    , _places(std::move(places))
{
}

void MoveTargetRows::setSnapshot(std::shared_ptr<const FolderSnapshot> snapshot)
{
    _snapshot = std::move(snapshot);
    _folders.clear();
    for (std::size_t i = 0; i < _snapshot->count(); ++i) {
        const auto kind = _snapshot->entry(i).kind;
        if (kind == FolderEntryKind::Folder
            || (kind == FolderEntryKind::Library && _libraries == Libraries::Shown))
            _folders.push_back(static_cast<std::uint32_t>(i));
    }
}

std::optional<Url> MoveTargetRows::destination(std::size_t index) const
{
    if (isRecent(index))
        return _recents[index - 1];
    if (index < headRows() || index - headRows() >= _folders.size())
        return std::nullopt;
    auto folder = _snapshot->url(_folders[index - headRows()]);
    return _isToBeMoved(folder) ? std::nullopt : std::optional(std::move(folder));
}

std::size_t MoveTargetRows::numberOfRows(const kit::ListView&) const
{
    return headRows() + _folders.size();
}

kit::RowKind MoveTargetRows::rowKindAtIndex(const kit::ListView&, std::size_t index) const
{
    const bool isHeading = index < headRows() && !isRecent(index);
    return isHeading ? kit::RowKind::SectionHeader : kit::RowKind::Item;
}

kit::RowId MoveTargetRows::rowIdAtIndex(const kit::ListView&, std::size_t index) const
{
    return idAt(index);
}

std::vector<kit::RowId> MoveTargetRows::ids() const
{
    std::vector<kit::RowId> ids;
    ids.reserve(headRows() + _folders.size());
    for (std::size_t row = 0; row < headRows() + _folders.size(); ++row)
        ids.push_back(idAt(row));
    return ids;
}

kit::RowId MoveTargetRows::idAt(std::size_t index) const
{
    if (isRecent(index))
        return idOf("recent", _recents[index - 1].path());
    if (index < headRows())
        return idOf("heading", index == 0 ? "recent" : "folders");
    const auto entry = _snapshot->entry(_folders[index - headRows()]);
    return idOf(entry.kind == FolderEntryKind::Library ? "library" : "folder", entry.name);
}

kit::ListRow MoveTargetRows::rowAtIndex(const kit::ListView& list, std::size_t index) const
{
    kit::ListRow row;
    if (isRecent(index))
        row = recentRow(index - 1);
    else if (index < headRows())
        row.title = index == 0 ? localized("Recent") : localized("Folders");
    else
        row = folderRow(index - headRows());
    row.id = idAt(index);
    row.kind = rowKindAtIndex(list, index);
    return row;
}

kit::ListRow MoveTargetRows::recentRow(std::size_t index) const
{
    const auto& folder = _recents[index];
    kit::ListRow row;
    row.image = Image::named("document-open-recent-symbolic");
    const auto titleOf = [this](const Url& known) {
        return _places->folderTitle(known).value_or(displayName(known.lastPathComponent()));
    };
    row.title = titleOf(folder);
    const auto way = _places->foldersDownTo(folder);
    if (way.size() > 1)
        row.detail = titleOf(way[way.size() - 2]);
    row.accessory = kit::RowAccessory::Disclosure;
    return row;
}

kit::ListRow MoveTargetRows::folderRow(std::size_t index) const
{
    const auto entry = _snapshot->entry(_folders[index]);
    const auto* library = _snapshot->extraItem(_folders[index]);
    kit::ListRow row;
    row.image = Image::named(library && !library->iconName.empty() ? library->iconName : folderIcon);
    row.title = displayName(entry.name);
    row.accessory = kit::RowAccessory::Disclosure;
    row.isDimmed = _isToBeMoved(_snapshot->url(_folders[index]));
    return row;
}

} // namespace screens
