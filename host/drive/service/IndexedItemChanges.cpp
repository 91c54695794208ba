// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/service/IndexedItemChanges.h"

namespace host::drive {

using platform::Error;
using platform::ItemVersion;

std::optional<Error> IndexedItemChanges::removeItem(
    const std::string& path, const std::optional<ItemVersion>& unchangedSince)
{
    const auto documents = _identifiers->documentsWithin(path);
    auto error = LocalItemChanges::removeItem(path, unchangedSince);
    if (!error)
        _identifiers->removed(documents);
    return error;
}

std::optional<Error> IndexedItemChanges::moveItem(const std::string& from, const std::string& to)
{
    auto error = LocalItemChanges::moveItem(from, to);
    if (!error)
        _identifiers->moved(from, to);
    return error;
}

platform::Result<ItemVersion> IndexedItemChanges::replaceContent(
    const std::string& path, const platform::FileContent& before, std::string_view content)
{
    auto replaced = LocalItemChanges::replaceContent(path, before, content);
    // Another file carries the identifier now.
    if (replaced)
        _identifiers->moved(path, path);
    return replaced;
}

platform::Result<std::vector<std::string>> IndexedItemChanges::editTags(
    const std::string& path, const TagEdit& edit)
{
    auto before = LocalItemChanges::editTags(path, edit);
    // A promise is another file with other tags.
    if (before)
        _identifiers->moved(path, path);
    return before;
}

std::optional<Error> IndexedItemChanges::evictItem(const std::string& path)
{
    auto error = LocalItemChanges::evictItem(path);
    // The item stays in its place, but now its promise carries the identifier.
    if (!error)
        _identifiers->moved(path, path);
    return error;
}

} // namespace host::drive
