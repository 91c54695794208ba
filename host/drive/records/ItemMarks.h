// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/FileDescriptor.h"
#include "host/system/files/SystemError.h"
#include "platform/Attributes.h"
#include "platform/Date.h"

#include <sys/types.h>

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace host::drive {

/// Reads the extended attributes of one item.
class AttributeReader {
public:
    /// Reads those of the item at a path, and follows no link at its end.
    explicit AttributeReader(std::string path);
    /// Reads those of an open item, which may be opened with O_PATH.
    explicit AttributeReader(const system::FileDescriptor& item);

    /// Answers the value of an attribute, or nothing when the item has none of this name. An attribute that
    /// cannot be read is an error, because it may well be there.
    system::SystemResult<std::optional<std::string>> value(const char* name) const;
    /// Answers the names of all attributes, each ended by a null character; empty where the file system has
    /// no attributes.
    system::SystemResult<std::string> names() const;

private:
    std::string _path;
    ssize_t (*_get)(const char*, const char*, void*, std::size_t);
    ssize_t (*_list)(const char*, char*, std::size_t);
};

/// The extended attributes of an item that the drive uses. A promise has the same ones.
struct ItemMarks {
    bool shared = false;
    std::optional<platform::SharedItemRole> role;
    bool extensionHidden = false;
    std::optional<platform::DownloadingStatus> status;
    std::uint32_t documentIdentifier = 0; ///< 0: none
    std::vector<std::string> tags;
    /// When the document was made, for one that the cloud gave back: the file system has the day of its
    /// download.
    std::optional<platform::Date> created;

    /// Reads them; a malformed attribute counts as missing, and one that cannot be read is an error. It costs
    /// one system call for an item without attributes. A mark without an attribute stays as it is in
    /// `before`.
    static system::SystemResult<ItemMarks> read(const AttributeReader& item, ItemMarks before);
    /// Reads those that can be read, for a look that changes nothing.
    static ItemMarks glimpse(const AttributeReader& item);

private:
    system::SystemError update(const AttributeReader& item);
};

/// The names of the extended attributes. The one that hides the extension is
/// host::system::hiddenExtensionAttribute.
namespace itemMark {
inline constexpr const char* shared = "user.tarrow.shared"; ///< "1"
inline constexpr const char* role = "user.tarrow.role"; ///< "owner" or "participant"
inline constexpr const char* status = "user.tarrow.status"; ///< "downloaded" or "current"
inline constexpr const char* documentIdentifier = "user.tarrow.document-id"; ///< decimal
inline constexpr const char* origin = "user.tarrow.origin"; ///< in the trash: the path where the item was
inline constexpr const char* tags = "user.xdg.tags"; ///< names separated by commas
inline constexpr const char* created = "user.tarrow.created"; ///< nanoseconds since 1970, decimal
inline constexpr const char* type = "user.tarrow.type"; ///< of a promise: its uniform type identifier
inline constexpr const char* promise = "user.trw.p"; ///< of a promise: see PromiseRecord::shortForm()
} // namespace itemMark

/// The names that roles have in promises and in extended attributes: "owner" and "participant".
std::optional<platform::SharedItemRole> roleNamed(std::string_view name);
const char* nameOf(platform::SharedItemRole role);

/// Answers tags as the text of their attribute, and the tags in such a text.
std::string joinedTags(const std::vector<std::string>& tags);
std::vector<std::string> splitTags(std::string_view text);
/// Answers the tags of the item at a path, or of its promise. It follows no link at the path's end, and
/// answers none for what cannot be read.
std::vector<std::string> tagsAt(const std::string& path, bool isPromise);
/// Says what an item without tags has: no attribute, or an empty one, which a promise needs because its
/// record may name tags.
enum class WithoutTags : std::uint8_t { NoAttribute, EmptyAttribute };
/// Gives an open item tags in place of its own. The descriptor may be opened with O_PATH.
system::SystemError writeTags(const system::FileDescriptor& item, const std::vector<std::string>& tags,
    WithoutTags without = WithoutTags::NoAttribute);

/// Answers the document identifier that an open item carries; 0 for none. The descriptor may be opened with
/// O_PATH.
system::SystemResult<std::uint32_t> documentIdentifierOf(const system::FileDescriptor& item);
/// Answers the document identifier of the item at a path, without following a link at its end; 0 for none,
/// and when it cannot be read.
std::uint32_t documentIdentifierAt(const std::string& path);

} // namespace host::drive
