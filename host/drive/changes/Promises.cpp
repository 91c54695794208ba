// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/Promises.h"

#include "host/drive/changes/CloudStore.h"
#include "host/drive/records/ItemFacts.h"
#include "host/system/files/DriveNames.h"

#include <fcntl.h>

#include <cerrno>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using host::system::SystemResult;

namespace {

constexpr int readFlags = O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_NOCTTY | O_CLOEXEC;

/// Answers whether the promise that is held names this content.
bool namesContent(const HeldItem& held, const std::string& content)
{
    const auto promise = OpenPromise::open(held.folder(), held.name());
    return promise && promise->record.content == content;
}

} // namespace

SystemResult<OpenPromise> OpenPromise::open(const FileDescriptor& folder, const std::string& promiseName)
{
    FileDescriptor file(::openat(folder.get(), promiseName.c_str(), readFlags));
    struct stat found;
    if (!file || ::fstat(file.get(), &found) != 0)
        return SystemError::last(promiseName);
    if (!S_ISREG(found.st_mode))
        return SystemError(EBADMSG, promiseName);
    auto record = readPromise(file);
    if (!record)
        return record.error;
    return OpenPromise{std::move(file), std::move(*record)};
}

PromiseRecord promiseFor(const FileDescriptor& document, const std::string& name, const std::string& content)
{
    const auto facts = lookAtOpenFile(document);
    PromiseRecord promise;
    if (facts.isDirectory())
        promise.kind = PromiseRecord::Kind::Package;
    else
        promise.size = facts.status.stx_size;
    promise.modified = facts.modified();
    promise.created = facts.created();
    promise.shared = facts.marks.shared;
    promise.role = facts.marks.role;
    promise.extensionHidden = facts.marks.extensionHidden;
    promise.documentIdentifier = facts.marks.documentIdentifier;
    promise.tags = facts.marks.tags;
    promise.content = content;
    if (name.size() > system::longestNameInPromise)
        promise.longName = name;
    return promise;
}

SystemResult<std::string> contentOfPromise(const FileDescriptor& folder, const std::string& promiseName)
{
    auto promise = OpenPromise::open(folder, promiseName);
    if (promise)
        return std::move(promise->record.content);
    // A damaged promise names no content that anybody could know. Any other error does not mean that there is
    // no content.
    const bool namesNone = promise.error.is(ENOENT) || promise.error.is(EBADMSG);
    return namesNone ? SystemResult<std::string>(std::string()) : promise.error;
}

SystemResult<HeldItem> takePromise(
    const DriveLayout& layout, const DriveEntry& entry, const std::string& content)
{
    auto held = HeldItem::take(layout, entry, entry.promiseName());
    if (held && !namesContent(*held, content))
        return SystemError(ESTALE, entry.promiseName());
    return held;
}

SystemError settleTwin(const DriveLayout& layout, const DriveEntry& entry, CloudStore& store)
{
    if (statusAt(entry.folder, entry.promiseName()).error.is(ENOENT))
        return {};
    const FileDescriptor document(::openat(entry.folder.get(), entry.name.c_str(), readFlags));
    if (!document)
        return SystemError::unless(errno == ENOENT, entry.name);
    const auto content = contentOfPromise(entry.folder, entry.promiseName());
    if (!content)
        return content.error;
    if (!content->empty() && store.holdsOtherThan(*content, document))
        return {};
    auto promise = takePromise(layout, entry, *content);
    if (!promise)
        return promise.error.is(ENOENT) || promise.error.is(ESTALE) ? SystemError() : promise.error;
    return promise->removePromise(store);
}

SystemError withdrawPromise(
    const DriveLayout& layout, const DriveEntry& entry, CloudStore& store, const std::string& content)
{
    const auto isInStore = store.has(content);
    if (isInStore.value_or(true))
        return {isInStore ? EEXIST : EIO, content};
    auto promise = takePromise(layout, entry, content);
    return promise ? promise->remove(nullptr) : promise.error;
}

} // namespace host::drive
