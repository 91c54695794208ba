// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/ItemFacts.h"

#include "host/drive/records/BeneathRoot.h"
#include "host/drive/records/PromiseFile.h"
#include "host/drive/records/SmallFile.h"
#include "host/system/files/FileVersion.h"
#include "platform/Log.h"

#include <fcntl.h>

#include <cerrno>

namespace host::drive {

namespace {

using host::system::SystemError;

bool hasMarks(const struct statx& status)
{
    // Linux keeps user attributes only for files and folders.
    return S_ISREG(status.stx_mode) || S_ISDIR(status.stx_mode);
}

SystemError readStatus(ItemFacts& facts, int folder, const char* path, int flags)
{
    constexpr unsigned mask = STATX_TYPE | STATX_MODE | STATX_SIZE | STATX_MTIME | STATX_BTIME | STATX_INO;
    constexpr int always = AT_NO_AUTOMOUNT | AT_STATX_DONT_SYNC;
    return SystemError::unless(::statx(folder, path, flags | always, mask, &facts.status) == 0);
}

SystemError readStatus(ItemFacts& facts, const std::string& path)
{
    return readStatus(facts, AT_FDCWD, path.c_str(), AT_SYMLINK_NOFOLLOW);
}

void describePromise(ItemFacts& facts, const std::string& itemPath, const SystemError& missingReason)
{
    static constexpr platform::Operation op{"-[LocalPromisedItems readPromise:]"};
    auto path = PromiseRecord::pathFor(itemPath);
    auto promise = drive::readPromise(path);
    if (promise.error
        && (promise.error->is(platform::FileErrorCode::NoSuchItem)
            || promise.error->is(platform::FileErrorCode::InvalidName))) {
        facts.error = itemError(missingReason, itemPath);
        return;
    }
    facts.presence = ItemFacts::Presence::Promised;
    if (promise)
        facts.promise = std::move(*promise.value);
    else
        facts.error = std::move(promise.error);
    if (facts.error)
        op.error("Cannot use the promise %@: %@", path, reasonOf(*facts.error));
    facts.promisePath = std::move(path);
}

/// Sets the facts of a file from the result of its stat call.
void describeFile(ItemFacts& facts, const std::string& path, const SystemError& failure)
{
    if (failure) {
        facts.error = itemError(failure, path);
        return;
    }
    facts.presence = ItemFacts::Presence::Here;
    if (hasMarks(facts.status))
        facts.marks = ItemMarks::glimpse(AttributeReader(path));
}

} // namespace

bool ItemFacts::isDirectory() const
{
    return presence == Presence::Promised ? promise.kind != PromiseRecord::Kind::File
                                          : S_ISDIR(status.stx_mode);
}

std::optional<platform::Date> ItemFacts::created() const
{
    if (presence == Presence::Promised)
        return promise.created;
    if (marks.created)
        return marks.created;
    return status.stx_mask & STATX_BTIME ? std::optional(host::system::dateOf(status.stx_btime))
                                         : std::nullopt;
}

std::optional<platform::Date> ItemFacts::modified() const
{
    if (presence == Presence::Promised)
        return promise.modified;
    return host::system::dateOf(status.stx_mtime);
}

ItemFacts lookAtItem(const std::string& path)
{
    ItemFacts facts;
    if (const auto failure = readStatus(facts, path); failure.is(ENOENT))
        describePromise(facts, path, failure);
    else
        describeFile(facts, path, failure);
    return facts;
}

ItemFacts lookAtFile(const std::string& path)
{
    ItemFacts facts;
    describeFile(facts, path, readStatus(facts, path));
    return facts;
}

ItemFacts lookAtOpenFile(const host::system::FileDescriptor& file)
{
    ItemFacts facts;
    if (const auto failure = readStatus(facts, file.get(), "", AT_EMPTY_PATH)) {
        facts.error = itemError(failure, descriptorPath(file));
        return facts;
    }
    facts.presence = ItemFacts::Presence::Here;
    if (hasMarks(facts.status))
        facts.marks = ItemMarks::glimpse(AttributeReader(file));
    return facts;
}

std::optional<bool> existsOnDisk(const std::string& path)
{
    struct statx found;
    constexpr int flags = AT_SYMLINK_NOFOLLOW | AT_NO_AUTOMOUNT | AT_STATX_DONT_SYNC;
    if (::statx(AT_FDCWD, path.c_str(), flags, 0, &found) == 0)
        return true;
    return errno == ENOENT || errno == ENOTDIR || errno == ENAMETOOLONG ? std::optional(false) : std::nullopt;
}

} // namespace host::drive
