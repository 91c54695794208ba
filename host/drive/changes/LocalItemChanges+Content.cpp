// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// Reading a document to replace its content later, and replacing it.

#include "host/drive/changes/LocalItemChanges.h"
#include "host/drive/changes/NewFile.h"
#include "host/drive/changes/TreeCopy.h"
#include "host/drive/records/ItemFacts.h"
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

/// A document of the drive that is open, and what it was then.
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

/// 0 when both the document and its folder may be written, else the errno.
int checkWritable(const OpenDocument& document)
{
    const int folder = document.entry.folder.get();
    const bool isWritable = ::faccessat(folder, document.entry.name.c_str(), W_OK, AT_EACCESS) == 0
        && ::faccessat(folder, ".", W_OK, AT_EACCESS) == 0;
    // The one who may write everything still respects what is meant to stay as it is.
    if (isWritable && (document.found.st_mode & 0222) == 0)
        return EACCES;
    return isWritable ? 0 : errno;
}

/// Reads from the start; answers 0 or the errno.
int readBytes(const FileDescriptor& file, std::size_t size, std::string& bytes)
{
    bytes.resize(size);
    for (std::size_t filled = 0; filled < size;) {
        const auto length =
            ::pread(file.get(), bytes.data() + filled, size - filled, static_cast<off_t>(filled));
        if (length < 0 && errno != EINTR)
            return errno;
        if (length == 0)
            return ECANCELED; // it was made shorter meanwhile
        filled += length > 0 ? static_cast<std::size_t>(length) : 0;
    }
    return 0;
}

/// 0 when a document holds these bytes, ECANCELED when it does not, else the errno.
int compareContent(const OpenDocument& document, const FileContent& before)
{
    if (versionOf(document.found) == before.version)
        return 0;
    // Tags, a new name or a new copy of the same content are no change of it.
    if (static_cast<std::size_t>(document.found.st_size) != before.bytes->size())
        return ECANCELED;
    std::string bytes;
    const int failure = readBytes(document.file, before.bytes->size(), bytes);
    return failure == 0 && bytes != *before.bytes ? ECANCELED : failure;
}

Error contentError(int errorNumber, const std::string& path)
{
    return errorNumber == ECANCELED ? Error(FileErrorCode::Cancelled) : itemError(errorNumber, path);
}

/// Access and attributes of another document.
SystemError takeOver(const NewFile& file, const OpenDocument& from, std::string_view except)
{
    TRW_TRY(copyAttributes(from.file, file.descriptor(), except));
    return SystemError::unless(::fchmod(file.descriptor().get(), from.found.st_mode & 07777) == 0);
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
        if (const int failure = checkWritable(*document); failure != 0)
            return itemError(failure, path);
        const auto size = static_cast<std::size_t>(document->found.st_size);
        if (size > maximumBytes)
            return itemError(EFBIG, path);
        std::string bytes;
        const int failure = readBytes(document->file, size, bytes);
        if (failure != 0 && failure != ECANCELED)
            return itemError(failure, path);
        struct stat after;
        if (failure == 0 && ::fstat(document->file.get(), &after) == 0
            && versionOf(after) == versionOf(document->found))
            return FileContent{std::make_shared<const std::string>(std::move(bytes)), versionOf(after)};
    }
    return itemError(EBUSY, path);
}

Result<ItemVersion> LocalItemChanges::replaceContent(
    const std::string& path, const FileContent& before, std::string_view content)
{
    const auto document = openDocument(_layout, path);
    if (!document)
        return *document.error;
    std::optional<NewFile> file;
    int failure = checkWritable(*document);
    if (failure == 0)
        failure = compareContent(*document, before);
    if (failure == 0)
        failure = NewFile::create(_layout, document->entry, file);
    if (failure == 0)
        failure = file->write(content);
    if (failure == 0)
        failure = takeOver(*file, *document, {});
    ItemVersion written;
    if (failure == 0)
        failure = file->replace(_layout, document->entry, versionOf(document->found), written);
    if (failure != 0)
        return contentError(failure, path);
    return written;
}

std::optional<Error> LocalItemChanges::addDocument(
    const std::string& path, const std::string& like, std::string_view content)
{
    const auto entry = DriveEntry::open(_layout, path);
    if (!entry)
        return entry.error;
    if (const auto failure = entry->checkIsFree())
        return itemError(failure, path);
    std::optional<NewFile> file;
    int failure = NewFile::create(_layout, *entry, file);
    if (failure == 0)
        failure = file->write(content);
    // It is a document of its own: the other one keeps the identifier.
    const auto model = openDocument(_layout, like);
    if (failure == 0 && model)
        failure = takeOver(*file, *model, itemMark::documentIdentifier);
    if (failure == 0)
        failure = file->publish(*entry, entry->name);
    return failure == 0 ? std::nullopt : std::optional(itemError(failure, path));
}

} // namespace host::drive
