// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/FileDescriptor.h"
#include "host/system/files/SystemError.h"
#include "platform/FileSystem.h"

#include <sys/types.h>

#include <functional>
#include <string>
#include <vector>

namespace host::system {

/// Walks through everything below a folder, without recursion. A folder's entries are reported together, then
/// those of its subfolders, one subfolder after the other. Names are resolved on descriptors and links are
/// never followed. A folder that is moved or replaced during the walk is reported as unreadable.
class DeepEnumeration {
public:
    using Continue = platform::FileSystem::Continue;
    using EntryHandler = std::function<Continue(const platform::Url&, platform::FileType)>;
    using ErrorHandler = std::function<Continue(const platform::Url&, const platform::Error&)>;

    DeepEnumeration(platform::Url folder, const EntryHandler& entry, const ErrorHandler& error)
        : _entry(entry)
        , _error(error)
        , _root(std::move(folder))
    {
    }

    void run();

private:
    /// A folder on the way from the root to the present folder of the walk.
    struct Level {
        std::string path;
        FileDescriptor descriptor; ///< closed while the walk is far below
        dev_t device;
        ino_t inode;
        std::vector<std::string> subfolders; ///< names that are still to be visited, the next one last
    };

    Continue enter(FileDescriptor descriptor, std::string path);
    Continue readEntries(Level& level);
    Continue report(const Level& level, std::string_view name, platform::FileType type);
    Continue descend();
    Continue leave();
    Continue fail(const std::string& path, const SystemError& failure);
    /// Answers whether the level's descriptor still refers to the folder with which the level began.
    static bool isAt(const Level& level);

    const EntryHandler& _entry;
    const ErrorHandler& _error;
    platform::Url _root;
    std::vector<Level> _levels;
};

} // namespace host::system
