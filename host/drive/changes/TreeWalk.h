// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/FileDescriptor.h"
#include "host/system/files/SystemError.h"
#include "platform/FileChanges.h"

#include <sys/stat.h>

#include <map>
#include <string>
#include <utility>
#include <vector>

namespace host::drive {

/// Is called for each item of a walk through a folder. The walk ends with the first error that a call
/// answers.
class TreeVisitor {
public:
    virtual ~TreeVisitor() = default;
    /// Visits an item that is not a folder, such as a link.
    virtual system::SystemError visitItem(
        const system::FileDescriptor& folder, const std::string& name, const struct stat& found) = 0;
    /// Visits a folder that was opened, before its contents.
    virtual system::SystemError enterFolder(const system::FileDescriptor& /*folder*/,
        const struct stat& /*self*/, const std::vector<std::string>& /*names*/)
    {
        return {};
    }
    /// Visits the same folder after its contents.
    virtual system::SystemError leaveFolder(
        const system::FileDescriptor& /*parent*/, const std::string& /*name*/)
    {
        return {};
    }
};

/// Says whether a walk enters a mount in a folder, or ends there (EBUSY).
enum class Mounts : std::uint8_t { Refuse, Enter };
/// Walks through an item and everything in it, with two descriptors however deep the folders lie. It follows
/// no link. ESTALE means that another program moved a folder away during the walk.
system::SystemError walkTree(const system::FileDescriptor& parent, const std::string& name,
    TreeVisitor& visitor, Mounts mounts = Mounts::Refuse);

/// Answers the names in an open folder. They are read at once, because the folder may change meanwhile.
system::SystemResult<std::vector<std::string>> readNames(const system::FileDescriptor& folder);

/// Removes a copy from an open folder, a folder with everything in it, also where the folder may not be
/// written in; a link's target stays. An error means that something could not be removed; what was removed
/// before stays removed.
system::SystemError removeTree(const system::FileDescriptor& folder, const std::string& name);

/// The versions of an item and of everything in it, by device and inode.
using TreeVersions = std::map<std::pair<std::uint64_t, std::uint64_t>, platform::ItemVersion>;
/// Reads all of these versions. The item's own status change time is left out, because a rename sets it.
system::SystemResult<TreeVersions> readVersions(
    const system::FileDescriptor& folder, const std::string& name);

} // namespace host::drive
