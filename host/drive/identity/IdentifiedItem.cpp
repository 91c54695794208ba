// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/identity/IdentifiedItem.h"

#include "host/drive/records/BeneathRoot.h"
#include "host/drive/records/ItemFacts.h"
#include "host/drive/records/PromiseFile.h"
#include "host/drive/records/SmallFile.h"
#include "host/system/files/ItemPaths.h"

#include <fcntl.h>
#include <sys/xattr.h>

#include <cerrno>

namespace host::drive {

using host::system::SystemError;
using host::system::SystemResult;
using platform::Result;

namespace {

platform::Error failed(int errorNumber)
{
    return {platform::errorDomain::system, errorNumber};
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

SystemResult<std::uint32_t> IdentifiedItem::identifier() const
{
    if (!_isPromise)
        return documentIdentifierOf(_file);
    const auto promise = readPromise(_file);
    return promise ? SystemResult<std::uint32_t>(promise->documentIdentifier) : promise.error;
}

bool IdentifiedItem::canCarryIdentifier() const
{
    return S_ISREG(_status.st_mode) || (!_isPromise && S_ISDIR(_status.st_mode));
}

SystemError IdentifiedItem::carry(std::uint32_t identifier) const
{
    TRW_TRY(writeIdentifier(_file, identifier));
    // The file may have been replaced by another one, such as a new version or the downloaded document.
    // A look that fails does not take the identifier back.
    struct stat now;
    const bool isReplaced = ::fstat(_file.get(), &now) == 0 && now.st_nlink == 0;
    return isReplaced ? SystemError(ESTALE, _path) : SystemError();
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
    const auto number = identifier();
    return number ? Attributes{*number, platform::Url::fileURL(path)}
                  : Result<Attributes>(itemError(number.error, path));
}

std::uint32_t identifierAt(const std::string& physicalPath)
{
    if (PromiseRecord::isPromiseName(system::lastName(physicalPath)))
        return readPromise(physicalPath).value.value_or(PromiseRecord()).documentIdentifier;
    return documentIdentifierAt(physicalPath);
}

} // namespace host::drive
