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

/// Tells what changes directly in one folder: names that came or went, were written, or have other
/// attributes, or that the folder itself went away.
class FolderWatcher {
public:
    /// Called on the main thread (in GLib's default main context), once for all changes that one turn of the
    /// loop brings: with the names, perhaps several times each. An empty name: changes were lost, or the
    /// folder itself went away. It may end the watcher.
    using Handler = std::function<void(const std::vector<std::string>& names)>;

    /// `written` is called, in the same way, with the names of files whose content changes while they are
    /// open, perhaps without end; without it they are told of when they are closed.
    explicit FolderWatcher(Handler changed, Handler written = {});
    FolderWatcher(const FolderWatcher&) = delete;
    FolderWatcher& operator=(const FolderWatcher&) = delete;

    /// Watches a folder instead of what was watched before; by descriptor it is the very folder that is open.
    /// Any thread. Answers whether it is watched: it may be missing, or the system may have no watches left.
    bool watch(const std::string& folder);
    bool watch(const FileDescriptor& folder);

private:
    struct State;
    std::shared_ptr<State> _state;
};

} // namespace host::system
