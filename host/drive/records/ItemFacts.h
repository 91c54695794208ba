// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/ItemMarks.h"
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
    /// Answers when the document was made, as far as that is known.
    std::optional<platform::Date> created() const;
};

/// Looks at a location: the item and its extended attributes, else its promise. A promise that cannot be used
/// is an error, and each look at it logs one line.
ItemFacts lookAtItem(const std::string& path);
/// Looks at the file system's item at a location, never at a promise.
ItemFacts lookAtFile(const std::string& path);
/// Looks at an open item, never at a promise. The descriptor may be opened with O_PATH.
ItemFacts lookAtOpenFile(const host::system::FileDescriptor& file);

/// Answers whether anything exists at a path, without following links, or nothing when that cannot be told.
std::optional<bool> existsOnDisk(const std::string& path);

} // namespace host::drive
