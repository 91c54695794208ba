#include "platform/FolderSnapshot.h"

namespace platform {

FolderEntry FolderSnapshot::entry(std::size_t index) const
{
    const auto& record = _records[index];
    return {
        std::string_view(_names).substr(record.nameOffset, record.nameLength), record.kind, record.isPromise};
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

void FolderSnapshot::Builder::reserve(std::size_t entries, std::size_t nameBytes)
{
    _snapshot->_records.reserve(entries);
    _snapshot->_names.reserve(nameBytes);
}

void FolderSnapshot::Builder::append(std::string_view name, FolderEntryKind kind, bool isPromise)
{
    const auto offset = static_cast<std::uint32_t>(_snapshot->_names.size());
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
    return std::shared_ptr<const FolderSnapshot>(std::move(_snapshot));
}

} // namespace platform
