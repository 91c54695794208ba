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
PromiseRecord marked(PromiseRecord promise, const AttributeReader& file)
{
    auto marks = ItemMarks::read(file,
        {promise.shared, promise.role, promise.extensionHidden, {}, promise.documentIdentifier,
            std::move(promise.tags), promise.created});
    promise.shared = marks.shared;
    promise.role = marks.role;
    promise.extensionHidden = marks.extensionHidden;
    promise.documentIdentifier = marks.documentIdentifier;
    promise.tags = std::move(marks.tags);
    promise.created = marks.created;
    return promise;
}

/// Answers nothing for a file without the attribute.
std::optional<Result<PromiseRecord>> readShortForm(const AttributeReader& file, const std::string& path)
{
    const auto form = file.value(itemMark::promise);
    if (!form)
        return std::nullopt;
    auto promise = PromiseRecord::parseShortForm(*form);
    if (!promise)
        return damagedRecord(path, "its attribute holds no promise");
    if (auto type = file.value(itemMark::type))
        promise->type = std::move(*type);
    return marked(std::move(*promise), file);
}

/// Writes no empty attribute.
SystemError writeAttribute(const FileDescriptor& file, const char* name, const std::string& value)
{
    return SystemError::unless(
        value.empty() || ::fsetxattr(file.get(), name, value.data(), value.size(), 0) == 0, name);
}

Result<PromiseRecord> readJson(Result<std::string> text, const AttributeReader& file, const std::string& path)
{
    if (!text)
        return *text.error;
    auto promise = PromiseRecord::parse(*text);
    if (!promise)
        return damagedRecord(path, "it does not hold a promise");
    return marked(std::move(*promise), file);
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
    if (auto promise = readShortForm(file, path))
        return std::move(*promise);
    return readJson(readSmallFile(path, PromiseRecord::maximumFileSize), file, path);
}

SystemResult<PromiseRecord> readPromise(const FileDescriptor& file)
{
    const AttributeReader attributes(file);
    auto promise = readShortForm(attributes, {});
    if (!promise && ::lseek(file.get(), 0, SEEK_SET) != 0)
        return SystemError::last();
    if (!promise)
        promise = readJson(readSmallFile(file, {}, PromiseRecord::maximumFileSize), attributes, {});
    if (*promise)
        return std::move(*promise->value);
    const bool isDamaged = promise->error->domain() == platform::errorDomain::cloud;
    return SystemError(isDamaged ? EBADMSG : promise->error->code());
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
    auto promise = form ? PromiseRecord::parseShortForm(*form) : std::nullopt;
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
