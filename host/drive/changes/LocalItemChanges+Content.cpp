// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file reads a document whose content is to be replaced, and replaces it.

#include "host/drive/changes/ItemTraits.h"
#include "host/drive/changes/LocalItemChanges.h"
#include "host/drive/changes/NewFile.h"
#include "host/drive/records/ItemMarks.h"
#include "host/drive/records/SmallFile.h"

#include <fcntl.h>

#include <algorithm>
#include <array>
#include <cerrno>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using host::system::SystemResult;
using platform::Error;
using platform::FileContent;
using platform::FileErrorCode;
using platform::ItemVersion;
using platform::Result;

namespace {

constexpr int readFlags = O_RDONLY | O_CLOEXEC | O_NOFOLLOW | O_NONBLOCK | O_NOCTTY;

/// A document of the drive that is open, and its status when it was opened.
struct OpenDocument {
    DriveEntry entry;
    FileDescriptor file;
    struct stat found { };
};

Result<OpenDocument> openDocument(const DriveLayout& layout, const std::string& path)
{
    auto entry = DriveEntry::open(layout, path);
    if (!entry)
        return *entry.error;
    OpenDocument document{std::move(*entry.value), {}, {}};
    document.file =
        FileDescriptor(::openat(document.entry.folder.get(), document.entry.name.c_str(), readFlags));
    if (!document.file || ::fstat(document.file.get(), &document.found) != 0)
        return itemError(errno, path);
    if (!S_ISREG(document.found.st_mode))
        return Error(FileErrorCode::Unsupported);
    return document;
}

/// Answers an error unless both the document and its folder may be written.
SystemError checkWritable(const OpenDocument& document)
{
    const int folder = document.entry.folder.get();
    const bool isWritable = ::faccessat(folder, document.entry.name.c_str(), W_OK, AT_EACCESS) == 0
        && ::faccessat(folder, ".", W_OK, AT_EACCESS) == 0;
    // Root may write every file, but a read-only document is respected all the same.
    if (isWritable && (document.found.st_mode & 0222) == 0)
        return {EACCES, document.entry.name};
    return SystemError::unless(isWritable, document.entry.name);
}

/// Reads a file from its start. Answers ECANCELED when it became shorter meanwhile.
SystemResult<std::string> readBytes(const FileDescriptor& file, std::size_t size)
{
    std::string bytes(size, '\0');
    for (std::size_t filled = 0; filled < size;) {
        const auto length =
            ::pread(file.get(), bytes.data() + filled, size - filled, static_cast<off_t>(filled));
        if (length < 0 && errno != EINTR)
            return SystemError::last();
        if (length == 0)
            return SystemError(ECANCELED);
        filled += length > 0 ? static_cast<std::size_t>(length) : 0;
    }
    return bytes;
}

/// Answers ECANCELED when a document does not hold these bytes.
SystemError compareContent(const OpenDocument& document, const FileContent& before)
{
    if (versionOf(document.found) == before.version)
        return {};
    // New tags, a new name or a new copy of the same content do not count as a change of content.
    if (static_cast<std::size_t>(document.found.st_size) != before.bytes->size())
        return {ECANCELED, document.entry.name};
    const auto bytes = readBytes(document.file, before.bytes->size());
    if (!bytes)
        return bytes.error;
    return *bytes == *before.bytes ? SystemError() : SystemError(ECANCELED, document.entry.name);
}

SystemResult<ItemVersion> replaceBytes(const DriveLayout& layout, const OpenDocument& document,
    const FileContent& before, std::string_view content)
{
    TRW_TRY(checkWritable(document));
    TRW_TRY(compareContent(document, before));
    auto file = NewFile::create(layout, document.entry);
    if (!file)
        return file.error;
    TRW_TRY(file->write(content));
    const auto traits = ItemTraits::read(document.file);
    if (!traits)
        return traits.error;
    TRW_TRY(traits->write(file->descriptor()));
    return file->replace(layout, document.entry, versionOf(document.found), *traits);
}

/// Makes a document with the access rights and attributes of another one, if that can be opened.
SystemError addFile(
    const DriveLayout& layout, const DriveEntry& entry, const std::string& like, std::string_view content)
{
    TRW_TRY(entry.checkIsFree());
    auto file = NewFile::create(layout, entry);
    if (!file)
        return file.error;
    TRW_TRY(file->write(content));
    if (const auto model = openDocument(layout, like)) {
        auto traits = ItemTraits::read(model->file);
        if (!traits)
            return traits.error;
        // The new document is one of its own, so the identifier and its day stay with the other one.
        traits->attributes.erase(itemMark::documentIdentifier);
        traits->attributes.erase(itemMark::created);
        TRW_TRY(traits->write(file->descriptor()));
    }
    return file->publish(entry, entry.name);
}

} // namespace

Result<FileContent> LocalItemChanges::contentToReplace(
    const std::string& path, std::size_t maximumBytes) const
{
    constexpr int mostTries = 3;
    for (int tries = 0; tries < mostTries; ++tries) {
        const auto document = openDocument(_layout, path);
        if (!document)
            return *document.error;
        if (const auto failure = checkWritable(*document))
            return itemError(failure, path);
        const auto size = static_cast<std::size_t>(document->found.st_size);
        if (size > maximumBytes)
            return itemError(EFBIG, path);
        auto bytes = readBytes(document->file, size);
        if (!bytes && !bytes.error.is(ECANCELED))
            return itemError(bytes.error, path);
        struct stat after;
        if (bytes && ::fstat(document->file.get(), &after) == 0
            && versionOf(after) == versionOf(document->found))
            return FileContent{std::make_shared<const std::string>(std::move(*bytes)), versionOf(after)};
    }
    return itemError(EBUSY, path);
}

Result<ItemVersion> LocalItemChanges::replaceContent(
    const std::string& path, const FileContent& before, std::string_view content)
{
    const auto document = openDocument(_layout, path);
    if (!document)
        return *document.error;
    const auto written = replaceBytes(_layout, *document, before, content);
    if (written)
        return *written;
    return written.error.is(ECANCELED) ? Error(FileErrorCode::Cancelled) : itemError(written.error, path);
}

std::optional<Error> LocalItemChanges::addDocument(
    const std::string& path, const std::string& like, std::string_view content)
{
    const auto entry = DriveEntry::open(_layout, path);
    if (!entry)
        return entry.error;
    if (isReservedName(entry.value->name))
        return reservedName(path);
    const auto failure = addFile(_layout, *entry, like, content);
    return failure ? std::optional(itemError(failure, path)) : std::nullopt;
}

} // namespace host::drive
