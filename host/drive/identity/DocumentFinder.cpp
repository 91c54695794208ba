// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/identity/DocumentFinder.h"

#include "host/drive/changes/Promises.h"
#include "host/drive/changes/TreeWalk.h"
#include "host/drive/changes/WorkRecord.h"
#include "host/drive/identity/IdentifiedItem.h"
#include "host/drive/records/ItemFacts.h"
#include "host/drive/records/ItemMarks.h"
#include "host/drive/records/PromiseFile.h"
#include "host/system/files/DeepEnumeration.h"
#include "host/system/files/DriveNames.h"
#include "host/system/files/FileVersion.h"
#include "host/system/files/ItemPaths.h"

#include <fcntl.h>
#include <sys/stat.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <map>

namespace host::drive {

using host::system::DeepEnumeration;
using host::system::FileDescriptor;
using host::system::lastName;
using host::system::SystemError;
using host::system::SystemResult;
using platform::FileType;
using platform::Url;
using Continue = platform::FileSystem::Continue;

namespace {

/// An item that carries the identifier, and its age, by which the older of two items wins.
struct Candidate {
    DocumentPlace place;
    std::int64_t born = 0; ///< nanoseconds since 1970; 0: not known
};

bool mayCarry(FileType type)
{
    return type == FileType::Regular || type == FileType::Directory;
}

/// Answers whether the item at a path exists only for the time of an operation: an incomplete copy, or an
/// item that is being removed.
bool isInWork(const std::string& path)
{
    constexpr std::array prefixes{
        WorkRecord::heldPrefix, WorkRecord::gonePrefix, WorkRecord::movedPrefix, WorkRecord::temporaryPrefix};
    return std::ranges::any_of(prefixes,
        [&](const char* prefix) { return path.find('/' + std::string(prefix)) != std::string::npos; });
}

std::int64_t birthOfPromise(const std::string& path)
{
    const auto promise = readPromise(path);
    return promise && promise->created ? promise->created->nanoseconds : 0;
}

std::optional<Candidate> candidateAt(const std::string& path, const std::string& home)
{
    struct stat status;
    struct statx birth;
    constexpr int flags = AT_SYMLINK_NOFOLLOW | AT_STATX_DONT_SYNC;
    if (::lstat(path.c_str(), &status) != 0
        || ::statx(AT_FDCWD, path.c_str(), flags, STATX_BTIME, &birth) != 0)
        return std::nullopt;
    const auto promised = PromiseRecord::itemPathFor(path);
    // An item counts before its promise.
    if (isInWork(path) || (promised && existsOnDisk(*promised) != false))
        return std::nullopt;
    const bool isBorn = (birth.stx_mask & STATX_BTIME) != 0;
    const auto born = promised ? birthOfPromise(path)
        : isBorn               ? host::system::nanosecondsOf(birth.stx_btime)
                               : 0;
    return Candidate{{promised.value_or(path).substr(home.size() + 1), status.st_dev, status.st_ino}, born};
}

/// Of two items of one age the first by path counts, so that every search answers the same.
bool isOlder(const Candidate& a, const Candidate& b)
{
    return a.born != b.born ? a.born < b.born : a.place.path < b.place.path;
}

bool isOfInode(const DocumentPlace& place, const DocumentPlace& known)
{
    return known.inode != 0 && place.inode == known.inode;
}

Continue goOn(const Url&, const platform::Error&)
{
    return Continue::Yes; // a folder that cannot be read does not hide the others
}

/// Ends the walk (EEXIST) at an item that carries the identifier.
class CarrierSearch : public TreeVisitor {
public:
    explicit CarrierSearch(std::uint32_t identifier)
        : _identifier(identifier)
    {
    }
    SystemError visitItem(
        const FileDescriptor& folder, const std::string& name, const struct stat& found) override
    {
        if (!S_ISREG(found.st_mode))
            return {};
        // A promise has another name while it is in work. What is no promise answers EBADMSG.
        const bool mayPromise = PromiseRecord::isPromiseName(name) || name.starts_with(system::passingPrefix);
        const auto promise = mayPromise ? OpenPromise::open(folder, name) : SystemError(EBADMSG, name);
        if (promise)
            return judge(promise->record.documentIdentifier);
        if (!promise.error.is(EBADMSG))
            return promise.error;
        const FileDescriptor file(::openat(folder.get(), name.c_str(), O_PATH | O_NOFOLLOW | O_CLOEXEC));
        return file ? judge(documentIdentifierOf(file)) : SystemError::last(name);
    }
    SystemError enterFolder(
        const FileDescriptor& folder, const struct stat&, const std::vector<std::string>&) override
    {
        return judge(documentIdentifierOf(folder));
    }

private:
    SystemError judge(const SystemResult<std::uint32_t>& carried) const
    {
        return carried ? SystemError(*carried == _identifier ? EEXIST : 0) : carried.error;
    }
    const std::uint32_t _identifier;
};

} // namespace

std::optional<bool> DocumentFinder::isCarried(std::uint32_t identifier) const
{
    const FileDescriptor home(::open(_layout.home().c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC));
    if (!home)
        return std::nullopt;
    CarrierSearch search(identifier);
    for (const auto& path : {_layout.documents(), _layout.trash(), _layout.held(), _layout.cloud()}) {
        const auto failure = walkTree(home, std::string(lastName(path)), search, Mounts::Enter);
        if (failure.is(EEXIST))
            return true;
        if (failure && !(failure.is(ENOENT) && existsOnDisk(path) == false))
            return std::nullopt;
    }
    return false;
}

DocumentFinder::Finding DocumentFinder::find(
    const std::string& folder, Depth depth, const IdentifiedPlace& known, Effort effort) const
{
    std::optional<Candidate> best;
    Finding finding;
    auto left = static_cast<std::size_t>(effort);
    const auto entry = [&](const Url& url, FileType type) {
        const auto& path = url.path();
        if (depth == Depth::Folder && path.find('/', folder.size() + 1) != std::string::npos)
            return Continue::No; // the folder's own names come first
        finding.isExhaustive = left > 0;
        if (left-- == 0)
            return Continue::No;
        if (!mayCarry(type) || identifierAt(path) != known.identifier)
            return Continue::Yes;
        const auto candidate = candidateAt(path, _layout.home());
        if (candidate && (!best || isOfInode(candidate->place, known.place) || isOlder(*candidate, *best)))
            best = candidate;
        return best && isOfInode(best->place, known.place) ? Continue::No : Continue::Yes;
    };
    const DeepEnumeration::ErrorHandler error = goOn;
    const DeepEnumeration::EntryHandler handler = entry;
    DeepEnumeration(Url::fileURL(folder), handler, error).run();
    if (best)
        finding.place = best->place;
    return finding;
}

DocumentFinder::Finding DocumentFinder::findInFolderOf(const IdentifiedPlace& known, Effort effort) const
{
    const auto path = _layout.home() + '/' + known.place.path;
    const auto folder = host::system::parentPath(path);
    if (folder != _layout.documents() && !folder.starts_with(_layout.documents() + '/'))
        return {};
    return find(folder, Depth::Folder, known, effort);
}

DocumentFinder::Finding DocumentFinder::findInDrive(const IdentifiedPlace& known, Effort effort) const
{
    return find(_layout.documents(), Depth::Everything, known, effort);
}

std::vector<IdentifiedPlace> DocumentFinder::findAll() const
{
    std::map<std::uint32_t, Candidate> found;
    const DeepEnumeration::EntryHandler entry = [&](const Url& url, FileType type) {
        const auto identifier = mayCarry(type) ? identifierAt(url.path()) : std::uint32_t{0};
        const auto candidate = identifier != 0 ? candidateAt(url.path(), _layout.home()) : std::nullopt;
        if (!candidate)
            return Continue::Yes;
        const auto [at, isNew] = found.try_emplace(identifier, *candidate);
        if (!isNew && isOlder(*candidate, at->second))
            at->second = *candidate;
        return Continue::Yes;
    };
    const DeepEnumeration::ErrorHandler error = goOn;
    DeepEnumeration(Url::fileURL(_layout.documents()), entry, error).run();
    std::vector<IdentifiedPlace> all;
    all.reserve(found.size());
    for (auto& [identifier, candidate] : found)
        all.push_back({identifier, std::move(candidate.place)});
    return all;
}

} // namespace host::drive
