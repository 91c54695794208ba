// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/DownloadWork.h"

#include "host/drive/changes/HeldItem.h"
#include "host/drive/changes/ItemTraits.h"
#include "host/drive/changes/NewFile.h"
#include "host/drive/changes/Promises.h"
#include "host/drive/records/ItemMarks.h"
#include "host/drive/records/SmallFile.h"
#include "host/system/texts/Translate.h"

#include <fcntl.h>

#include <cerrno>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using host::system::SystemResult;
using platform::Error;

namespace {

constexpr std::int64_t nanosecondsPerSecond = 1'000'000'000;

/// A download that ended early must not take the place of the document.
SystemError checkSize(const NewFile& file, const PromiseRecord& promise)
{
    const auto bytes = file.bytes();
    if (!bytes)
        return bytes.error;
    return promise.size && *bytes < *promise.size ? SystemError(EIO) : SystemError();
}

/// Answers the traits of a promise for a folder. A promise that another program wrote has the access of a
/// file, and nobody could enter a folder with that.
ItemTraits ofFolder(ItemTraits traits)
{
    constexpr mode_t mayRead = S_IRUSR | S_IRGRP | S_IROTH;
    if ((traits.mode & S_IXUSR) == 0)
        traits.mode |= (traits.mode & mayRead) >> 2;
    return traits;
}

SystemError setModified(const FileDescriptor& file, const platform::Date& modified)
{
    auto seconds = modified.nanoseconds / nanosecondsPerSecond;
    auto rest = modified.nanoseconds % nanosecondsPerSecond;
    if (rest < 0) {
        --seconds;
        rest += nanosecondsPerSecond;
    }
    const timespec times[] = {{0, UTIME_OMIT}, {seconds, rest}};
    return SystemError::unless(::futimens(file.get(), times) == 0);
}

/// One promised document or folder that takes its promise's place.
class Arrival {
public:
    Arrival(const DriveLayout& layout, CloudStore& store, const DriveEntry& entry, OpenPromise& promise)
        : _layout(layout)
        , _store(store)
        , _entry(entry)
        , _promise(promise)
        , _isFolder(promise.record.kind != PromiseRecord::Kind::File)
    {
    }
    SystemError fetch(const CloudStore::Progress& progress);
    SystemError takePlace();

private:
    enum class Place : std::uint8_t { Promised, Taken };
    ItemTraits fitting(ItemTraits traits) const { return _isFolder ? ofFolder(std::move(traits)) : traits; }
    SystemError takeOver();
    SystemResult<Place> look() const;
    SystemError removePromise();
    SystemError adoptChanges();
    SystemError withdraw();

    const DriveLayout& _layout;
    CloudStore& _store;
    const DriveEntry& _entry;
    OpenPromise& _promise;
    const bool _isFolder;
    std::optional<NewFile> _file;
    ItemTraits _traits; ///< of the promise, as the document has taken them over
    TreeVersions _published;
};

SystemError Arrival::fetch(const CloudStore::Progress& progress)
{
    auto file = _isFolder ? NewFile::createFolder(_layout, _entry) : NewFile::create(_layout, _entry);
    if (!file)
        return file.error;
    _file.emplace(std::move(*file));
    TRW_TRY(_store.fetch(_promise.record.content, _file->descriptor(), progress));
    return checkSize(*_file, _promise.record);
}

/// Gives the new document what the promise says now, because tags, an identifier or access may have changed
/// during the download.
SystemError Arrival::takeOver()
{
    auto now = readPromise(_promise.file);
    if (!now)
        return now.error;
    auto traits = ItemTraits::read(_promise.file);
    if (!traits)
        return traits.error;
    _promise.record = std::move(*now);
    *traits = fitting(std::move(*traits));
    _traits = *traits;
    traits->attributes[itemMark::status] = "current";
    if (const auto identifier = _promise.record.documentIdentifier)
        traits->attributes[itemMark::documentIdentifier] = std::to_string(identifier);
    if (_promise.record.created)
        traits->attributes[itemMark::created] = std::to_string(_promise.record.created->nanoseconds);
    // The record comes first, because the attributes count before it and the access may forbid more writing.
    auto failure = writeMarks(_file->descriptor(), _promise.record);
    if (failure && !failure.is(EOPNOTSUPP))
        return failure;
    TRW_TRY(traits->write(_file->descriptor()));
    return _promise.record.modified ? setModified(_file->descriptor(), *_promise.record.modified)
                                    : SystemError();
}

/// Answers whether the promise is still in its place, or a document has taken it. Errors: ENOENT when there
/// is neither, ESTALE when another promise is there.
SystemResult<Arrival::Place> Arrival::look() const
{
    const auto content = contentOfPromise(_entry.folder, _entry.promiseName());
    if (!content)
        return content.error;
    if (*content == _promise.record.content)
        return Place::Promised;
    const auto document = _entry.status();
    if (!document)
        return document.error.is(ENOENT) && !content->empty() ? SystemError(ESTALE, _entry.promiseName())
                                                              : document.error;
    const bool isOfKind = _isFolder ? S_ISDIR(document->st_mode) : S_ISREG(document->st_mode);
    return isOfKind ? SystemResult<Place>(Place::Taken) : SystemError(EEXIST, _entry.name);
}

SystemError Arrival::takePlace()
{
    const auto place = look();
    if (!place)
        return place.error;
    if (*place == Place::Taken)
        return {};
    TRW_TRY(takeOver());
    auto versions = _file->versions();
    if (!versions)
        return versions.error;
    _published = std::move(*versions);
    // The promise and its content outlive a power cut that takes the new name, because both go later in the
    // same journal, and the content after a sync of everything.
    TRW_TRY(_file->publish(_entry, _entry.name, NewFile::Sync::Content));
    return removePromise();
}

/// Removes the promise. Whatever else is in its place stays, and so does the promise if it cannot be removed:
/// the document hides it until the next start settles both.
SystemError Arrival::removePromise()
{
    auto held = takePromise(_layout, _entry, _promise.record.content);
    if (held.error.is(ENOENT))
        return withdraw();
    if (held.error.is(ESTALE))
        return {};
    if (!held || adoptChanges() || held->removePromise(_store))
        _file->keepRecord();
    return {};
}

SystemError Arrival::adoptChanges()
{
    const auto now = ItemTraits::read(_promise.file);
    if (!now)
        return now.error;
    TRW_TRY(fitting(*now).writeChanges(_traits, _file->descriptor()));
    const auto record = readPromise(_promise.file);
    if (!record || record->documentIdentifier == _promise.record.documentIdentifier)
        return record.error;
    return writeIdentifier(_file->descriptor(), record->documentIdentifier);
}

/// Removes the new document, because another program took its promise away in the moment before: it must not
/// appear in its old place again. In doubt it stays, because one document too many is better than one too
/// few.
SystemError Arrival::withdraw()
{
    if (!_store.has(_promise.record.content).value_or(false))
        return {};
    auto held = HeldItem::take(_layout, _entry, _entry.name);
    if (!held)
        return {};
    const auto found = readVersions(held->folder(), held->name());
    const bool isGone = found && *found == _published && !held->remove(nullptr);
    return isGone ? SystemError(ENOENT, _entry.promiseName()) : SystemError();
}

bool isThere(const DriveEntry& entry)
{
    return static_cast<bool>(entry.find());
}

Error missingContent(const std::string& path)
{
    return cloudError(CloudErrorCode::MissingContent, path,
        system::textKey("The content of the document isn’t in the cloud."));
}

/// Makes one attempt, which a later eviction by another process defeats (ESTALE).
std::optional<Error> tryToBringHere(const DriveLayout& layout, CloudStore& store, const std::string& path,
    const CloudStore::Progress& progress, const KeepingOthersOut& keepingOthersOut)
{
    const auto item = LocatedItem::locate(layout, path);
    if (!item || !item->isPromise())
        return item.error;
    auto promise = OpenPromise::open(item->entry);
    if (!promise)
        return itemError(promise.error, path);
    const auto& record = promise->record;
    if (record.content.empty())
        return missingContent(path);
    Arrival arrival(layout, store, item->entry, *promise);
    auto failure = arrival.fetch(progress);
    if (failure.is(ENOENT) && store.has(record.content) == false && isThere(item->entry))
        return missingContent(path);
    if (!failure) {
        if (auto refused = keepingOthersOut([&] { failure = arrival.takePlace(); }))
            return refused;
    }
    return failure ? std::optional(itemError(failure, path)) : std::nullopt;
}

} // namespace

std::optional<Error> bringHere(const DriveLayout& layout, CloudStore& store, const std::string& path,
    const CloudStore::Progress& progress, const KeepingOthersOut& keepingOthersOut)
{
    constexpr int mostTries = 3;
    auto error = tryToBringHere(layout, store, path, progress, keepingOthersOut);
    for (int tries = 1; tries < mostTries && error && error->code() == ESTALE; ++tries)
        error = tryToBringHere(layout, store, path, progress, keepingOthersOut);
    return error;
}

} // namespace host::drive
