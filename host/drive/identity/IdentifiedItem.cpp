// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/identity/IdentifiedItem.h"

#include "host/drive/changes/DriveEntry.h"
#include "host/drive/records/BeneathRoot.h"
#include "host/drive/records/ItemFacts.h"
#include "host/drive/records/PromiseRecord.h"
#include "host/drive/records/SmallFile.h"
#include "host/system/files/AtomicWrite.h"

#include <fcntl.h>
#include <sys/xattr.h>

#include <array>
#include <cerrno>
#include <climits>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using host::system::SystemResult;
using platform::Result;

namespace {

platform::Error failed(int errorNumber)
{
    return {platform::errorDomain::system, errorNumber};
}

std::uint32_t identifierInPromise(const Result<std::string>& text)
{
    const auto promise = text ? PromiseRecord::parse(*text) : std::nullopt;
    return promise ? promise->documentIdentifier : 0;
}

std::string pathOf(const FileDescriptor& file)
{
    std::array<char, PATH_MAX> buffer;
    const auto length = ::readlink(descriptorPath(file).c_str(), buffer.data(), buffer.size());
    if (length == static_cast<ssize_t>(buffer.size()))
        errno = ENAMETOOLONG;
    const bool isWhole = length > 0 && length < static_cast<ssize_t>(buffer.size());
    return isWhole ? std::string(buffer.data(), static_cast<std::size_t>(length)) : std::string();
}

} // namespace

SystemResult<IdentifiedItem> IdentifiedItem::open(const DriveLayout& layout, const std::string& path)
{
    IdentifiedItem item(layout, path);
    auto file = openBeneath(layout.home(), path, O_PATH);
    if (file.error.is(ENOENT)) {
        file = openBeneath(layout.home(), PromiseRecord::pathFor(path), O_RDONLY | O_NONBLOCK);
        item._isPromise = true;
    }
    if (!file)
        return file.error;
    item._file = std::move(*file);
    if (::fstat(item._file.get(), &item._status) != 0)
        return SystemError::last(path);
    if (S_ISLNK(item._status.st_mode))
        return SystemError(ELOOP, path);
    return item;
}

std::uint32_t IdentifiedItem::identifier() const
{
    if (!_isPromise)
        return documentIdentifierOf(_file);
    ::lseek(_file.get(), 0, SEEK_SET);
    return identifierInPromise(readSmallFile(_file, _path, PromiseRecord::maximumFileSize));
}

bool IdentifiedItem::canCarryIdentifier() const
{
    return S_ISREG(_status.st_mode) || (!_isPromise && S_ISDIR(_status.st_mode));
}

SystemError IdentifiedItem::carry(std::uint32_t identifier) const
{
    if (_isPromise)
        return carryInPromise(identifier);
    const auto text = std::to_string(identifier);
    const auto path = descriptorPath(_file);
    return SystemError::unless(
        ::setxattr(path.c_str(), itemMark::documentIdentifier, text.data(), text.size(), 0) == 0, _path);
}

SystemError IdentifiedItem::carryInPromise(std::uint32_t identifier) const
{
    const auto entry = DriveEntry::open(_layout, _layout.home() + '/' + _path);
    if (!entry)
        return {ESTALE, _path};
    const auto found = statusAt(entry->folder, entry->promiseName());
    if (!found)
        return found.error;
    if (found->st_ino != _status.st_ino || found->st_dev != _status.st_dev)
        return {ESTALE, _path};
    ::lseek(_file.get(), 0, SEEK_SET);
    const auto text = readSmallFile(_file, _path, PromiseRecord::maximumFileSize);
    auto promise = text ? PromiseRecord::parse(*text) : std::nullopt;
    if (!promise)
        return {EBADMSG, _path};
    promise->documentIdentifier = identifier;
    return host::system::writeFileAtomically(entry->folder, entry->promiseName(), promise->toJson());
}

Result<platform::DocumentIdentifiers::OpenFile::Attributes> IdentifiedItem::attributes() const
{
    struct stat status;
    auto path = pathOf(_file);
    if (path.empty() || ::fstat(_file.get(), &status) != 0)
        return failed(errno);
    if (status.st_nlink == 0)
        return failed(ENOENT);
    if (_isPromise)
        path = PromiseRecord::itemPathFor(path).value_or("");
    // Nothing is told about items elsewhere, not even that they exist.
    if (!path.starts_with(_layout.documents() + '/'))
        return failed(EXDEV);
    return Attributes{identifier(), platform::Url::fileURL(path)};
}

std::uint32_t identifierAt(const std::string& physicalPath)
{
    if (PromiseRecord::itemPathFor(physicalPath))
        return identifierInPromise(readSmallFile(physicalPath, PromiseRecord::maximumFileSize));
    return documentIdentifierAt(physicalPath);
}

} // namespace host::drive
