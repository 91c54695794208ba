#include "host/system/FolderWatcher.h"

#include <mutex>

namespace host::system {

struct FolderWatcher::State {
    Handler changed;
    std::unique_ptr<Inotify> inotify;
    std::mutex mutex;
    int watch = -1;

    void tell()
    {
        std::vector<std::string> names;
        {
            const std::lock_guard lock(mutex);
            for (auto& event : inotify->take()) {
                // What is left of a former folder's events concerns nobody.
                if (event.watch != watch && event.watch >= 0)
                    continue;
                names.push_back(event.isLoss() ? std::string() : std::move(event.name));
            }
        }
        if (!names.empty())
            changed(names);
    }
};

FolderWatcher::FolderWatcher(Handler changed)
    : _state(std::make_shared<State>())
{
    _state->changed = std::move(changed);
    _state->inotify = std::make_unique<Inotify>(Inotify::Writing::WhenClosed, [weak = std::weak_ptr(_state)] {
        if (const auto state = weak.lock())
            state->tell();
    });
}

bool FolderWatcher::watch(const std::string& folder)
{
    const std::lock_guard lock(_state->mutex);
    const int watch = _state->inotify->watch(folder);
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
