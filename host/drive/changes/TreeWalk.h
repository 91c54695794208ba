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

/// What a walk through a folder calls. The walk ends with the first failure that one of them answers.
class TreeVisitor {
public:
    virtual ~TreeVisitor() = default;
    /// Something that is no folder, a link for instance.
    virtual system::SystemError visitItem(
        const system::FileDescriptor& folder, const std::string& name, const struct stat& found) = 0;
    /// A folder that was opened, before what lies in it.
    virtual system::SystemError enterFolder(const system::FileDescriptor& /*folder*/,
        const struct stat& /*self*/, const std::vector<std::string>& /*names*/)
    {
        return {};
    }
    /// The same folder, after everything in it.
    virtual system::SystemError leaveFolder(
        const system::FileDescriptor& /*parent*/, const std::string& /*name*/)
    {
        return {};
    }
};

/// Goes through an item and everything in it, by descriptors, of which it keeps two however deep the folders
/// lie. No link is followed, and nothing that is mounted in a folder entered (EBUSY). ESTALE when a folder
/// was moved away under the walk.
system::SystemError walkTree(
    const system::FileDescriptor& parent, const std::string& name, TreeVisitor& visitor);

/// The names in an open folder. They are read whole, because the folder may change meanwhile.
system::SystemResult<std::vector<std::string>> readNames(const system::FileDescriptor& folder);

/// Removes a name from an open folder, a folder with everything in it and no link's target. It fails with
/// what could not be removed; what was removed before that is gone.
system::SystemError removeTree(const system::FileDescriptor& folder, const std::string& name);

/// The versions of an item and of everything in it, by device and inode.
using TreeVersions = std::map<std::pair<std::uint64_t, std::uint64_t>, platform::ItemVersion>;
/// Looks at all of them. The item's own time of change is left out, because a rename sets it.
system::SystemResult<TreeVersions> readVersions(
    const system::FileDescriptor& folder, const std::string& name);

} // namespace host::drive
