// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/ContentCollection.h"

#include "host/drive/changes/Discarding.h"
#include "host/drive/changes/DriveEntry.h"
#include "host/drive/changes/LocalCloudStore.h"
#include "host/drive/changes/Promises.h"
#include "host/drive/changes/TreeWalk.h"
#include "host/drive/changes/WorkRecord.h"
#include "host/system/files/DirectoryReader.h"
#include "host/system/files/DriveNames.h"
#include "host/system/files/ItemPaths.h"

#include <fcntl.h>
#include <sys/file.h>

#include <algorithm>
#include <cerrno>
#include <charconv>
#include <chrono>
#include <iterator>
#include <map>
#include <memory>
#include <thread>
#include <vector>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using host::system::SystemResult;

namespace {

using Outcome = ContentCollection::Outcome;
using Names = std::set<std::string>;
using Nanoseconds = std::int64_t;
using Inode = std::pair<std::uint64_t, std::uint64_t>;

/// All promises of the drive as one walk saw them.
struct Promised {
    /// When each folder and each promise was changed last.
    std::map<Inode, Nanoseconds> changed;
    Names contents;
    /// The texts of promises that cannot be read as such. They may name contents all the same.
    std::vector<std::string> damaged;

    bool names(const std::string& content) const
    {
        return contents.contains(content) || std::ranges::any_of(damaged, [&](const std::string& text) {
            return text.find(content) != std::string::npos;
        });
    }
    /// Answers whether everything was changed last before a moment, so that a later change has another time.
    bool isOlderThan(Nanoseconds moment) const
    {
        constexpr Nanoseconds second = 1'000'000'000;
        return std::ranges::all_of(changed, [&](const auto& item) {
            // Whole seconds are from a file system that counts in one or two of them.
            return item.second + (item.second % second == 0 ? 2 * second : 0) < moment;
        });
    }
    bool operator==(const Promised&) const = default;
};

class PromiseReading : public TreeVisitor {
public:
    Promised promised;

    SystemError visitItem(
        const FileDescriptor& folder, const std::string& name, const struct stat& found) override
    {
        // Promises have private names, too, while they are moved or removed.
        const bool mayPromise = PromiseRecord::isPromiseName(name)
            || (name.starts_with(system::passingPrefix)
                && static_cast<std::uint64_t>(found.st_size) <= PromiseRecord::maximumFileSize);
        if (!mayPromise || !S_ISREG(found.st_mode))
            return {};
        note(found);
        auto promise = OpenPromise::open(folder, name);
        if (promise)
            promised.contents.insert(std::move(promise->record.content));
        return promise.error.is(EBADMSG) ? readDamaged(folder, name) : promise.error;
    }
    SystemError enterFolder(
        const FileDescriptor&, const struct stat& self, const std::vector<std::string>&) override
    {
        note(self);
        return {};
    }

private:
    void note(const struct stat& found)
    {
        const auto version = versionOf(found);
        promised.changed[{version.device, version.inode}] = version.changed;
    }
    SystemError readDamaged(const FileDescriptor& folder, const std::string& name)
    {
        auto text = system::readWholeFile(folder, name, PromiseRecord::maximumFileSize);
        if (text)
            promised.damaged.push_back(std::move(*text));
        return text.error.is(EFBIG) ? SystemError() : text.error;
    }
};

SystemResult<std::vector<std::string>> foldersIn(const FileDescriptor& folder)
{
    std::vector<std::string> names;
    const auto reader = std::make_unique<system::DirectoryReader>(folder);
    while (const auto entry = reader->next()) {
        // What cannot be told is taken for a folder, whose walk then says what is wrong.
        const auto type = reader->typeOf(*entry);
        if (type == platform::FileType::Directory || type == platform::FileType::Other)
            names.emplace_back(entry->name);
    }
    if (reader->error())
        return reader->error();
    return names;
}

/// Reads the promises in packages that are in the cloud themselves.
SystemError readPromisesInContents(const std::string& path, PromiseReading& reading)
{
    const auto folder = system::openFolder(path);
    if (!folder)
        return folder.error.is(ENOENT) ? SystemError() : folder.error;
    const auto names = foldersIn(*folder);
    if (!names)
        return names.error;
    for (const auto& name : *names)
        TRW_TRY(walkTree(*folder, name, reading, Mounts::Enter));
    return {};
}

/// Reads all promises: those of items, those in the trash, those that are being removed, and those in
/// contents. A package goes into the cloud from its place and out of the cloud to be removed, so the contents
/// are read in this order after the items.
SystemResult<Promised> readPromises(const DriveLayout& layout)
{
    PromiseReading reading;
    const FileDescriptor home(::open(layout.home().c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC));
    if (!home)
        return SystemError::last(layout.home());
    for (const auto& path : {layout.documents(), layout.trash(), layout.held()}) {
        const std::string name(system::lastName(path));
        const auto failure = walkTree(home, name, reading, Mounts::Enter);
        if (failure && !(failure.is(ENOENT) && statusAt(home, name).error.is(ENOENT)))
            return failure;
    }
    for (const auto& path : {layout.cloud(), layout.released()})
        TRW_TRY(readPromisesInContents(path, reading));
    return std::move(reading.promised);
}

SystemResult<Names> namesIn(const std::string& path)
{
    const auto folder = system::openFolder(path);
    if (!folder)
        return folder.error.is(ENOENT) ? SystemResult<Names>(Names()) : folder.error;
    auto names = readNames(*folder);
    if (!names)
        return names.error;
    return Names(std::make_move_iterator(names->begin()), std::make_move_iterator(names->end()));
}

/// Answers the time that the kernel would give to a change now.
Nanoseconds fileTime()
{
    timespec now{};
    ::clock_gettime(CLOCK_REALTIME_COARSE, &now);
    return system::nanosecondsOf(now);
}

/// Syncs the drive's file system, whose errors are told, and those that are mounted in its folders.
SystemError syncAll(const DriveLayout& layout)
{
    const FileDescriptor home(::open(layout.home().c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    if (!home || ::syncfs(home.get()) != 0)
        return SystemError::last(layout.home());
    ::sync();
    return {};
}

/// Remembers in a file how long the last walk took, and lets the next one wait accordingly.
class Pace {
public:
    explicit Pace(const std::string& path)
        : _file(::open(path.c_str(), O_RDWR | O_CREAT | O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC, 0600))
    {
    }
    /// Answers false while another process walks, and when it is too early.
    bool begin() const { return _file && ::flock(_file.get(), LOCK_EX | LOCK_NB) == 0 && isDue(); }
    void end(std::chrono::milliseconds duration) const
    {
        const auto text = std::to_string(duration.count());
        if (::ftruncate(_file.get(), 0) == 0)
            static_cast<void>(system::writeWhole(_file, text));
    }

private:
    bool isDue() const
    {
        constexpr int share = 20;
        char text[20];
        const auto length = ::pread(_file.get(), text, sizeof text, 0);
        struct stat found;
        std::int64_t milliseconds = 0;
        if (length > 0)
            std::from_chars(text, text + length, milliseconds);
        if (::fstat(_file.get(), &found) != 0)
            return false;
        const auto passed = (fileTime() - system::nanosecondsOf(found.st_mtim)) / 1'000'000;
        // A clock that was put back must not stop the collection.
        return passed < 0 || passed >= share * milliseconds;
    }
    FileDescriptor _file;
};

/// Removes a content for good, a folder with everything in it. It loses its name first, because half of a
/// folder must not be found as a content after a kill.
SystemError removeContent(const FileDescriptor& folder, const std::string& content, CloudStore& store)
{
    if (::unlinkat(folder.get(), content.c_str(), 0) == 0 || errno == ENOENT)
        return {};
    if (errno != EISDIR)
        return SystemError::last(content);
    auto gone = content;
    if (!content.starts_with(WorkRecord::gonePrefix)) {
        gone = uniqueName(WorkRecord::gonePrefix);
        TRW_TRY(renameEntry(folder, content, folder, gone));
    }
    return discardTree(folder, gone, &store).failure;
}

} // namespace

SystemResult<Outcome> ContentCollection::run()
{
    auto released = namesIn(_layout.released());
    if (!released)
        return released.error;
    if (released->empty())
        return Outcome::Done;
    static_cast<void>(openOwnFolder(_layout.locks()));
    const Pace pace(_layout.collection());
    if (!pace.begin())
        return Outcome::Later;
    constexpr std::chrono::milliseconds tick(20); // the kernel's clock for files moves at least this often
    constexpr int mostRounds = 4;
    std::chrono::steady_clock::duration duration{};
    SystemResult<Outcome> outcome(Outcome::Done);
    // A package releases the contents of its parts when it is removed.
    for (int round = 0; round < mostRounds && released && !released->empty(); ++round) {
        std::this_thread::sleep_for(tick);
        const auto begin = std::chrono::steady_clock::now();
        outcome = collect(*released);
        duration += std::chrono::steady_clock::now() - begin;
        if (!outcome || *outcome == Outcome::Later)
            break;
        released = namesIn(_layout.released());
    }
    pace.end(std::chrono::duration_cast<std::chrono::milliseconds>(duration));
    return outcome;
}

SystemResult<Outcome> ContentCollection::collect(const Names& released)
{
    const auto begin = fileTime();
    const auto first = readPromises(_layout);
    const auto second = first ? readPromises(_layout) : first.error;
    if (!second)
        return second.error.is(ENOENT) || second.error.is(ESTALE) ? SystemResult<Outcome>(Outcome::Later)
                                                                  : second.error;
    if (*first != *second || !first->isOlderThan(begin))
        return Outcome::Later;
    const auto from = openOwnFolder(_layout.released()), to = openOwnFolder(_layout.cloud());
    if (!from || !to)
        return from ? to.error : from.error;
    // The documents that were downloaded must be on the disk before their contents go.
    TRW_TRY(syncAll(_layout));
    for (const auto& content : released) {
        if (first->names(content))
            static_cast<void>(renameEntry(*from, content, *to, content));
    }
    LocalCloudStore store(_layout);
    SystemError failure;
    for (const auto& content : released) {
        auto failed = first->names(content) ? SystemError() : removeContent(*from, content, store);
        if (!failure)
            failure = std::move(failed);
    }
    return failure ? SystemResult<Outcome>(std::move(failure)) : Outcome::Done;
}

SystemResult<Names> ContentCollection::orphans()
{
    // The contents are listed first: one that is stored later has its promise before it has its name.
    auto contents = namesIn(_layout.cloud());
    // The second walk is for a promise that was moved while the first one went on.
    for (int walk = 0; walk < 2 && contents && !contents->empty(); ++walk) {
        const auto promised = readPromises(_layout);
        if (!promised)
            return promised.error;
        std::erase_if(*contents, [&](const std::string& content) { return promised->names(content); });
    }
    if (!contents || contents->empty())
        return contents;
    // A content that was released meanwhile is gone from the folder.
    const auto now = namesIn(_layout.cloud());
    if (!now)
        return now.error;
    std::erase_if(*contents, [&](const std::string& content) { return !now->contains(content); });
    return contents;
}

} // namespace host::drive
