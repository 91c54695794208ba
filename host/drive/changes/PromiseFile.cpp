// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/PromiseFile.h"

#include "host/drive/records/SmallFile.h"
#include "host/system/files/AtomicWrite.h"
#include "host/system/files/SystemErrors.h"

#include <fcntl.h>

#include <cerrno>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemResult;

platform::Result<PromiseRecord> readPromise(const DriveEntry& entry)
{
    const auto text =
        host::system::readWholeFile(entry.folder, entry.promiseName(), PromiseRecord::maximumFileSize);
    if (!text)
        return host::system::systemError(text.error, entry.path);
    auto promise = PromiseRecord::parse(*text);
    return promise ? platform::Result<PromiseRecord>(std::move(*promise))
                   : damagedRecord(entry.path, "its promise is no JSON object");
}

SystemResult<std::string> contentOfPromise(const FileDescriptor& folder, const std::string& promiseName)
{
    const auto text = host::system::readWholeFile(folder, promiseName, PromiseRecord::maximumFileSize);
    // A promise that is gone has no content, and one that is too large counts as damaged. Any other error
    // does not mean that there is no content.
    if (!text && !text.error.is(ENOENT) && !text.error.is(EFBIG))
        return text.error;
    const auto promise = text ? PromiseRecord::parse(*text) : std::nullopt;
    return promise ? promise->content : std::string();
}

void dropRedundantPromise(const DriveEntry& entry, CloudStore& store)
{
    if (!entry.status())
        return;
    const auto promise = readPromise(entry);
    if (!promise)
        return;
    const FileDescriptor document(::openat(
        entry.folder.get(), entry.name.c_str(), O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_NOCTTY | O_CLOEXEC));
    const auto& content = promise->content;
    if (!content.empty() && store.holdsOtherThan(content, document))
        return;
    // The content is removed first: a promise without a content can still be found again, but a content
    // without a promise cannot.
    if (content.empty() || !store.remove(content))
        ::unlinkat(entry.folder.get(), entry.promiseName().c_str(), 0);
}

} // namespace host::drive
