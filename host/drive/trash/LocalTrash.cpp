// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/trash/LocalTrash.h"

#include "host/drive/changes/Promises.h"
#include "host/drive/changes/TreeWalk.h"
#include "host/drive/records/BeneathRoot.h"
#include "host/drive/records/ItemFacts.h"
#include "host/drive/records/SmallFile.h"
#include "host/drive/trash/TrashedContent.h"
#include "host/system/files/DirectoryReader.h"
#include "host/system/files/DriveNames.h"
#include "host/system/files/ItemPaths.h"
#include "host/system/files/SystemErrors.h"
#include "host/system/texts/Translate.h"
#include "platform/Log.h"

#include <fcntl.h>
#include <sys/file.h>
#include <sys/xattr.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <chrono>
#include <iterator>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using host::system::SystemResult;
using platform::Error;
using platform::FileErrorCode;
using platform::ItemVersion;
using platform::Result;
using platform::TrashedItem;

namespace {

platform::Date now()
{
    return platform::Date::fromTimePoint(std::chrono::system_clock::now());
}

/// Opens the trash and locks it. The lock is held until the descriptor is closed.
SystemResult<FileDescriptor> openTrash(const DriveLayout& layout, int lock)
{
    if (const auto made = openOwnFolder(layout.trash()); !made)
        return made.error;
    auto folder = system::openFolder(layout.trash());
    if (!folder)
        return folder.error.ofDrive();
    int result = 0;
    do
        result = ::flock(folder->get(), lock);
    while (result != 0 && errno == EINTR);
    if (result != 0)
        return SystemError::last(layout.trash()).ofDrive();
    return folder;
}

/// Answers whether a path below the documents area is a container's folder or its documents folder.
bool isContainer(std::string_view relative)
{
    const auto slash = relative.find('/');
    return slash == std::string_view::npos
        || (relative.substr(0, slash) != DriveLayout::defaultContainerIdentifier
            && relative.substr(slash + 1) == DriveLayout::documentsFolderName);
}

} // namespace

Error notInTrash()
{
    platform::PropertyDictionary info;
    info.emplace(platform::errorKey::localizedDescription,
        host::system::translated(host::system::textKey("The item is no longer in the trash.")));
    return Error(FileErrorCode::NoSuchItem, std::move(info));
}

namespace {

Error changeError(const SystemError& failure, const std::string& path)
{
    return failure.is(ECANCELED) ? Error(FileErrorCode::Cancelled) : itemError(failure, path);
}

/// Answers where an item was that Recovery brought; empty when that is not known.
SystemResult<std::string> markedOrigin(const DriveLayout& layout, const LocatedItem& item)
{
    std::array<char, 4096> text; // PATH_MAX
    const auto path = descriptorPath(item.entry.folder) + '/' + item.name;
    const auto length = ::lgetxattr(path.c_str(), itemMark::origin, text.data(), text.size());
    if (length < 0 && errno != ENODATA && errno != EOPNOTSUPP && errno != ERANGE)
        return SystemError::last(item.name);
    const std::string origin(text.data(), static_cast<std::size_t>(std::max<ssize_t>(length, 0)));
    if (!origin.starts_with(layout.documents() + '/'))
        return std::string();
    return PromiseRecord::itemPathFor(origin).value_or(origin);
}

/// Answers whether an item came into the trash before a moment. A date that lies so far back that the clock
/// must have been wrong is no answer.
bool isOlder(const TrashRecord& record, platform::Date moment)
{
    constexpr std::int64_t longestTime = std::int64_t{5} * 365 * 24 * 3600 * 1'000'000'000;
    return record.reason == TrashRecord::Reason::Trashed && record.trashed < moment
        && record.trashed.nanoseconds > 0 && moment.nanoseconds - record.trashed.nanoseconds < longestTime;
}

} // namespace

Result<TrashedItem> LocalTrash::moveToTrash(
    const std::string& path, const std::optional<ItemVersion>& unchangedSince)
{
    const auto item = LocatedItem::locate(_layout, path);
    if (!item)
        return *item.error;
    auto origin = PromiseRecord::itemPathFor(path).value_or(path).substr(_layout.documents().size() + 1);
    if (isContainer(origin) || system::isPassingName(item->entry.name))
        return Error(FileErrorCode::Unsupported);
    if (unchangedSince && versionOf(item->found) != *unchangedSince)
        return Error(FileErrorCode::Cancelled);
    if (!item->isPromise())
        static_cast<void>(settleTwin(_layout, item->entry, *_store));
    const auto trash = openTrash(_layout, LOCK_SH);
    if (!trash)
        return itemError(trash.error, path);
    const TrashRecord record{std::move(origin), now()};
    const auto place = TrashPlace::make(*trash, _layout.trash(), record);
    auto failure = place ? take(*item.value, *place) : place.error;
    if (!failure)
        return describe(
            place->name(), LocatedItem{place->entry(item->entry.name), item->name, item->found}, record);
    if (place) {
        // What could not be put back stays in its place here, because something new lies in the old one.
        if (place->item())
            static_cast<void>(place->write({record.origin, record.trashed, TrashRecord::Reason::KeptCopy}));
        place->dropIfEmpty(*trash);
    }
    return changeError(failure, path);
}

SystemError LocalTrash::take(const LocatedItem& item, const TrashPlace& place)
{
    const auto target = place.entry(item.name);
    auto failure = LocalItemChanges::moveWithin(item, target, item.name);
    if (failure.is(EXDEV))
        return _changes->moveAcross(item, target, item.name);
    if (failure)
        return failure;
    const auto taken = target.status();
    if (taken && isSameContent(versionOf(item.found), versionOf(*taken)))
        return {};
    // Another program has saved since the look, so its version gets its name back.
    static_cast<void>(renameEntry(target.folder, item.name, item.entry.folder, item.name));
    return taken ? SystemError(ECANCELED, item.name) : taken.error;
}

Result<std::vector<TrashedItem>> LocalTrash::items()
{
    static constexpr platform::Operation op{"-[LocalTrash items]"};
    std::vector<TrashedItem> items;
    const auto trash = system::openFolder(_layout.trash());
    const auto names = trash     ? readNames(*trash)
        : trash.error.is(ENOENT) ? SystemResult<std::vector<std::string>>(std::vector<std::string>())
                                 : trash.error;
    if (!names)
        return itemError(names.error, _layout.trash());
    std::vector<std::string> empty;
    for (const auto& name : *names) {
        const bool isPlace = TrashPlace::isPlace(name);
        if (!isPlace && system::isPassingName(name))
            continue;
        const auto place = isPlace ? TrashPlace::open(*trash, _layout.trash(), name) : SystemError(ENOENT);
        const auto item = place ? place->item()
            : isPlace           ? place.error
                                : locateIn(*trash, _layout.trash(), name);
        const auto record = place ? place->record() : SystemError(ENOENT);
        if (item)
            items.push_back(describe(name, *item, record.value.value_or(std::nullopt)));
        else if (!item.error.is(ENOENT))
            op.warning("Cannot list %@ in the trash: %@", name, item.error);
        else if (place)
            empty.push_back(name);
    }
    dropEmptyPlaces(empty);
    std::ranges::move(contentsWithoutPromise(), std::back_inserter(items));
    std::ranges::sort(items, [](const TrashedItem& a, const TrashedItem& b) {
        return a.trashed != b.trashed ? a.trashed > b.trashed : a.identifier < b.identifier;
    });
    return items;
}

void LocalTrash::dropEmptyPlaces(const std::vector<std::string>& names) const
{
    const auto trash = names.empty() ? SystemError(ENOENT) : openTrash(_layout, LOCK_EX | LOCK_NB);
    for (const auto& name : names) {
        const auto place = trash ? TrashPlace::open(*trash, _layout.trash(), name) : trash.error;
        if (place)
            place->dropIfEmpty(*trash);
    }
}

Result<LocalTrash::Found> LocalTrash::find(const std::string& identifier) const
{
    const bool isPlace = TrashPlace::isPlace(identifier);
    if (identifier.empty() || identifier.find_first_of(std::string_view("/\0", 2)) != std::string::npos
        || identifier == "." || identifier == ".." || (!isPlace && system::isPassingName(identifier)))
        return notInTrash();
    auto trash = openTrash(_layout, LOCK_SH);
    if (!trash)
        return itemError(trash.error, _layout.trash());
    auto place = isPlace ? TrashPlace::open(*trash, _layout.trash(), identifier) : SystemError(ENOENT);
    auto item = place ? place->item() : isPlace ? place.error : locateIn(*trash, _layout.trash(), identifier);
    if (!item)
        return item.error.is(ENOENT) ? notInTrash() : itemError(item.error, _layout.trash());
    return Found{std::move(*trash), std::move(place.value), std::move(*item)};
}

Result<std::string> LocalTrash::restore(
    const std::string& identifier, const std::optional<std::string>& target)
{
    if (const auto content = contentIn(identifier))
        return restoreContent(*content, target);
    const auto found = find(identifier);
    if (!found)
        return *found.error;
    const auto& item = found->item;
    const auto origin = target ? *target : originOf(*found.value);
    if (!origin)
        return itemError(origin.error, item.entry.path);
    const auto path = origin->empty() ? _layout.defaultContainer() + '/' + item.entry.name : *origin;
    if (!system::isPathWithin(path, _layout.documents()))
        return itemError(EXDEV, path);
    if (auto error = _changes->createFolder(system::parentPath(path)))
        return *std::move(error);
    const auto entry = DriveEntry::open(_layout, path);
    if (!entry)
        return *entry.error;
    auto failure = entry->checkIsFree();
    if (!failure)
        failure = _changes->moveLocated(item, *entry.value);
    if (failure)
        return changeError(failure, path);
    const auto nameOnDisk = item.isPromise() ? entry->promiseName() : entry->name;
    if (found->place)
        found->place->dropIfEmpty(found->trash);
    else
        ::lremovexattr((descriptorPath(entry->folder) + '/' + nameOnDisk).c_str(), itemMark::origin);
    return path;
}

std::optional<Error> LocalTrash::remove(const std::string& identifier)
{
    if (const auto content = contentIn(identifier))
        return removeContent(*content);
    const auto found = find(identifier);
    if (!found)
        return found.error;
    if (const auto failure = _changes->removeLocated(found->item))
        return changeError(failure, found->item.entry.path);
    if (found->place)
        found->place->dropIfEmpty(found->trash);
    return std::nullopt;
}

std::optional<Error> LocalTrash::removeOlderThan(platform::Date moment)
{
    std::optional<Error> first;
    const auto trash = system::openFolder(_layout.trash());
    if (!trash)
        return trash.error.is(ENOENT) ? first : itemError(trash.error, _layout.trash());
    const auto names = readNames(*trash);
    for (const auto& name : names ? *names : std::vector<std::string>()) {
        const auto place =
            TrashPlace::isPlace(name) ? TrashPlace::open(*trash, _layout.trash(), name) : SystemError(ENOENT);
        const auto record = place ? place->record() : SystemError(ENOENT);
        if (!record || !*record || !isOlder(**record, moment))
            continue;
        const auto error = remove(name);
        // Another program may have restored or removed it meanwhile.
        if (error && !error->is(FileErrorCode::NoSuchItem) && !first)
            first = error;
    }
    return first || names ? first : itemError(names.error, _layout.trash());
}

TrashedItem LocalTrash::describe(
    const std::string& identifier, const LocatedItem& item, const std::optional<TrashRecord>& record) const
{
    TrashedItem described;
    described.identifier = identifier;
    described.name = item.entry.name;
    described.type = system::fileType(item.found.st_mode);
    described.isPromise = item.isPromise();
    const auto extension = described.name.substr(described.name.rfind('.') + 1);
    described.standsForAnother = described.type == platform::FileType::Regular
        && (extension == system::aliasExtension || extension == system::referenceExtension);
    if (S_ISREG(item.found.st_mode))
        described.size = static_cast<std::uint64_t>(item.found.st_size);
    if (described.isPromise) {
        const auto promise = OpenPromise::open(item.entry);
        described.size = promise ? promise->record.size : std::nullopt;
        if (promise && promise->record.kind != PromiseRecord::Kind::File)
            described.type = platform::FileType::Directory;
    }
    if (record) {
        described.origin = _layout.documents() + '/' + record->origin;
        described.trashed = record->trashed;
        described.reason = record->reason;
    } else {
        // A rename sets the time of the last change of the status, and nothing else has touched the item
        // since.
        described.origin = markedOrigin(_layout, item).value.value_or(std::string());
        described.trashed = platform::Date{versionOf(item.found).changed};
        described.reason = TrashedItem::Reason::NotPutBack;
    }
    return described;
}

SystemResult<std::string> LocalTrash::originOf(const Found& found) const
{
    const auto record =
        found.place ? found.place->record() : SystemResult<std::optional<TrashRecord>>(std::nullopt);
    if (!record)
        return record.error;
    return *record ? _layout.documents() + '/' + (*record)->origin : markedOrigin(_layout, found.item);
}

} // namespace host::drive
