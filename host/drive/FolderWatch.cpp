#include "host/drive/FolderWatch.h"

#include "host/system/FileDescriptor.h"

#include <glib-unix.h>
#include <sys/inotify.h>

#include <array>
#include <cstring>

namespace host::drive {

namespace {

using host::system::FileDescriptor;

constexpr std::uint32_t watchedEvents = IN_CLOSE_WRITE | IN_CREATE | IN_MOVED_TO | IN_MOVED_FROM | IN_DELETE
    | IN_ATTRIB | IN_DELETE_SELF | IN_MOVE_SELF | IN_ONLYDIR;
constexpr std::uint32_t wholeFolderEvents =
    IN_Q_OVERFLOW | IN_DELETE_SELF | IN_MOVE_SELF | IN_UNMOUNT | IN_IGNORED;

class InotifyFolderWatch : public FolderWatch {
public:
    InotifyFolderWatch(FileDescriptor descriptor, Handler handler)
        : _descriptor(std::move(descriptor))
        , _handler(std::move(handler))
    {
        _source = g_unix_fd_add(_descriptor.get(), G_IO_IN, &InotifyFolderWatch::readable, this);
    }
    ~InotifyFolderWatch() override { g_source_remove(_source); }

private:
    static gboolean readable(int, GIOCondition, gpointer self)
    {
        static_cast<InotifyFolderWatch*>(self)->drain();
        return G_SOURCE_CONTINUE;
    }

    void drain()
    {
        alignas(inotify_event) std::array<char, 8192> buffer;
        // A copy, because the handler may destroy the watch; then nothing more may be touched.
        const auto handler = _handler;
        const int descriptor = _descriptor.get();
        const std::weak_ptr<bool> alive = _alive;
        for (;;) {
            const auto length = ::read(descriptor, buffer.data(), buffer.size());
            if (length <= 0)
                return;
            for (ssize_t at = 0; at < length && !alive.expired();) {
                inotify_event event;
                std::memcpy(&event, buffer.data() + at, sizeof event);
                const char* name = buffer.data() + at + sizeof event;
                handler(event.len > 0 && !(event.mask & wholeFolderEvents) ? name : "");
                at += static_cast<ssize_t>(sizeof event + event.len);
            }
            if (alive.expired())
                return;
        }
    }

    FileDescriptor _descriptor;
    Handler _handler;
    unsigned _source = 0;
    std::shared_ptr<bool> _alive = std::make_shared<bool>(true);
};

} // namespace

std::unique_ptr<FolderWatch> FolderWatch::start(const std::string& folder, Handler handler)
{
    FileDescriptor descriptor(::inotify_init1(IN_CLOEXEC | IN_NONBLOCK));
    if (!descriptor || ::inotify_add_watch(descriptor.get(), folder.c_str(), watchedEvents) < 0)
        return nullptr;
    return std::make_unique<InotifyFolderWatch>(std::move(descriptor), std::move(handler));
}

} // namespace host::drive
