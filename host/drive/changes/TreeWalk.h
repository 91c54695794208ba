// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/FileDescriptor.h"
#include "platform/FileSystem.h"

#include <sys/stat.h>

#include <map>
#include <string>
#include <utility>
#include <vector>

namespace host::drive {

/// What a walk through a folder calls. Each call answers 0 to go on, else the errno that the walk ends with.
class TreeVisitor {
public:
    virtual ~TreeVisitor() = default;
    /// Something that is no folder, a link for instance.
    virtual int visitItem(
        const system::FileDescriptor& folder, const std::string& name, const struct stat& found) = 0;
    /// A folder that was opened, before what lies in it.
    virtual int enterFolder(const system::FileDescriptor& /*folder*/, const struct stat& /*self*/,
        const std::vector<std::string>& /*names*/)
    {
        return 0;
    }
    /// The same folder, after everything in it.
    virtual int leaveFolder(const system::FileDescriptor& /*parent*/, const std::string& /*name*/)
    {
        return 0;
    }
};

/// Goes through an item and everything in it, by descriptors, of which it keeps two however deep the folders
/// lie. No link is followed, and nothing that is mounted in a folder entered (EBUSY). Answers 0 or the errno
/// (ESTALE when a folder was moved away under the walk).
int walkTree(const system::FileDescriptor& parent, const std::string& name, TreeVisitor& visitor);

/// The names in an open folder; answers 0 or the errno. Read whole, because the folder may change meanwhile.
int readNames(const system::FileDescriptor& folder, std::vector<std::string>& names);

/// Removes a name from an open folder, a folder with everything in it and no link's target. Answers 0, or the
/// errno of what could not be removed; what was removed before that is gone.
int removeTree(const system::FileDescriptor& folder, const std::string& name);

/// The versions of an item and of everything in it, by device and inode.
using TreeVersions = std::map<std::pair<std::uint64_t, std::uint64_t>, platform::ItemVersion>;
/// Looks at all of them; answers 0 or the errno. The item's own time of change is left out: a rename sets it.
int readVersions(const system::FileDescriptor& folder, const std::string& name, TreeVersions& versions);

} // namespace host::drive
