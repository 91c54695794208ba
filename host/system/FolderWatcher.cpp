#include "host/system/FolderWatcher.h"

#include <glib-unix.h>
#include <sys/inotify.h>

#include <array>
#include <mutex>
#include <string>

namespace host::system {

namespace {

constexpr std::uint32_t events = IN_CREATE | IN_DELETE | IN_MOVED_FROM | IN_MOVED_TO | IN_CLOSE_WRITE
    | IN_ATTRIB | IN_DELETE_SELF | IN_MOVE_SELF | IN_ONLYDIR;

} // namespace

struct FolderWatcher::State {
    FileDescriptor inotify;
    std::function<void()> changed;
    guint source = 0;
    std::mutex mutex;
    int watch = -1;

    static gboolean readable(gint descriptor, GIOCondition, gpointer data)
    {
        alignas(inotify_event) std::array<char, 16 * 1024> buffer;
        while (::read(descriptor, buffer.data(), buffer.size()) > 0) { }
        // The handler may end the watcher.
        const auto state = static_cast<std::weak_ptr<State>*>(data)->lock();
        if (state)
            state->changed();
        return G_SOURCE_CONTINUE;
    }
};

FolderWatcher::FolderWatcher(std::function<void()> changed)
    : _state(std::make_shared<State>())
{
    _state->changed = std::move(changed);
    _state->inotify = FileDescriptor(inotify_init1(IN_NONBLOCK | IN_CLOEXEC));
    if (!_state->inotify)
        return; // too many watchers: the list is then as good as its last reading
    auto data = std::make_unique<std::weak_ptr<State>>(_state);
    _state->source = g_unix_fd_add_full(G_PRIORITY_DEFAULT, _state->inotify.get(), G_IO_IN, State::readable,
        data.release(), [](gpointer held) {
            std::unique_ptr<std::weak_ptr<State>>(static_cast<std::weak_ptr<State>*>(held));
        });
}

FolderWatcher::~FolderWatcher()
{
    if (_state->source)
        g_source_remove(_state->source);
}

void FolderWatcher::watch(const FileDescriptor& folder)
{
    if (!_state->inotify)
        return;
    // By descriptor, so that it is the folder that is read, whatever its path leads to meanwhile.
    const auto path = "/proc/self/fd/" + std::to_string(folder.get());
    const std::lock_guard lock(_state->mutex);
    const int watch = inotify_add_watch(_state->inotify.get(), path.c_str(), events);
    if (_state->watch >= 0 && _state->watch != watch)
        inotify_rm_watch(_state->inotify.get(), _state->watch);
    _state->watch = watch;
}

} // namespace host::system
