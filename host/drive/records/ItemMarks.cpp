// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/ItemMarks.h"

#include "host/drive/records/BeneathRoot.h"
#include "host/drive/records/PromiseFile.h"
#include "host/system/files/PosixFileSystem.h"

#include <sys/xattr.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <charconv>
#include <cstring>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using host::system::SystemResult;
using platform::DownloadingStatus;
using platform::SharedItemRole;

namespace {

constexpr std::size_t largestAttribute = 64 * 1024; // the kernel's own limit

/// Calls a function of the kernel with a small buffer, and with one of the largest size when that is needed.
template <typename Call>
SystemResult<std::string> readWith(const Call& call)
{
    std::array<char, 1024> small;
    auto length = call(small.data(), small.size());
    if (length >= 0)
        return std::string(small.data(), static_cast<std::size_t>(length));
    if (errno != ERANGE)
        return SystemError::last();
    std::string large(largestAttribute, '\0');
    length = call(large.data(), large.size());
    if (length < 0)
        return SystemError::last();
    large.resize(static_cast<std::size_t>(length));
    return large;
}

template <typename Number>
std::optional<Number> numberIn(std::string_view text)
{
    Number value = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value);
    return error == std::errc() && end == text.data() + text.size() ? std::optional(value) : std::nullopt;
}

std::uint32_t identifier(const std::optional<std::string>& text)
{
    return text ? numberIn<std::uint32_t>(*text).value_or(0) : 0;
}

std::optional<DownloadingStatus> statusNamed(std::string_view name)
{
    if (name == "current")
        return DownloadingStatus::Current;
    return name == "downloaded" ? std::optional(DownloadingStatus::Downloaded) : std::nullopt;
}

/// Answers whether a file system, or this kind of file, has no attributes of users.
bool saysNone(const SystemError& error)
{
    return error.is(ENODATA) || error.is(EOPNOTSUPP);
}

bool isMark(std::string_view name)
{
    static constexpr std::array names{std::string_view(itemMark::tags), std::string_view(itemMark::status),
        std::string_view(itemMark::documentIdentifier), std::string_view(itemMark::shared),
        std::string_view(itemMark::role), std::string_view(host::system::hiddenExtensionAttribute),
        std::string_view(itemMark::created)};
    return std::ranges::find(names, name) != names.end();
}

void setMark(ItemMarks& marks, std::string_view name, const std::string& value)
{
    if (name == itemMark::tags)
        marks.tags = splitTags(value);
    else if (name == itemMark::status)
        marks.status = statusNamed(value);
    else if (name == itemMark::documentIdentifier)
        marks.documentIdentifier = identifier(value);
    else if (name == itemMark::shared)
        marks.shared = value == "1";
    else if (name == itemMark::role)
        marks.role = roleNamed(value);
    else if (name == host::system::hiddenExtensionAttribute)
        marks.extensionHidden = value == "1";
    else if (name == itemMark::created) {
        if (const auto nanoseconds = numberIn<std::int64_t>(value))
            marks.created = platform::Date{*nanoseconds};
    }
}

} // namespace

AttributeReader::AttributeReader(std::string path)
    : _path(std::move(path))
    , _get(::lgetxattr)
    , _list(::llistxattr)
{
}

// The path of an open item is a link to it, so the calls that follow no link would ask the link.
AttributeReader::AttributeReader(const FileDescriptor& item)
    : _path(descriptorPath(item))
    , _get(::getxattr)
    , _list(::listxattr)
{
}

SystemResult<std::optional<std::string>> AttributeReader::value(const char* name) const
{
    auto value =
        readWith([&](char* into, std::size_t size) { return _get(_path.c_str(), name, into, size); });
    if (!value && !saysNone(value.error))
        return value.error;
    return std::move(value.value);
}

SystemResult<std::string> AttributeReader::names() const
{
    auto names = readWith([&](char* into, std::size_t size) { return _list(_path.c_str(), into, size); });
    return !names && saysNone(names.error) ? std::string() : std::move(names);
}

SystemError ItemMarks::update(const AttributeReader& item)
{
    SystemError failure;
    const auto names = item.names();
    if (!names)
        return names.error;
    for (const char* name = names->data(); name < names->data() + names->size();
         name += std::strlen(name) + 1) {
        if (!isMark(name))
            continue;
        const auto value = item.value(name);
        if (!value)
            failure = value.error;
        else if (*value)
            setMark(*this, name, **value);
    }
    return failure;
}

SystemResult<ItemMarks> ItemMarks::read(const AttributeReader& item, ItemMarks before)
{
    TRW_TRY(before.update(item));
    return before;
}

ItemMarks ItemMarks::glimpse(const AttributeReader& item)
{
    ItemMarks marks;
    static_cast<void>(marks.update(item));
    return marks;
}

std::optional<SharedItemRole> roleNamed(std::string_view name)
{
    if (name == "owner")
        return SharedItemRole::Owner;
    return name == "participant" ? std::optional(SharedItemRole::Participant) : std::nullopt;
}

const char* nameOf(SharedItemRole role)
{
    return role == SharedItemRole::Owner ? "owner" : "participant";
}

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
        return ItemMarks::glimpse(AttributeReader(path)).tags;
    auto promise = readPromise(PromiseRecord::pathFor(path));
    return promise ? std::move(promise.value->tags) : std::vector<std::string>();
}

SystemError writeTags(const FileDescriptor& item, const std::vector<std::string>& tags, WithoutTags without)
{
    const auto path = descriptorPath(item);
    const auto text = joinedTags(tags);
    if (!tags.empty() || without == WithoutTags::EmptyAttribute)
        return SystemError::unless(
            ::setxattr(path.c_str(), itemMark::tags, text.data(), text.size(), 0) == 0);
    const bool hasNone = ::removexattr(path.c_str(), itemMark::tags) == 0 || errno == ENODATA;
    return SystemError::unless(hasNone);
}

SystemResult<std::uint32_t> documentIdentifierOf(const FileDescriptor& item)
{
    const auto text = AttributeReader(item).value(itemMark::documentIdentifier);
    return text ? SystemResult<std::uint32_t>(identifier(*text)) : text.error;
}

std::uint32_t documentIdentifierAt(const std::string& path)
{
    const auto text = AttributeReader(path).value(itemMark::documentIdentifier);
    return text ? identifier(*text) : 0;
}

} // namespace host::drive
