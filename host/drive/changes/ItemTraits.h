// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/FileDescriptor.h"
#include "host/system/files/SystemError.h"

#include <sys/types.h>

#include <map>
#include <string>

namespace host::drive {

/// Holds what an item has beside its name and its content: access rights, group and owner, and attributes.
/// A document gets all of it back when it is saved, evicted and downloaded, or copied to another file system.
struct ItemTraits {
    /// The user attributes and the access list, by name. Those that make a file a promise are left out
    /// (itemMark::promise, itemMark::type and system::promisedNameAttribute).
    std::map<std::string, std::string> attributes;
    mode_t mode = 0; ///< access rights
    uid_t owner = 0;
    gid_t group = 0;

    bool operator==(const ItemTraits&) const = default;

    /// Reads them from a file or folder that is open for reading.
    static system::SystemResult<ItemTraits> read(const system::FileDescriptor& item);
    /// Gives them to an open item. Where the group or the access list cannot be kept, the item's group may do
    /// nothing with it, because these rights were meant for others. A file system without attributes gets
    /// none.
    system::SystemError write(const system::FileDescriptor& item) const;
    /// Answers the traits without the attributes that a promise's record says instead.
    ItemTraits ofPromise() const;
    /// Gives an open item what has changed since `before`, and leaves the rest of it alone.
    system::SystemError writeChanges(const ItemTraits& before, const system::FileDescriptor& item) const;
};

} // namespace host::drive
