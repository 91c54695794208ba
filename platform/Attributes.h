// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Date.h"
#include "platform/Image.h"
#include "platform/Url.h"

#include <array>
#include <concepts>
#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <type_traits>
#include <utility>
#include <variant>
#include <vector>

namespace platform {

/// The attributes that can be read of an item. The comment names the kind of its value.
enum class AttributeKey : std::uint8_t {
    Name, ///< text
    LocalizedName, ///< text
    TypeIdentifier, ///< text, a uniform type identifier
    LocalizedTypeDescription, ///< text
    FileSize, ///< unsigned, bytes
    TotalFileSize, ///< unsigned, bytes with everything that belongs to the item
    CreationDate, ///< date
    ContentModificationDate, ///< date
    IsDirectory, ///< boolean, true for packages too
    IsRegularFile, ///< boolean
    IsPackage, ///< boolean
    HasHiddenExtension, ///< boolean
    ParentDirectoryURL, ///< URL
    IsShared, ///< boolean
    SharedItemRole, ///< SharedItemRole
    DownloadingStatus, ///< DownloadingStatus; missing for an item that the cloud does not know
    ThumbnailMap, ///< thumbnails by size
    DocumentIdentifier, ///< unsigned, 32 bits
};
inline constexpr std::size_t attributeKeyCount =
    static_cast<std::size_t>(AttributeKey::DocumentIdentifier) + 1;

enum class SharedItemRole : std::uint8_t { Owner, Participant };

/// Downloaded: a copy is here, perhaps an old one; Current: the newest one is.
enum class DownloadingStatus : std::uint8_t { NotDownloaded, Downloaded, Current };

/// Thumbnails of an item by the length of their longer side in pixels.
struct Thumbnail {
    int pixelSize;
    Image image;
    bool operator==(const Thumbnail&) const = default;
};
using ThumbnailMap = std::vector<Thumbnail>;

using AttributeValue = std::variant<std::monostate, bool, std::uint64_t, std::string, Date, Url,
    SharedItemRole, DownloadingStatus, ThumbnailMap>;

/// Attribute values of one item: a flat table with a place for each key, so that reading an item allocates
/// only what its texts need.
class AttributeMap {
public:
    void set(AttributeKey key, AttributeValue value) { _values[index(key)] = std::move(value); }
    /// The same for a value of one of the kinds, which is made in its place.
    template <typename T>
    requires(!std::same_as<std::remove_cvref_t<T>, AttributeValue>) void set(AttributeKey key, T&& value)
    {
        _values[index(key)] = std::forward<T>(value);
    }

    bool has(AttributeKey key) const { return !std::holds_alternative<std::monostate>(_values[index(key)]); }
    const AttributeValue& value(AttributeKey key) const { return _values[index(key)]; }

    /// The value when it is there and of just this kind, else null.
    template <typename T>
    const T* get(AttributeKey key) const
    {
        return std::get_if<T>(&_values[index(key)]);
    }

    /// The value when it is there and of just this kind.
    template <typename T>
    std::optional<T> optional(AttributeKey key) const
    {
        const T* found = get<T>(key);
        return found ? std::optional<T>(*found) : std::nullopt;
    }

    /// A boolean attribute; a missing one is false.
    bool flag(AttributeKey key) const
    {
        const bool* found = get<bool>(key);
        return found && *found;
    }

private:
    static constexpr std::size_t index(AttributeKey key) { return static_cast<std::size_t>(key); }
    std::array<AttributeValue, attributeKeyCount> _values;
};

using AttributeKeys = std::span<const AttributeKey>;

} // namespace platform
