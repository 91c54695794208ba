// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/FolderSnapshot.h"

#include <utility>

namespace platform {

namespace {

/// So many bytes of waste are not worth a copy.
constexpr std::size_t smallWaste = 64 * 1024;

} // namespace

std::string_view FolderSnapshot::nameOf(const Record& record) const
{
    const auto shared = _sharedNames ? _sharedNames->size() : 0;
    return record.nameOffset < shared
        ? std::string_view(*_sharedNames).substr(record.nameOffset, record.nameLength)
        : std::string_view(_names).substr(record.nameOffset - shared, record.nameLength);
}

FolderEntry FolderSnapshot::entry(std::size_t index) const
{
    const auto& record = _records[index];
    return {nameOf(record), record.kind, record.isPromise};
}

bool FolderSnapshot::isMostlyWaste() const
{
    const auto bytes = (_sharedNames ? _sharedNames->size() : 0) + _names.size();
    std::size_t used = 0;
    for (const auto& record : _records)
        used += record.nameLength;
    return bytes > 2 * used + smallWaste;
}

Url FolderSnapshot::url(std::size_t index) const
{
    if (const auto* extra = extraItem(index))
        return extra->url;
    const auto found = entry(index);
    const bool isFolder = found.kind == FolderEntryKind::Folder || found.kind == FolderEntryKind::Package;
    return _folder.appendingPathComponent(found.name, isFolder ? PathKind::Directory : PathKind::Unknown);
}

const FolderSnapshot::ExtraItem* FolderSnapshot::extraItem(std::size_t index) const
{
    const auto extra = _records[index].extra;
    return extra < 0 ? nullptr : &_extras[static_cast<std::size_t>(extra)];
}

FolderSnapshot::Builder::Builder(const FolderSnapshot& before)
    : Builder(before._folder)
{
    _snapshot->_sharedNames = before._sharedNames;
    _snapshot->_names = before._names;
    _snapshot->_extras = before._extras;
}

void FolderSnapshot::Builder::keep(const FolderSnapshot& before, std::size_t first, std::size_t count)
{
    const auto from = before._records.begin() + static_cast<std::ptrdiff_t>(first);
    _snapshot->_records.insert(_snapshot->_records.end(), from, from + static_cast<std::ptrdiff_t>(count));
}

void FolderSnapshot::Builder::keep(
    const FolderSnapshot& before, std::size_t index, FolderEntryKind kind, bool isPromise)
{
    keep(before, index, 1);
    _snapshot->_records.back().kind = kind;
    _snapshot->_records.back().isPromise = isPromise;
}

void FolderSnapshot::Builder::reserve(std::size_t entries, std::size_t nameBytes)
{
    _snapshot->_records.reserve(entries);
    _snapshot->_names.reserve(nameBytes);
}

void FolderSnapshot::Builder::append(std::string_view name, FolderEntryKind kind, bool isPromise)
{
    const auto shared = _snapshot->_sharedNames ? _snapshot->_sharedNames->size() : 0;
    const auto offset = static_cast<std::uint32_t>(shared + _snapshot->_names.size());
    _snapshot->_names.append(name);
    _snapshot->_records.push_back({offset, static_cast<std::uint16_t>(name.size()), kind, isPromise, -1});
}

void FolderSnapshot::Builder::append(ExtraItem item)
{
    append(item.name, item.kind, false);
    _snapshot->_records.back().extra = static_cast<std::int32_t>(_snapshot->_extras.size());
    _snapshot->_extras.push_back(std::move(item));
}

std::shared_ptr<const FolderSnapshot> FolderSnapshot::Builder::finish(
    ListingStage stage, std::optional<Error> error)
{
    _snapshot->_stage = stage;
    _snapshot->_error = std::move(error);
    if (!_snapshot->_sharedNames)
        _snapshot->_sharedNames = std::make_shared<const std::string>(std::exchange(_snapshot->_names, {}));
    return std::shared_ptr<const FolderSnapshot>(std::move(_snapshot));
}

std::shared_ptr<const FolderSnapshot> FolderSnapshot::Builder::finish(FolderRevision revision)
{
    _snapshot->_revision = std::move(revision);
    return finish(ListingStage::Complete);
}

} // namespace platform
