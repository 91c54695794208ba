// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/listing/EntryClassifier.h"

#include "host/system/files/DriveNames.h"
#include "host/system/files/ItemPaths.h"
#include "host/system/files/PromisedNames.h"

#include <cerrno>

namespace host::system {

using platform::FileType;
using platform::FolderEntry;
using platform::FolderEntryKind;

namespace {

/// Answers the part behind the last dot, by the same rules as Url::pathExtension().
std::string_view extensionOf(std::string_view name)
{
    const auto dot = name.rfind('.');
    const bool hasNone = dot == std::string_view::npos || dot == 0;
    return hasNone || name.find(' ', dot) != std::string_view::npos ? std::string_view()
                                                                    : name.substr(dot + 1);
}

FolderEntryKind kindOfFile(std::string_view name)
{
    const auto extension = extensionOf(name);
    return extension == referenceExtension || extension == aliasExtension ? FolderEntryKind::Link
                                                                          : FolderEntryKind::Document;
}

} // namespace

bool LongNameReading::mayBeThere() const
{
    return failure && !failure.is(ENOENT) && !failure.is(EBADMSG);
}

FolderEntryKind EntryClassifier::kindOfFolder(std::string_view name) const
{
    return _types->isPackageExtension(extensionOf(name)) ? FolderEntryKind::Package : FolderEntryKind::Folder;
}

std::optional<FolderEntry> EntryClassifier::promised(std::string_view name) const
{
    if (name.starts_with('.'))
        return std::nullopt; // it is the promise of a hidden item
    const bool isPackage = kindOfFolder(name) == FolderEntryKind::Package;
    return FolderEntry{name, isPackage ? FolderEntryKind::Package : kindOfFile(name), true};
}

std::optional<FolderEntry> EntryClassifier::classify(
    const FileDescriptor& folder, std::string_view name, FileType type, LongNameReading& longName) const
{
    if (!isLongPromiseName(name))
        return classify(name, type);
    auto read = type == FileType::Regular ? promisedName(folder, name) : SystemError(EBADMSG);
    longName.failure = std::move(read.error);
    if (!read)
        return std::nullopt;
    longName.name = std::move(*read);
    return promised(longName.name);
}

std::optional<FolderEntry> EntryClassifier::classify(std::string_view name, FileType type) const
{
    if (name.starts_with('.')) {
        if (type != FileType::Regular || !name.ends_with(promiseSuffix)
            || name.size() <= promiseSuffix.size() + 1)
            return std::nullopt;
        return promised(name.substr(1, name.size() - 1 - promiseSuffix.size()));
    }
    switch (type) {
    case FileType::Directory:
        return FolderEntry{name, kindOfFolder(name), false};
    case FileType::SymbolicLink:
        return FolderEntry{name, FolderEntryKind::Link, false};
    default:
        return FolderEntry{name, kindOfFile(name), false};
    }
}

} // namespace host::system
