// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/PromiseFile.h"

#include "host/drive/records/BeneathRoot.h"
#include "host/drive/records/ItemMarks.h"
#include "host/drive/records/SmallFile.h"
#include "host/system/files/AtomicWrite.h"
#include "host/system/files/DriveNames.h"
#include "host/system/files/ItemPaths.h"
#include "host/system/files/PosixFileSystem.h"
#include "host/system/files/PromisedNames.h"
#include "platform/Url.h"

#include <fcntl.h>
#include <sys/xattr.h>

#include <cerrno>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using host::system::SystemResult;
using platform::Result;

namespace {

/// Answers the promise with the marks that its file has.
SystemResult<PromiseRecord> marked(PromiseRecord promise, const AttributeReader& file)
{
    ItemMarks marks;
    marks.shared = promise.shared;
    marks.role = promise.role;
    marks.extensionHidden = promise.extensionHidden;
    marks.documentIdentifier = promise.documentIdentifier;
    marks.tags = std::move(promise.tags);
    marks.created = promise.created;
    auto read = ItemMarks::read(file, std::move(marks));
    if (!read)
        return read.error;
    promise.shared = read->shared;
    promise.role = read->role;
    promise.extensionHidden = read->extensionHidden;
    promise.documentIdentifier = read->documentIdentifier;
    promise.tags = std::move(read->tags);
    promise.created = read->created;
    return promise;
}

/// Answers a promise that is an attribute, or nothing for a file without one. Both this function and
/// readJson() answer EBADMSG, with the reason for the log, for what is no promise.
std::optional<SystemResult<PromiseRecord>> readShortForm(const AttributeReader& file)
{
    const auto form = file.value(itemMark::promise);
    if (!form)
        return form.error;
    if (!*form)
        return std::nullopt;
    auto promise = PromiseRecord::parseShortForm(**form);
    if (!promise)
        return SystemError(EBADMSG, "its attribute holds no promise");
    auto type = file.value(itemMark::type);
    if (!type)
        return type.error;
    if (*type)
        promise->type = std::move(**type);
    return marked(std::move(*promise), file);
}

SystemResult<PromiseRecord> readJson(const std::string& text, const AttributeReader& file)
{
    auto promise = PromiseRecord::parse(text);
    return promise ? marked(std::move(*promise), file)
                   : SystemResult<PromiseRecord>(SystemError(EBADMSG, "it does not hold a promise"));
}

/// Writes no empty attribute.
SystemError writeAttribute(const FileDescriptor& file, const char* name, const std::string& value)
{
    return SystemError::unless(
        value.empty() || ::fsetxattr(file.get(), name, value.data(), value.size(), 0) == 0, name);
}

} // namespace

Result<PromiseRecord> readPromise(const std::string& path)
{
    if (system::isLongPromiseName(system::lastName(path))) {
        const auto name = system::promisedName(path);
        if (name.error.is(EBADMSG))
            return damagedRecord(path, "it does not say the name that belongs to it");
        if (!name)
            return itemError(name.error, path);
    }
    const AttributeReader file(path);
    auto promise = readShortForm(file);
    if (!promise) {
        const auto text = readSmallFile(path, PromiseRecord::maximumFileSize);
        if (!text)
            return *text.error;
        promise = readJson(*text, file);
    }
    if (*promise)
        return std::move(*promise->value);
    const auto& failure = promise->error;
    return failure.is(EBADMSG) ? damagedRecord(path, failure.about()) : itemError(failure, path);
}

SystemResult<PromiseRecord> readPromise(const FileDescriptor& file)
{
    const AttributeReader attributes(file);
    if (auto promise = readShortForm(attributes))
        return std::move(*promise);
    if (::lseek(file.get(), 0, SEEK_SET) != 0)
        return SystemError::last();
    const auto text = readSmallFile(file, {}, PromiseRecord::maximumFileSize);
    if (text)
        return readJson(*text, attributes);
    const bool isDamaged = text.error->domain() == platform::errorDomain::cloud;
    return SystemError(isDamaged ? EBADMSG : text.error->code());
}

SystemError writePromise(const FileDescriptor& file, const PromiseRecord& promise)
{
    const auto form = promise.shortForm();
    if (::fsetxattr(file.get(), itemMark::promise, form.data(), form.size(), 0) == 0) {
        TRW_TRY(writeAttribute(file, system::promisedNameAttribute, promise.longName));
        return writeMarks(file, promise);
    }
    if (errno != EOPNOTSUPP)
        return SystemError::last();
    // JSON holds text only, and a name that is none would not be the item's any more.
    const bool canSayName = platform::isValidUtf8(promise.longName);
    return canSayName ? system::writeWhole(file, promise.toJson()) : SystemError(EILSEQ);
}

SystemError writeIdentifier(const FileDescriptor& file, std::uint32_t identifier)
{
    const auto path = descriptorPath(file);
    const auto form = AttributeReader(file).value(itemMark::promise);
    if (!form)
        return form.error;
    auto promise = *form ? PromiseRecord::parseShortForm(**form) : std::nullopt;
    const char* name = promise ? itemMark::promise : itemMark::documentIdentifier;
    if (promise)
        promise->documentIdentifier = identifier;
    const auto value = promise ? promise->shortForm() : std::to_string(identifier);
    return SystemError::unless(::setxattr(path.c_str(), name, value.data(), value.size(), 0) == 0);
}

SystemError writeMarks(const FileDescriptor& file, const PromiseRecord& promise)
{
    const std::pair<const char*, std::string> marks[] = {{itemMark::tags, joinedTags(promise.tags)},
        {itemMark::shared, promise.shared ? "1" : ""},
        {itemMark::role, promise.role ? nameOf(*promise.role) : ""},
        {system::hiddenExtensionAttribute, promise.extensionHidden ? "1" : ""},
        {itemMark::type, promise.type}};
    for (const auto& [name, value] : marks)
        TRW_TRY(writeAttribute(file, name, value));
    return {};
}

} // namespace host::drive
