#pragma once

#include "host/system/FileDescriptor.h"
#include "platform/FileSystem.h"

#include <map>
#include <string>
#include <utility>

namespace host::drive {

/// Removes a name from an open folder, a folder with everything in it and no link's target. Goes down by
/// descriptors and keeps two of them, however deep the folders lie. Answers 0, or the errno of what could not
/// be removed; what was removed before that is gone.
int removeTree(const host::system::FileDescriptor& folder, const std::string& name);

/// The versions of an item and of everything in it, by device and inode.
using TreeVersions = std::map<std::pair<std::uint64_t, std::uint64_t>, platform::ItemVersion>;
/// Looks at all of them; answers 0 or the errno. The item's own time of change is left out: a rename sets it.
int readVersions(const host::system::FileDescriptor& folder, const std::string& name, TreeVersions& versions);

/// Copies an item under a new name, a folder with everything in it: contents, links as links, access, user
/// attributes and modification dates. Every file is synced and compared with what it was copied from. Answers
/// 0 or the errno; EOPNOTSUPP for what is no file, folder or link, ELOOP below 128 levels.
int copyTree(const host::system::FileDescriptor& folder, const std::string& name,
    const host::system::FileDescriptor& target, const std::string& newName);

} // namespace host::drive
