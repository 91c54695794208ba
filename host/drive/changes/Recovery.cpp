// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/Recovery.h"

#include "host/drive/changes/Discarding.h"
#include "host/drive/changes/HeldItem.h"
#include "host/drive/changes/Promises.h"
#include "host/drive/changes/TreeCopy.h"
#include "host/drive/changes/TreeWalk.h"
#include "host/drive/records/BeneathRoot.h"
#include "host/drive/records/ItemFacts.h"
#include "host/drive/records/SmallFile.h"
#include "host/system/coordination/LockFile.h"
#include "host/system/files/DirectoryReader.h"
#include "host/system/files/DriveNames.h"
#include "host/system/files/ItemPaths.h"
#include "host/system/files/PromisedNames.h"
#include "host/system/files/SystemErrors.h"
#include "platform/Log.h"

#include <fcntl.h>
#include <sys/xattr.h>

#include <cerrno>
#include <ctime>
#include <vector>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::lastName;
using host::system::SystemError;

namespace {

bool isThere(const DriveEntry& entry)
{
    return static_cast<bool>(entry.status());
}

/// Answers the same private name with another prefix.
DriveEntry renamed(const DriveEntry& entry, const char* prefix)
{
    return {FileDescriptor(::fcntl(entry.folder.get(), F_DUPFD_CLOEXEC, 0)),
        prefix + entry.name.substr(entry.name.find('-') + 1), entry.path};
}

/// Answers the path of the document for which a promise belongs at a path; the promise may lie in another
/// place for the moment. Any other path stands for itself.
std::string documentPath(const std::string& path, const std::string& place)
{
    auto name = system::promisedName(place, lastName(path));
    return name ? system::siblingPath(path, *name) : PromiseRecord::itemPathFor(path).value_or(path);
}

/// Gives the held name to an item and its name to the held one, in one step.
void exchange(const DriveEntry& held, const DriveEntry& document)
{
    static_cast<void>(::renameat2(
        held.folder.get(), held.name.c_str(), document.folder.get(), document.name.c_str(), RENAME_EXCHANGE));
}

void removeLastCharacter(std::string& text)
{
    const auto isContinuation = [](char byte) { return (static_cast<unsigned char>(byte) & 0xC0U) == 0x80U; };
    while (text.size() > 1 && isContinuation(text.back()))
        text.pop_back();
    text.pop_back();
}

/// Answers a name with a number, which a promise can say in its own name.
std::string numberedName(std::string name, int number)
{
    if (number == 1)
        return name;
    const auto suffix = ' ' + std::to_string(number);
    while (name.size() + suffix.size() > system::longestNameInPromise)
        removeLastCharacter(name);
    return name + suffix;
}

std::int64_t fileTime()
{
    timespec now{};
    ::clock_gettime(CLOCK_REALTIME, &now);
    return system::nanosecondsOf(now);
}

/// Finds the items with private names.
class StraySearch : public TreeVisitor {
public:
    std::vector<std::string> paths;

    SystemError visitItem(const FileDescriptor& folder, const std::string& name, const struct stat&) override
    {
        note(folder, name);
        return {};
    }
    SystemError leaveFolder(const FileDescriptor& parent, const std::string& name) override
    {
        note(parent, name);
        return {};
    }

private:
    void note(const FileDescriptor& folder, const std::string& name)
    {
        const bool isPromise =
            system::isLongPromiseName(name) && !system::promisedName(folder, name).error.is(EBADMSG);
        if (name.starts_with(system::passingPrefix) && !isPromise)
            paths.push_back(pathOf(folder) + '/' + name);
    }
};

/// Answers whether an error says that something is gone. Any other error says nothing of the kind.
bool saysGone(const platform::Error& error)
{
    return error.is(platform::FileErrorCode::NoSuchItem);
}

} // namespace

void Recovery::run()
{
    WorkRecord::forEachAbandoned(
        _layout, [this](const WorkRecord::Places& places) { return settle(places); });
    settleStrays();
}

platform::Result<DriveEntry> Recovery::entryAt(const std::string& path) const
{
    const std::string name(lastName(path));
    const auto& trash = _layout.trash();
    const bool isHeld = path == _layout.held() + '/' + name;
    if (!isHeld && !path.starts_with(trash + '/'))
        return DriveEntry::open(_layout, path);
    // What is in the trash lies in a folder of its own there.
    auto folder = isHeld
        ? openOwnFolder(_layout.held())
        : openBeneath(trash, "." + host::system::parentPath(path).substr(trash.size()), O_PATH | O_DIRECTORY);
    return folder ? platform::Result<DriveEntry>(DriveEntry{std::move(*folder), name, path})
                  : itemError(folder.error, path);
}

bool Recovery::settle(const WorkRecord::Places& places)
{
    // Nobody changes the item meanwhile. A program that hangs keeps only its own item from being settled.
    constexpr std::chrono::milliseconds patience(500);
    const system::LockFile locks(_layout.coordination());
    const auto kept =
        locks.acquire({{documentPath(places.item, places.working), system::LockMode::Exclusive}}, patience);
    if (kept.error.is(EBUSY))
        return false;
    return lastName(places.working).starts_with(WorkRecord::temporaryPrefix) ? settleCopy(places)
                                                                             : settleHeld(places);
}

bool Recovery::settleCopy(const WorkRecord::Places& places)
{
    static constexpr platform::Operation op{"-[Recovery settleCopy:]"};
    auto failure = removeCopy(places.working);
    if (!failure && !places.copy.empty())
        failure = finishMove(places);
    if (!failure)
        failure = settlePromise(places);
    if (failure)
        op.warning("Cannot settle what was left of %@: %@", places.item, itemError(failure, places.item));
    return !failure;
}

SystemError Recovery::removeCopy(const std::string& path) const
{
    const auto copy = entryAt(path);
    if (!copy)
        return saysGone(*copy.error) ? SystemError() : SystemError(EIO, path);
    auto failure = removeTree(copy->folder, copy->name);
    return failure.is(ENOENT) ? SystemError() : failure;
}

/// Settles a promise beside its document, after a download or an eviction.
SystemError Recovery::settlePromise(const WorkRecord::Places& places)
{
    const auto document = entryAt(documentPath(places.item, places.item));
    if (!document)
        return saysGone(*document.error) ? SystemError() : SystemError(EIO, places.item);
    if (!places.content.empty()) {
        // A document that did not come into the store left a promise of nothing.
        const auto failure = withdrawPromise(_layout, *document, _store, places.content);
        const bool isSettled = failure.is(ENOENT) || failure.is(ESTALE) || failure.is(EEXIST);
        return isSettled ? SystemError() : failure;
    }
    return settleTwin(_layout, *document, _store);
}

SystemError Recovery::finishMove(const WorkRecord::Places& places)
{
    const auto item = entryAt(places.item), copy = entryAt(places.copy);
    for (const auto* entry : {&item, &copy}) {
        if (!*entry)
            return saysGone(*entry->error) ? SystemError() : SystemError(EIO, places.item);
    }
    if (!isSameTree(item->folder, item->name, copy->folder, copy->name))
        return {};
    auto held = HeldItem::take(_layout, *item, item->name, places.copy);
    if (!held)
        return held.error;
    // When something changed between the two comparisons, the item is put back.
    if (!isSameTree(held->folder(), held->name(), copy->folder, copy->name))
        return {};
    return held->remove(nullptr);
}

bool Recovery::settleHeld(const WorkRecord::Places& places)
{
    const auto held = entryAt(places.working);
    if (!held)
        return saysGone(*held.error); // the item's folder is gone, and the item with it
    const auto gone = renamed(*held, WorkRecord::gonePrefix), moved = renamed(*held, WorkRecord::movedPrefix);
    if (isThere(gone))
        return discard(gone, true);
    if (isThere(moved))
        return discard(moved, false);
    const auto found = held->status();
    if (!found)
        return found.error.is(ENOENT);
    if (!places.replaced.empty())
        return settleSave(*held, *found, places);
    const auto copy = entryAt(places.copy);
    if (copy && isSameTree(held->folder, held->name, copy->folder, copy->name))
        return discard(*held, false);
    return putBack(*held, places.item);
}

/// Settles an interrupted save, so that the newest version has the document's name. The save is whole,
/// because it was synced before it got its private name, so it is finished if the document is still the one
/// that it replaces. A version that another program saved meanwhile has the name in any case, and the save is
/// kept.
bool Recovery::settleSave(const DriveEntry& held, const struct stat& found, const WorkRecord::Places& places)
{
    const auto text = [](const struct stat& status) { return WorkRecord::versionText(versionOf(status)); };
    const auto document = entryAt(places.item);
    if (!document && !saysGone(*document.error))
        return false;
    const auto current = document ? document->status() : SystemError(ENOENT);
    if (!current)
        return current.error.is(ENOENT) && putBack(held, places.item);
    if (text(found) == places.replaced)
        return discard(held, false);
    const bool isSave = text(found) == places.replacing, isReplaced = text(*current) == places.replaced;
    const bool isNewest = text(*current) == places.replacing
        || (!isSave && versionOf(found).modified > versionOf(*current).modified);
    if ((isSave && isReplaced) || isNewest)
        exchange(held, *document.value);
    const auto out = held.status();
    if (out && text(*out) == places.replaced)
        return discard(held, false);
    // Another program saved in the moment before, and its version keeps the name.
    if (isSave && isReplaced && out && text(*out) != places.replacing)
        exchange(held, *document.value);
    return moveToTrash(held, places.item);
}

bool Recovery::discard(const DriveEntry& entry, bool contentsToo)
{
    static constexpr platform::Operation op{"-[Recovery discard:]"};
    const auto failure = discardTree(entry.folder, entry.name, contentsToo ? &_store : nullptr).failure;
    if (failure)
        op.warning("Cannot remove the rest of %@: %@", entry.path, failure);
    return !failure;
}

bool Recovery::putBack(const DriveEntry& held, const std::string& item)
{
    const auto origin = entryAt(item);
    if (!origin)
        return saysGone(*origin.error) && moveToTrash(held, item);
    const auto failure = renameEntry(held.folder, held.name, origin->folder, origin->name);
    if (!failure)
        return !syncFolder(origin->folder) && !settleOwnTwin(item);
    return failure.is(EEXIST) && moveToTrash(held, item);
}

/// Settles a promise that was put back beside its document.
SystemError Recovery::settleOwnTwin(const std::string& item)
{
    const auto document = PromiseRecord::itemPathFor(item);
    if (!document)
        return {};
    const auto entry = entryAt(*document);
    return entry ? settleTwin(_layout, *entry.value, _store) : SystemError();
}

bool Recovery::moveToTrash(const DriveEntry& held, const std::string& item)
{
    static constexpr platform::Operation op{"-[Recovery moveToTrash:]"};
    constexpr int mostOfOneName = 1000;
    const auto trash = openOwnFolder(_layout.trash());
    const auto place = descriptorPath(held.folder) + '/' + held.name;
    const auto document = documentPath(item, place);
    const bool isPromise = document != item;
    ::lsetxattr(place.c_str(), itemMark::origin, document.data(), document.size(), 0);
    auto failure = trash ? SystemError(EEXIST) : trash.error;
    for (int number = 1; failure.is(EEXIST) && number < mostOfOneName; ++number) {
        const auto name = numberedName(std::string(lastName(document)), number);
        failure =
            renameEntry(held.folder, held.name, *trash, isPromise ? PromiseRecord::pathFor(name) : name);
    }
    if (!failure)
        op.warning("Cannot put back %@: it is in the trash now", item);
    else
        op.error("Cannot put back %@, kept as %@: %@", item, held.path, itemError(failure, item));
    return !failure;
}

void Recovery::settleStrays()
{
    const auto folder = system::openFolder(_layout.held());
    const auto names = folder ? readNames(*folder) : folder.error;
    if (!names)
        return;
    for (const auto& name : *names) {
        if (const auto held = entryAt(_layout.held() + '/' + name); held && !isAtWork(*held))
            settleStray(*held, "Recovered " + name.substr(name.find('-') + 1));
    }
}

/// Answers whether an item with a private name belongs to a process that may live. One without a record was
/// held on a full disk, or its record was lost in a power cut; it is left alone for as long as any operation
/// takes.
bool Recovery::isAtWork(const DriveEntry& stray) const
{
    const auto found = stray.status();
    return !found || WorkRecord::isRecorded(_layout, stray.name)
        || versionOf(*found).changed + _strayPatience.count() > fileTime();
}

void Recovery::settleStray(const DriveEntry& stray, const std::string& item)
{
    if (stray.name.starts_with(WorkRecord::heldPrefix))
        moveToTrash(stray, item);
    else if (stray.name.starts_with(WorkRecord::gonePrefix))
        discard(stray, true);
    else if (stray.name.starts_with(WorkRecord::movedPrefix)
        || stray.name.starts_with(WorkRecord::temporaryPrefix))
        discard(stray, false);
    else if (system::isLongPromiseName(stray.name)) // it says no name that belongs to it
        moveToTrash(stray, PromiseRecord::pathFor(item));
}

SystemError Recovery::settleStraysAmongItems()
{
    StraySearch search;
    const FileDescriptor home(::open(_layout.home().c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC));
    if (!home)
        return SystemError::last(_layout.home());
    TRW_TRY(walkTree(home, std::string(lastName(_layout.documents())), search, Mounts::Enter));
    for (const auto& path : search.paths) {
        const auto stray = entryAt(path);
        if (stray && !isAtWork(*stray.value))
            settleStray(*stray.value, system::siblingPath(path, "Recovered item"));
    }
    return {};
}

} // namespace host::drive
