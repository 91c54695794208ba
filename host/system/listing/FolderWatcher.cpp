// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/listing/FolderWatcher.h"

#include "platform/Weakly.h"

#include <sys/inotify.h>

#include <mutex>

namespace host::system {

struct FolderWatcher::State : std::enable_shared_from_this<State> {
    Handler changed, written;
    std::unique_ptr<Inotify> inotify;
    std::mutex mutex;
    int watch = -1;

    void tell()
    {
        std::vector<std::string> names, namesWritten;
        {
            const std::lock_guard lock(mutex);
            for (auto& event : inotify->take()) {
                // Events of a folder that was watched before are ignored.
                if (event.watch != watch && event.watch >= 0)
                    continue;
                auto& told = event.mask == IN_MODIFY ? namesWritten : names;
                told.push_back(event.isLoss() ? std::string() : std::move(event.name));
            }
        }
        const auto keepsHandlers = shared_from_this();
        if (!names.empty())
            changed(names);
        if (!namesWritten.empty())
            written(namesWritten);
    }
};

FolderWatcher::FolderWatcher(Handler changed, Handler written)
    : _state(std::make_shared<State>())
{
    const auto writing = written ? Inotify::Writing::AtOnce : Inotify::Writing::WhenClosed;
    _state->changed = std::move(changed);
    _state->written = std::move(written);
    _state->inotify = std::make_unique<Inotify>(writing, platform::weakly(_state, &State::tell));
}

bool FolderWatcher::watch(const std::string& folder)
{
    const std::lock_guard lock(_state->mutex);
    const int watch = _state->inotify->watch(folder).value.value_or(-1);
    if (_state->watch >= 0 && _state->watch != watch)
        _state->inotify->unwatch(_state->watch);
    _state->watch = watch;
    return watch >= 0;
}

bool FolderWatcher::watch(const FileDescriptor& folder)
{
    return watch("/proc/self/fd/" + std::to_string(folder.get()));
}

} // namespace host::system
