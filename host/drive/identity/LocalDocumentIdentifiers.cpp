// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/identity/LocalDocumentIdentifiers.h"

#include "host/drive/identity/IdentifiedItem.h"
#include "host/drive/records/AccountRecord.h"
#include "host/drive/records/LinkRecords.h"
#include "host/drive/records/PromiseRecord.h"
#include "platform/Weakly.h"

#include <cerrno>

namespace host::drive {

using platform::Error;
using platform::Result;
using platform::Url;
using platform::weakly;
using Kind = DocumentIndex::Answer::Kind;

namespace {

// So many items are remembered between two uses of the index. Beyond that the memory is cleared.
constexpr std::size_t mostRemembered = 4096;

Error failed(int errorNumber)
{
    return {platform::errorDomain::system, errorNumber};
}

/// Answers the path on disk of an item or else of its promise, or nothing.
std::optional<std::string> physicalPath(const std::string& path, struct stat& status)
{
    if (::lstat(path.c_str(), &status) == 0)
        return path;
    const bool isMissing = errno == ENOENT;
    auto promise = PromiseRecord::pathFor(path);
    return isMissing && ::lstat(promise.c_str(), &status) == 0 ? std::optional(std::move(promise))
                                                               : std::nullopt;
}

} // namespace

std::shared_ptr<LocalDocumentIdentifiers> LocalDocumentIdentifiers::create(
    const DriveLayout& layout, const std::shared_ptr<platform::Dispatch>& dispatch)
{
    return std::shared_ptr<LocalDocumentIdentifiers>(new LocalDocumentIdentifiers(layout, dispatch));
}

LocalDocumentIdentifiers::LocalDocumentIdentifiers(
    const DriveLayout& layout, const std::shared_ptr<platform::Dispatch>& dispatch)
    : _layout(layout)
    , _index(layout.index())
    , _finder(layout)
    , _dispatch(dispatch)
    , _queue(dispatch->makeSerialQueue("TarrowDriveAppID.identifiers"))
{
}

std::optional<std::uint64_t> LocalDocumentIdentifiers::deviceIdentifier()
{
    const std::lock_guard lock(_mutex);
    struct stat status;
    if (!_device && AccountRecord::read(_layout) && ::stat(_layout.defaultContainer().c_str(), &status) == 0)
        _device = status.st_dev;
    return _device;
}

Result<platform::DocumentIdentifiers::File> LocalDocumentIdentifiers::resolve(std::uint32_t identifier)
{
    return resolve(identifier, _dispatch->isMainThread() ? Effort::Unnoticed : Effort::Whole);
}

Result<platform::DocumentIdentifiers::File> LocalDocumentIdentifiers::resolve(
    std::uint32_t identifier, Effort effort)
{
    if (identifier == 0)
        return failed(ENOENT);
    auto answer = _index.lookUp(identifier);
    if (answer.kind == Kind::Removed)
        return failed(ENOENT);
    const IdentifiedPlace known{identifier, std::move(answer.place)};
    if (answer.kind == Kind::Known && isAt(known))
        return File{known.place.inode, known.place.path};
    auto place = locate(known, effort);
    if (!place && answer.kind == Kind::Known && effort == Effort::Whole)
        place = inherit(known);
    // An incomplete index is made anew, because every look-up would otherwise be a search.
    const bool isIncomplete = answer.kind != Kind::Known && _index.state() != DocumentIndex::State::Complete;
    if (isIncomplete || (!place && effort == Effort::Unnoticed))
        searchInBackground(known);
    if (!place)
        return failed(ENOENT);
    if (answer.kind != Kind::Unreadable)
        _index.note(identifier, *place);
    return File{place->inode, place->path};
}

Result<std::shared_ptr<const platform::DocumentIdentifiers::OpenFile>> LocalDocumentIdentifiers::open(
    const File& file)
{
    if (!isPlainRelativePath(file.place))
        return failed(ENOENT);
    auto item = IdentifiedItem::open(_layout, file.place);
    if (!item) {
        // The path may lead through a link to the document's new place; only a search finds that place
        // itself.
        for (const auto& known : _index.documentsWithin(file.place))
            searchInBackground(known);
        return failed(item.error.number());
    }
    if (item->inode() != file.number)
        return failed(ESTALE);
    return std::shared_ptr<const OpenFile>(std::make_shared<IdentifiedItem>(std::move(*item.value)));
}

std::optional<Url> LocalDocumentIdentifiers::find(std::uint32_t identifier)
{
    const auto file = resolve(identifier, Effort::Whole);
    const auto item = file ? open(*file) : Result<std::shared_ptr<const OpenFile>>();
    const auto attributes = item ? (*item)->attributes() : Result<OpenFile::Attributes>();
    if (!attributes || attributes->documentIdentifier != identifier)
        return std::nullopt;
    return attributes->url;
}

bool LocalDocumentIdentifiers::isAt(const IdentifiedPlace& known) const
{
    struct stat status;
    if (known.place.inode == 0 || !isPlainRelativePath(known.place.path))
        return false;
    const auto path = physicalPath(_layout.home() + '/' + known.place.path, status);
    if (!path || status.st_ino != known.place.inode)
        return false;
    // When the device number is another one, this may be another volume on which the same inode is another
    // file.
    return status.st_dev == known.place.device || identifierAt(*path) == known.identifier;
}

std::optional<DocumentPlace> LocalDocumentIdentifiers::locate(const IdentifiedPlace& known, Effort effort)
{
    std::optional<DocumentPlace> best;
    if (isPlainRelativePath(known.place.path)) {
        // The document may have been saved by replacing it. A copy may also lie in its old place.
        const auto item = IdentifiedItem::open(_layout, known.place.path);
        if (item && item->carries(known.identifier) && item->attributes())
            best = item->place();
        if (best && known.place.inode == 0)
            return best;
        const auto inFolder = _finder.findInFolderOf(known, effort).place;
        if (inFolder && (inFolder->inode == known.place.inode || known.place.inode == 0))
            return inFolder;
        best = best ? best : inFolder;
    }
    auto inDrive = _finder.findInDrive(known, effort).place;
    if (inDrive && (!best || inDrive->inode == known.place.inode))
        return inDrive;
    return best;
}

void LocalDocumentIdentifiers::searchInBackground(const IdentifiedPlace& known)
{
    {
        const std::lock_guard lock(_mutex);
        if (_searched.size() >= mostRemembered)
            _searched.clear();
        if (!_searched.insert(known.identifier).second)
            return;
    }
    _queue->async(weakly(this, &LocalDocumentIdentifiers::searchFor, known));
}

void LocalDocumentIdentifiers::searchFor(const IdentifiedPlace& known)
{
    if (_index.state() != DocumentIndex::State::Complete)
        rebuild();
    else if (const auto place = locate(known, Effort::Whole))
        _index.note(known.identifier, *place);
    else
        inherit(known);
}

void LocalDocumentIdentifiers::rebuild()
{
    if (_index.state() == DocumentIndex::State::Unavailable)
        return;
    auto all = _finder.findAll();
    // An item that the index knows at its place counts before an older one, because a copy may have an older
    // date.
    std::erase_if(all, [this](const auto& found) {
        const auto answer = _index.lookUp(found.identifier);
        return answer.kind == Kind::Known && isAt({found.identifier, answer.place});
    });
    _index.complete(all);
}

std::optional<std::string> LocalDocumentIdentifiers::relativePath(const std::string& path) const
{
    if (!path.starts_with(_layout.documents() + '/'))
        return std::nullopt;
    auto relative = path.substr(_layout.home().size() + 1);
    return isPlainRelativePath(relative) ? std::optional(std::move(relative)) : std::nullopt;
}

void LocalDocumentIdentifiers::seen(std::uint32_t identifier, const std::string& path)
{
    {
        const std::lock_guard lock(_mutex);
        if (_seen.size() >= mostRemembered)
            _seen.clear();
        auto& known = _seen[identifier];
        if (known == path)
            return;
        known = path;
        _searched.erase(identifier);
    }
    _queue->async(weakly(this, &LocalDocumentIdentifiers::correct, identifier, path));
}

void LocalDocumentIdentifiers::correct(std::uint32_t identifier, const std::string& path)
{
    const auto relative = relativePath(path);
    const auto item = relative ? IdentifiedItem::open(_layout, *relative) : system::SystemError(ENOENT, path);
    if (!item || !item->carries(identifier))
        return;
    const auto answer = _index.lookUp(identifier);
    if (answer.kind == Kind::Removed || (answer.kind == Kind::Known && answer.place == item->place()))
        return;
    const IdentifiedPlace known{identifier, answer.place};
    if (_index.state() != DocumentIndex::State::Complete)
        rebuild();
    else if (answer.kind == Kind::Unknown || answer.place.inode == item->inode())
        _index.note(identifier, item->place());
    else if (const auto place = isAt(known) ? std::nullopt : locate(known, Effort::Whole))
        _index.note(identifier, *place);
}

void LocalDocumentIdentifiers::moved(const std::string& from, const std::string& to)
{
    const auto source = relativePath(from), target = relativePath(to);
    if (!source || !target)
        return;
    _index.noteMove(*source, *target);
    const auto item = IdentifiedItem::open(_layout, *target);
    const auto identifier = item ? item->identifier().value.value_or(0) : 0;
    const auto answer = identifier != 0 ? _index.lookUp(identifier) : DocumentIndex::Answer();
    // A move to another file system makes another file of the item.
    if (answer.kind == Kind::Known && answer.place.path == *target && answer.place != item->place())
        _index.note(identifier, item->place());
}

void LocalDocumentIdentifiers::replaced(const std::string& path)
{
    _queue->async(weakly(this, &LocalDocumentIdentifiers::moved, path, path));
}

std::vector<std::uint32_t> LocalDocumentIdentifiers::documentsWithin(const std::string& path) const
{
    std::vector<std::uint32_t> identifiers;
    const auto relative = relativePath(path);
    for (const auto& known : relative ? _index.documentsWithin(*relative) : std::vector<IdentifiedPlace>()) {
        // A document that others moved away is not removed with the folder in which it was.
        if (isAt(known))
            identifiers.push_back(known.identifier);
    }
    return identifiers;
}

void LocalDocumentIdentifiers::removed(const std::vector<std::uint32_t>& identifiers)
{
    for (const auto identifier : identifiers)
        _index.noteRemoval(identifier);
}

} // namespace host::drive
