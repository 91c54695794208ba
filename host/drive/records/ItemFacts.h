// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/PromiseRecord.h"
#include "host/system/files/FileDescriptor.h"
#include "platform/Attributes.h"
#include "platform/Error.h"

#include <sys/stat.h>

#include <optional>
#include <string>
#include <vector>

namespace host::drive {

/// The extended attributes of an item that the drive knows.
struct ItemMarks {
    bool shared = false;
    std::optional<platform::SharedItemRole> role;
    bool extensionHidden = false;
    std::optional<platform::DownloadingStatus> status;
    std::uint32_t documentIdentifier = 0; ///< 0: none
    std::vector<std::string> tags;

    /// Reads them; what is malformed is as if it were not there. Costs one system call for an item without
    /// any.
    static ItemMarks read(const std::string& path);
};

/// Names of the extended attributes; the one that hides the extension is
/// host::system::hiddenExtensionAttribute.
namespace itemMark {
inline constexpr const char* shared = "user.tarrow.shared"; ///< "1"
inline constexpr const char* role = "user.tarrow.role"; ///< "owner" or "participant"
inline constexpr const char* status = "user.tarrow.status"; ///< "downloaded" or "current"
inline constexpr const char* documentIdentifier = "user.tarrow.document-id"; ///< decimal
inline constexpr const char* tags = "user.xdg.tags"; ///< names separated by commas
} // namespace itemMark
/// Tags as the text of their attribute.
std::string joinedTags(const std::vector<std::string>& tags);

/// What one look at a logical location found: the item itself, else its promise.
struct ItemFacts {
    enum class Presence : std::uint8_t { Missing, Here, Promised };

    Presence presence = Presence::Missing;
    std::optional<platform::Error> error; ///< why it is missing, or why its promise cannot be used
    struct statx status { }; ///< of the item that is here
    PromiseRecord promise; ///< of the one that is promised
    std::string promisePath; ///< where its promise lies
    ItemMarks marks; ///< of the item that is here

    bool isDirectory() const;
    /// When the content was last changed; nothing when the promise does not say.
    std::optional<platform::Date> modified() const;
};

/// Looks at a location: the item and its marks, else its promise. A promise that cannot be used is an error,
/// and one line of the log for each look.
ItemFacts lookAtItem(const std::string& path);
/// Looks at what lies at a location in the file system; never at a promise.
ItemFacts lookAtFile(const std::string& path);

/// The document identifier that an open item carries; 0 for none. A descriptor opened with O_PATH will do.
std::uint32_t documentIdentifierOf(const host::system::FileDescriptor& item);
/// The same of what lies at a path, the last link not followed.
std::uint32_t documentIdentifierAt(const std::string& path);

/// Whether anything is at a path, links not followed; nothing when it cannot be told.
std::optional<bool> existsOnDisk(const std::string& path);

} // namespace host::drive
