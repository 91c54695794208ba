// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/FileDescriptor.h"
#include "host/system/files/Inotify.h"

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace host::system {

/// Reports changes directly in one folder: names that were created or removed, were written or have other
/// attributes, and the disappearance of the folder itself.
class FolderWatcher {
public:
    /// Called on the main thread (in GLib's default main context) with the names, perhaps several times each,
    /// once for all changes that one turn of the loop brings. An empty name means that changes were lost or
    /// that the folder itself disappeared. The handler may destroy the watcher.
    using Handler = std::function<void(const std::vector<std::string>& names)>;

    /// `written` is called in the same way with the names of files whose content changes while they are open,
    /// perhaps without end. Without it such files are reported when they are closed.
    explicit FolderWatcher(Handler changed, Handler written = {});
    FolderWatcher(const FolderWatcher&) = delete;
    FolderWatcher& operator=(const FolderWatcher&) = delete;

    /// Watches a folder instead of the previous one. A descriptor means the very folder that is open. Any
    /// thread. Answers whether the folder is watched, because it may be missing and the system may have no
    /// watches left.
    bool watch(const std::string& folder);
    bool watch(const FileDescriptor& folder);

private:
    struct State;
    std::shared_ptr<State> _state;
};

} // namespace host::system
