#include "host/drive/IndexedItemChanges.h"

namespace host::drive {

using platform::Error;
using platform::ItemVersion;

std::optional<ItemVersion> IndexedItemChanges::versionOfItem(const std::string& path) const
{
    return _changes.versionOfItem(path);
}

std::optional<Error> IndexedItemChanges::createFolder(const std::string& path)
{
    return _changes.createFolder(path);
}

std::optional<Error> IndexedItemChanges::removeItem(
    const std::string& path, const std::optional<ItemVersion>& unchangedSince)
{
    const auto documents = _identifiers->documentsWithin(path);
    auto error = _changes.removeItem(path, unchangedSince);
    if (!error)
        _identifiers->removed(documents);
    return error;
}

std::optional<Error> IndexedItemChanges::moveItem(const std::string& from, const std::string& to)
{
    auto error = _changes.moveItem(from, to);
    if (!error)
        _identifiers->moved(from, to);
    return error;
}

platform::Result<platform::FileContent> IndexedItemChanges::contentToReplace(
    const std::string& path, std::size_t maximumBytes) const
{
    return _changes.contentToReplace(path, maximumBytes);
}

platform::Result<ItemVersion> IndexedItemChanges::replaceContent(
    const std::string& path, const platform::FileContent& before, std::string_view content)
{
    auto replaced = _changes.replaceContent(path, before, content);
    // Another file carries the identifier now.
    if (replaced)
        _identifiers->moved(path, path);
    return replaced;
}

std::optional<Error> IndexedItemChanges::addDocument(
    const std::string& path, const std::string& like, std::string_view content)
{
    return _changes.addDocument(path, like, content);
}

std::optional<Error> IndexedItemChanges::evictItem(const std::string& path)
{
    auto error = _changes.evictItem(path);
    // The item is where it was, but it is its promise that carries the identifier now.
    if (!error)
        _identifiers->moved(path, path);
    return error;
}

} // namespace host::drive
