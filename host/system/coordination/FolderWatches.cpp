// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/coordination/FolderWatches.h"

#include <sys/inotify.h>

namespace host::system {

SystemResult<int> FolderWatches::hold(const std::string& folder)
{
    auto watch = _inotify->watch(folder);
    if (watch)
        ++_holders[*watch];
    return watch;
}

void FolderWatches::release(int watch)
{
    const auto found = _holders.find(watch);
    if (found == _holders.end() || --found->second > 0)
        return;
    _holders.erase(found);
    _inotify->unwatch(watch);
}

std::vector<Inotify::Event> FolderWatches::take()
{
    auto events = _inotify->take();
    // The kernel has ended such a watch by itself and never uses its number again.
    for (const auto& event : events) {
        if (event.mask & IN_IGNORED)
            _holders.erase(event.watch);
    }
    return events;
}

} // namespace host::system
