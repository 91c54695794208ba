// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/ItemFacts.h"

#include "host/drive/records/BeneathRoot.h"
#include "host/drive/records/SmallFile.h"
#include "host/system/files/FileVersion.h"
#include "host/system/files/PosixFileSystem.h"
#include "platform/Log.h"

#include <fcntl.h>
#include <sys/xattr.h>

#include <array>
#include <cerrno>
#include <charconv>
#include <cstring>

namespace host::drive {

namespace {

using host::system::SystemError;
using platform::DownloadingStatus;

constexpr std::size_t largestAttribute = 64 * 1024; // the kernel's own limit

std::string attributeValue(const std::string& path, const char* name)
{
    std::array<char, 256> small;
    auto length = ::lgetxattr(path.c_str(), name, small.data(), small.size());
    if (length >= 0)
        return {small.data(), static_cast<std::size_t>(length)};
    if (errno != ERANGE)
        return {};
    std::string large(largestAttribute, '\0');
    length = ::lgetxattr(path.c_str(), name, large.data(), large.size());
    large.resize(length < 0 ? 0 : static_cast<std::size_t>(length));
    return large;
}

std::uint32_t identifier(const std::string& text)
{
    std::uint32_t value = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value);
    return error == std::errc() && end == text.data() + text.size() ? value : 0;
}

std::optional<DownloadingStatus> statusNamed(std::string_view name)
{
    if (name == "current")
        return DownloadingStatus::Current;
    return name == "downloaded" ? std::optional(DownloadingStatus::Downloaded) : std::nullopt;
}

void readMark(ItemMarks& marks, const std::string& path, std::string_view name)
{
    if (name == itemMark::tags)
        marks.tags = splitTags(attributeValue(path, itemMark::tags));
    else if (name == itemMark::status)
        marks.status = statusNamed(attributeValue(path, itemMark::status));
    else if (name == itemMark::documentIdentifier)
        marks.documentIdentifier = identifier(attributeValue(path, itemMark::documentIdentifier));
    else if (name == itemMark::shared)
        marks.shared = attributeValue(path, itemMark::shared) == "1";
    else if (name == itemMark::role)
        marks.role = roleNamed(attributeValue(path, itemMark::role));
    else if (name == host::system::hiddenExtensionAttribute)
        marks.extensionHidden = attributeValue(path, host::system::hiddenExtensionAttribute) == "1";
}

bool hasMarks(const struct statx& status)
{
    // Linux keeps user attributes only for files and folders.
    return S_ISREG(status.stx_mode) || S_ISDIR(status.stx_mode);
}

SystemError readStatus(ItemFacts& facts, const std::string& path)
{
    constexpr unsigned mask = STATX_TYPE | STATX_MODE | STATX_SIZE | STATX_MTIME | STATX_BTIME | STATX_INO;
    constexpr int flags = AT_SYMLINK_NOFOLLOW | AT_NO_AUTOMOUNT | AT_STATX_DONT_SYNC;
    return SystemError::unless(::statx(AT_FDCWD, path.c_str(), flags, mask, &facts.status) == 0);
}

void readPromise(ItemFacts& facts, const std::string& itemPath, const SystemError& missingReason)
{
    static constexpr platform::Operation op{"-[LocalPromisedItems readPromise:]"};
    auto path = PromiseRecord::pathFor(itemPath);
    const auto text = readSmallFile(path, PromiseRecord::maximumFileSize);
    if (text.error
        && (text.error->is(platform::FileErrorCode::NoSuchItem)
            || text.error->is(platform::FileErrorCode::InvalidName))) {
        facts.error = itemError(missingReason, itemPath);
        return;
    }
    facts.presence = ItemFacts::Presence::Promised;
    auto promise = text ? PromiseRecord::parse(*text) : std::nullopt;
    if (promise)
        facts.promise = std::move(*promise);
    else
        facts.error = text ? damagedRecord(path, "it does not hold a promise") : *text.error;
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
        facts.marks = ItemMarks::read(path);
}

} // namespace

std::string joinedTags(const std::vector<std::string>& tags)
{
    std::string text;
    for (const auto& tag : tags)
        text.append(text.empty() ? "" : ",").append(tag);
    return text;
}

std::vector<std::string> splitTags(std::string_view text)
{
    std::vector<std::string> tags;
    while (!text.empty()) {
        const auto end = std::min(text.find(','), text.size());
        if (end > 0 && platform::isValidUtf8(text.substr(0, end)))
            tags.emplace_back(text.substr(0, end));
        text.remove_prefix(std::min(end + 1, text.size()));
    }
    return tags;
}

std::vector<std::string> tagsAt(const std::string& path, bool isPromise)
{
    if (!isPromise)
        return splitTags(attributeValue(path, itemMark::tags));
    const auto text = readSmallFile(PromiseRecord::pathFor(path), PromiseRecord::maximumFileSize);
    auto promise = text ? PromiseRecord::parse(*text) : std::nullopt;
    return promise ? std::move(promise->tags) : std::vector<std::string>();
}

std::vector<std::string> tagsOf(const host::system::FileDescriptor& item)
{
    // The descriptor's own path is a link to the item, so the call that follows no link would ask the link.
    std::string text(largestAttribute, '\0');
    const auto length = ::getxattr(descriptorPath(item).c_str(), itemMark::tags, text.data(), text.size());
    text.resize(length < 0 ? 0 : static_cast<std::size_t>(length));
    return splitTags(text);
}

SystemError writeTags(const host::system::FileDescriptor& item, const std::vector<std::string>& tags)
{
    const auto path = descriptorPath(item);
    const auto text = joinedTags(tags);
    if (!tags.empty())
        return SystemError::unless(
            ::setxattr(path.c_str(), itemMark::tags, text.data(), text.size(), 0) == 0);
    const bool hasNone = ::removexattr(path.c_str(), itemMark::tags) == 0 || errno == ENODATA;
    return SystemError::unless(hasNone);
}

ItemMarks ItemMarks::read(const std::string& path)
{
    ItemMarks marks;
    std::array<char, 1024> small;
    std::string large;
    const char* names = small.data();
    auto length = ::llistxattr(path.c_str(), small.data(), small.size());
    if (length < 0 && errno == ERANGE) {
        large.resize(largestAttribute);
        length = ::llistxattr(path.c_str(), large.data(), large.size());
        names = large.data();
    }
    for (const char* name = names; length > 0 && name < names + length; name += std::strlen(name) + 1) {
        if (std::string_view(name).starts_with("user."))
            readMark(marks, path, name);
    }
    return marks;
}

bool ItemFacts::isDirectory() const
{
    return presence == Presence::Promised ? promise.kind != PromiseRecord::Kind::File
                                          : S_ISDIR(status.stx_mode);
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
        readPromise(facts, path, failure);
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

std::uint32_t documentIdentifierOf(const host::system::FileDescriptor& item)
{
    std::array<char, 32> value;
    const auto length =
        ::getxattr(descriptorPath(item).c_str(), itemMark::documentIdentifier, value.data(), value.size());
    return length > 0 ? identifier({value.data(), static_cast<std::size_t>(length)}) : 0;
}

std::uint32_t documentIdentifierAt(const std::string& path)
{
    std::array<char, 32> value;
    const auto length = ::lgetxattr(path.c_str(), itemMark::documentIdentifier, value.data(), value.size());
    return length > 0 ? identifier({value.data(), static_cast<std::size_t>(length)}) : 0;
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
