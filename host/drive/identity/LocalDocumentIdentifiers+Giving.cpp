// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/DriveEntry.h"
#include "host/drive/identity/IdentifiedItem.h"
#include "host/drive/identity/LocalDocumentIdentifiers.h"
#include "host/drive/records/LinkRecords.h"
#include "host/drive/records/PromiseRecord.h"
#include "host/drive/records/RealPath.h"
#include "host/drive/records/SmallFile.h"

#include <fcntl.h>
#include <sys/file.h>

#include <cerrno>

namespace host::drive {

using host::system::FileDescriptor;
using platform::Result;
using platform::Url;
using Kind = DocumentIndex::Answer::Kind;

namespace {

/// Locks the giving of identifiers among all threads and processes until the file is closed. When even the
/// lock cannot be made, the index cannot be written either.
FileDescriptor lockGiving(const DriveLayout& layout)
{
    static_cast<void>(openOwnFolder(layout.locks()));
    FileDescriptor file(
        ::open(layout.identification().c_str(), O_RDWR | O_CREAT | O_NOFOLLOW | O_CLOEXEC, 0600));
    int result = 0;
    do
        result = file ? ::flock(file.get(), LOCK_EX) : 0;
    while (result != 0 && errno == EINTR);
    return file;
}

} // namespace

Result<std::uint32_t> LocalDocumentIdentifiers::identify(const Url& url)
{
    const auto real = url.isFileURL() ? realPathOfEntry(url.path()) : std::nullopt;
    const auto path = relativePath(real ? PromiseRecord::itemPathFor(*real).value_or(*real) : "");
    if (!path)
        return itemError(EXDEV, url.path());
    return identifyAt(*path);
}

Result<std::uint32_t> LocalDocumentIdentifiers::identifyAt(const std::string& path)
{
    constexpr int mostTries = 3;
    const auto lock = lockGiving(_layout);
    auto identifier = identifyLocked(path);
    // Another file has taken the item's place meanwhile, for example the downloaded document.
    for (int tries = 1; tries < mostTries && !identifier && identifier.error->code() == ESTALE; ++tries)
        identifier = identifyLocked(path);
    return identifier;
}

Result<std::uint32_t> LocalDocumentIdentifiers::identifyLocked(const std::string& path)
{
    const auto item = IdentifiedItem::open(_layout, path);
    if (!item && !item.error.is(ELOOP))
        return itemError(item.error, path);
    if (!item || !item->canCarryIdentifier())
        return platform::Error(platform::FileErrorCode::Unsupported);
    // Only a complete index can tell whether another item has the identifier.
    if (_index.prepareForWriting() == DocumentIndex::State::Incomplete)
        rebuild();
    if (_index.prepareForWriting() != DocumentIndex::State::Complete)
        return itemError(_index.failure(), path);
    const auto carried = item->identifier();
    if (!carried)
        return itemError(carried.error, path);
    const auto identifier = *carried;
    const auto answer = _index.lookUp(identifier, IndexDatabase::Use::Writing);
    if (answer.kind == Kind::Unreadable)
        return itemError(_index.failure(), path);
    if (identifier != 0 && isOwner({identifier, answer.place}, answer.kind, item->place()))
        return identifier;
    for (const auto& known :
        identifier == 0 ? _index.documentsWithin(path) : std::vector<IdentifiedPlace>()) {
        if (known.place.path == path && inheritLocked(known))
            return known.identifier;
    }
    return giveIdentifier(*item);
}

std::optional<DocumentPlace> LocalDocumentIdentifiers::inherit(const IdentifiedPlace& known)
{
    const auto lock = lockGiving(_layout);
    return inheritLocked(known);
}

std::optional<DocumentPlace> LocalDocumentIdentifiers::inheritLocked(const IdentifiedPlace& known)
{
    if (known.place.inode == 0 || !isPlainRelativePath(known.place.path))
        return std::nullopt;
    const auto item = IdentifiedItem::open(_layout, known.place.path);
    const bool isNewFile = item && item->isFile() && item->inode() != known.place.inode && item->carries(0);
    if (!isNewFile || _finder.isCarried(known.identifier).value_or(true) || item->carry(known.identifier))
        return std::nullopt;
    _index.note(known.identifier, item->place());
    return item->place();
}

bool LocalDocumentIdentifiers::isOwner(
    const IdentifiedPlace& known, DocumentIndex::Answer::Kind kind, const DocumentPlace& place)
{
    if (kind == Kind::Removed)
        return false;
    if (kind == Kind::Known && known.place == place)
        return true;
    if (kind == Kind::Known && known.place.inode != place.inode) {
        // The document with this identifier may have been moved or saved anew by other programs. This item
        // keeps the identifier only when no other item with it can be found.
        const auto owner = locate(known, Effort::Whole);
        if (owner && owner->inode != place.inode) {
            _index.note(known.identifier, *owner);
            return false;
        }
    }
    _index.note(known.identifier, place);
    return true;
}

Result<std::uint32_t> LocalDocumentIdentifiers::giveIdentifier(const IdentifiedItem& item)
{
    const auto place = item.place();
    // The index is written before the item, so that a crash in between only wastes an identifier.
    const auto identifier = _index.reserve(place);
    if (!identifier)
        return itemError(_index.failure(), place.path);
    if (const auto failure = item.carry(*identifier)) {
        _index.release(*identifier);
        return itemError(failure, place.path);
    }
    return *identifier;
}

} // namespace host::drive
