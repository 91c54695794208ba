// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/files/Inotify.h"

#include "host/system/files/FileDescriptor.h"

#include <glib-unix.h>
#include <sys/inotify.h>

#include <array>
#include <cerrno>
#include <cstring>
#include <mutex>

namespace host::system {

namespace {

constexpr std::uint32_t watchedEvents = IN_CREATE | IN_DELETE | IN_MOVED_FROM | IN_MOVED_TO | IN_CLOSE_WRITE
    | IN_ATTRIB | IN_DELETE_SELF | IN_MOVE_SELF | IN_ONLYDIR;
constexpr std::uint32_t lossEvents = IN_Q_OVERFLOW | IN_DELETE_SELF | IN_MOVE_SELF | IN_UNMOUNT | IN_IGNORED;
// The kernel keeps as many events by default. When more are waiting, reading the folder again is quicker.
constexpr std::size_t mostEvents = 16'384;

} // namespace

bool Inotify::Event::isLoss() const
{
    return (mask & lossEvents) != 0;
}

struct Inotify::State {
    FileDescriptor descriptor;
    std::uint32_t events = watchedEvents;
    std::function<void()> arrived;
    guint source = 0;
    std::mutex mutex;
    std::vector<Event> waiting;

    static bool open(const std::shared_ptr<State>& state);
    void read();
    void append(const char* bytes, std::size_t length);
    static gboolean readable(gint, GIOCondition, gpointer data);
};

void Inotify::State::append(const char* bytes, std::size_t length)
{
    for (std::size_t at = 0; at < length;) {
        inotify_event event;
        std::memcpy(&event, bytes + at, sizeof event);
        if (waiting.size() >= mostEvents)
            waiting.assign(1, Event{-1, IN_Q_OVERFLOW, 0, {}});
        // A file that is being written causes the same event again and again.
        const char* name = event.len > 0 ? bytes + at + sizeof event : "";
        const bool isRepeated = !waiting.empty() && event.mask == IN_MODIFY
            && waiting.back().mask == IN_MODIFY && waiting.back().watch == event.wd
            && waiting.back().name == name;
        if (!isRepeated)
            waiting.push_back({event.wd, event.mask, event.cookie, name});
        at += sizeof event + event.len;
    }
}

/// Reads the events that the kernel holds; the mutex is locked.
void Inotify::State::read()
{
    alignas(inotify_event) std::array<char, 16 * 1024> buffer;
    // The number of turns is limited, because other programs may add events as quickly as they are read.
    for (std::size_t turn = 0; turn < mostEvents; ++turn) {
        const auto length = ::read(descriptor.get(), buffer.data(), buffer.size());
        if (length > 0)
            append(buffer.data(), static_cast<std::size_t>(length));
        else if (length == 0 || errno != EINTR)
            return;
    }
}

gboolean Inotify::State::readable(gint, GIOCondition, gpointer data)
{
    const auto state = static_cast<std::weak_ptr<State>*>(data)->lock();
    if (!state)
        return G_SOURCE_REMOVE;
    bool isWaiting = false;
    {
        const std::lock_guard lock(state->mutex);
        state->read();
        isWaiting = !state->waiting.empty();
    }
    if (isWaiting)
        state->arrived();
    return G_SOURCE_CONTINUE;
}

Inotify::Inotify(Writing writing, std::function<void()> arrived)
    : _state(std::make_shared<State>())
{
    _state->arrived = std::move(arrived);
    if (writing == Writing::AtOnce)
        _state->events |= IN_MODIFY;
}

/// Opens the queue unless it is open; the mutex is locked.
bool Inotify::State::open(const std::shared_ptr<State>& state)
{
    if (state->descriptor)
        return true;
    state->descriptor = FileDescriptor(::inotify_init1(IN_NONBLOCK | IN_CLOEXEC));
    if (!state->descriptor)
        return false;
    auto data = std::make_unique<std::weak_ptr<State>>(state);
    state->source = g_unix_fd_add_full(G_PRIORITY_DEFAULT, state->descriptor.get(), G_IO_IN, State::readable,
        data.release(), [](gpointer held) {
            std::unique_ptr<std::weak_ptr<State>>(static_cast<std::weak_ptr<State>*>(held));
        });
    return true;
}

Inotify::~Inotify()
{
    if (_state->source)
        g_source_remove(_state->source);
}

SystemResult<int> Inotify::watch(const std::string& folder)
{
    {
        const std::lock_guard lock(_state->mutex);
        if (!State::open(_state))
            return SystemError::last(folder);
    }
    // This is called without the mutex, because the look-up of the folder may hang with its file system, and
    // events must be read meanwhile.
    const int watch = ::inotify_add_watch(_state->descriptor.get(), folder.c_str(), _state->events);
    if (watch < 0)
        return SystemError::last(folder);
    return watch;
}

void Inotify::unwatch(int watch)
{
    ::inotify_rm_watch(_state->descriptor.get(), watch);
}

std::vector<Inotify::Event> Inotify::take()
{
    const std::lock_guard lock(_state->mutex);
    if (_state->descriptor)
        _state->read();
    return std::exchange(_state->waiting, {});
}

} // namespace host::system
