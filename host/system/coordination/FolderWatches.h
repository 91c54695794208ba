// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/Inotify.h"

#include <map>
#include <memory>
#include <string>

namespace host::system {

/// Watches of folders that several holders share. A folder is watched as long as one of them holds it.
class FolderWatches {
public:
    explicit FolderWatches(std::unique_ptr<Inotify> inotify)
        : _inotify(std::move(inotify))
    {
    }

    /// Adds a holder and answers the watch. The errors are those of Inotify::watch().
    SystemResult<int> hold(const std::string& folder);
    /// Removes a holder. A watch of -1 is ignored.
    void release(int watch);
    /// Answers the events in the watched folders since the last call.
    std::vector<Inotify::Event> take();

private:
    std::unique_ptr<Inotify> _inotify;
    std::map<int, int> _holders;
};

} // namespace host::system
