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

/// The attributes that can be read of an item. Each comment names the kind of the value first. An attribute
/// that an item does not have is missing from the map, which is no error.
enum class AttributeKey : std::uint8_t {
    Name, ///< text: the name as the bytes on disk
    /// Text, always UTF-8: the name for people. A hidden extension is left off, a container has its own name,
    /// and bytes that are no UTF-8 become replacement characters.
    LocalizedName,
    TypeIdentifier, ///< text: a uniform type identifier, typeIdentifier::data for what nobody knows
    LocalizedTypeDescription, ///< text, in the user's language; missing for a type without a description
    FileSize, ///< unsigned, bytes; missing for folders and for promises that do not give it
    TotalFileSize, ///< unsigned, bytes with all that belongs to the item; on Linux as FileSize
    CreationDate, ///< date; missing where the file system keeps none
    ContentModificationDate, ///< date; missing for promises that do not give it
    IsDirectory, ///< boolean, true for packages too
    IsRegularFile, ///< boolean, true for the promise of a file too
    IsPackage, ///< boolean: a folder that is shown as one document
    HasHiddenExtension, ///< boolean: the person does not want to see the extension
    ParentDirectoryURL, ///< URL of the folder that the item lies in
    IsShared, ///< boolean: other people have access to the item
    SharedItemRole, ///< SharedItemRole; missing for an item that is not shared
    DownloadingStatus, ///< DownloadingStatus; missing for an item that the cloud does not know
    /// ThumbnailMap; missing when there are none. It is decoded, or made when the desktop has none yet,
    /// before the reading ends, so it is read on worker threads alone.
    ThumbnailMap,
    DocumentIdentifier, ///< unsigned, 32 bits; missing for an item that carries none
};
/// The number of keys, for tables with a place for each.
inline constexpr std::size_t attributeKeyCount =
    static_cast<std::size_t>(AttributeKey::DocumentIdentifier) + 1;

/// Whether the account's user shares an item with others, or somebody else shares it with the user.
enum class SharedItemRole : std::uint8_t { Owner, Participant };

/// Says which part of an item's content is on this device.
enum class DownloadingStatus : std::uint8_t {
    NotDownloaded, ///< only the promise of the item is here
    Downloaded, ///< a copy is here, which may be older than the one in the cloud
    Current, ///< the newest copy is here
};

/// A small picture of an item's content.
struct Thumbnail {
    int pixelSize; ///< the size class: the longer side has at most so many pixels
    Image image;
    bool operator==(const Thumbnail&) const = default;
};
/// The thumbnails of an item, one for each size that there is.
using ThumbnailMap = std::vector<Thumbnail>;

/// The value of one attribute; std::monostate means that the item has no value for it.
using AttributeValue = std::variant<std::monostate, bool, std::uint64_t, std::string, Date, Url,
    SharedItemRole, DownloadingStatus, ThumbnailMap>;

/// Attribute values of one item. It is a flat table with a place for each key, because an item is read for
/// every row of a list: so a reading allocates only what its texts need. A map is a plain value; threads must
/// not share one that changes.
class AttributeMap {
public:
    /// Sets the value of a key, in place of the one before. A std::monostate removes it.
    void set(AttributeKey key, AttributeValue value) { _values[index(key)] = std::move(value); }
    /// Does the same with a value of one of the kinds, which is made in the table without a copy.
    template <typename T>
    requires(!std::same_as<std::remove_cvref_t<T>, AttributeValue>) void set(AttributeKey key, T&& value)
    {
        _values[index(key)] = std::forward<T>(value);
    }

    /// Whether there is a value for the key.
    bool has(AttributeKey key) const { return !std::holds_alternative<std::monostate>(_values[index(key)]); }
    /// The value of the key; std::monostate when there is none. The reference is valid until the key is set.
    const AttributeValue& value(AttributeKey key) const { return _values[index(key)]; }

    /// The value when there is one and it is of exactly this kind; null otherwise.
    template <typename T>
    const T* get(AttributeKey key) const
    {
        return std::get_if<T>(&_values[index(key)]);
    }

    /// A copy of the value when there is one and it is of exactly this kind; nothing otherwise.
    template <typename T>
    std::optional<T> optional(AttributeKey key) const
    {
        const T* found = get<T>(key);
        return found ? std::optional<T>(*found) : std::nullopt;
    }

    /// The value of a boolean attribute; a missing one counts as false.
    bool flag(AttributeKey key) const
    {
        const bool* found = get<bool>(key);
        return found && *found;
    }

private:
    static constexpr std::size_t index(AttributeKey key) { return static_cast<std::size_t>(key); }
    std::array<AttributeValue, attributeKeyCount> _values;
};

/// The keys that a reading is asked for. The caller keeps them until the reading ends.
using AttributeKeys = std::span<const AttributeKey>;

} // namespace platform
