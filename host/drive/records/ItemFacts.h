// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/PromiseRecord.h"
#include "host/system/files/FileDescriptor.h"
#include "host/system/files/SystemError.h"
#include "platform/Attributes.h"
#include "platform/Error.h"

#include <sys/stat.h>

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace host::drive {

/// The extended attributes of an item that the drive uses.
struct ItemMarks {
    bool shared = false;
    std::optional<platform::SharedItemRole> role;
    bool extensionHidden = false;
    std::optional<platform::DownloadingStatus> status;
    std::uint32_t documentIdentifier = 0; ///< 0: none
    std::vector<std::string> tags;

    /// Reads them; a malformed attribute counts as missing. It costs one system call for an item without
    /// attributes.
    static ItemMarks read(const std::string& path);
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
} // namespace itemMark
/// Answers tags as the text of their attribute, and the tags in such a text.
std::string joinedTags(const std::vector<std::string>& tags);
std::vector<std::string> splitTags(std::string_view text);
/// Answers the tags of the item at a path, or of its promise. It follows no link at the path's end, and
/// answers none for what cannot be read.
std::vector<std::string> tagsAt(const std::string& path, bool isPromise);
/// Answers the tags of an open item, which may be opened with O_PATH; none for a promise.
std::vector<std::string> tagsOf(const host::system::FileDescriptor& item);
/// Gives an open item tags in place of its own. The descriptor may be opened with O_PATH.
host::system::SystemError writeTags(
    const host::system::FileDescriptor& item, const std::vector<std::string>& tags);

/// The result of one look at a logical location: the item itself, else its promise.
struct ItemFacts {
    enum class Presence : std::uint8_t { Missing, Here, Promised };

    Presence presence = Presence::Missing;
    std::optional<platform::Error> error; ///< why the item is missing, or why its promise cannot be used
    struct statx status { }; ///< of a downloaded item
    PromiseRecord promise; ///< of a promised item
    std::string promisePath; ///< the path of the promise
    ItemMarks marks; ///< of a downloaded item

    bool isDirectory() const;
    /// Answers when the content was last changed, or nothing when the promise does not say it.
    std::optional<platform::Date> modified() const;
};

/// Looks at a location: the item and its extended attributes, else its promise. A promise that cannot be used
/// is an error, and each look at it logs one line.
ItemFacts lookAtItem(const std::string& path);
/// Looks at the file system's item at a location, never at a promise.
ItemFacts lookAtFile(const std::string& path);

/// Answers the document identifier that an open item carries; 0 for none. The descriptor may be opened with
/// O_PATH.
std::uint32_t documentIdentifierOf(const host::system::FileDescriptor& item);
/// Answers the document identifier of the item at a path, without following a link at its end.
std::uint32_t documentIdentifierAt(const std::string& path);

/// Answers whether anything exists at a path, without following links, or nothing when that cannot be told.
std::optional<bool> existsOnDisk(const std::string& path);

} // namespace host::drive
