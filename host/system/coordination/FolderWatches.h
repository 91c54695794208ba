// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/Inotify.h"

#include <map>
#include <memory>
#include <string>

namespace host::system {

/// Watches of folders that several may hold at once: a folder is watched as long as one of them holds it.
class FolderWatches {
public:
    explicit FolderWatches(std::unique_ptr<Inotify> inotify)
        : _inotify(std::move(inotify))
    {
    }

    /// One more holder. Answers the watch; errors as Inotify::watch().
    SystemResult<int> hold(const std::string& folder);
    /// One holder less; -1 is nobody's watch.
    void release(int watch);
    /// What happened in the watched folders since the last call.
    std::vector<Inotify::Event> take();

private:
    std::unique_ptr<Inotify> _inotify;
    std::map<int, int> _holders;
};

} // namespace host::system
