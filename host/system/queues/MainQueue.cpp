// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/queues/MainQueue.h"

#include <glib.h>

#include <deque>
#include <mutex>

namespace host::system {

using platform::Work;

struct MainQueue::State {
    std::mutex mutex;
    std::deque<Work> pending;
    GSource* source = nullptr;
};

/// The queue as a GLib source, which is ready while work waits.
struct MainQueue::Source {
    GSource base;
    std::weak_ptr<State> state;

    static gboolean prepare(GSource* source, gint* timeout)
    {
        *timeout = -1;
        return check(source);
    }

    static gboolean check(GSource* source)
    {
        const auto state = reinterpret_cast<Source*>(source)->state.lock();
        if (!state)
            return FALSE;
        const std::lock_guard lock(state->mutex);
        return !state->pending.empty();
    }

    static std::size_t waiting(const std::shared_ptr<State>& state)
    {
        const std::lock_guard lock(state->mutex);
        return state->pending.size();
    }

    static Work takeFirst(const std::weak_ptr<State>& weak)
    {
        const auto state = weak.lock();
        if (!state)
            return {};
        const std::lock_guard lock(state->mutex);
        if (state->pending.empty())
            return {};
        auto work = std::move(state->pending.front());
        state->pending.pop_front();
        return work;
    }

    static gboolean dispatch(GSource* source, GSourceFunc, gpointer)
    {
        const auto weak = reinterpret_cast<Source*>(source)->state;
        const auto state = weak.lock();
        // Only the work that waits now is run, because work that adds work must not keep the loop from its
        // other sources.
        auto count = state ? waiting(state) : 0;
        for (; count > 0; --count) {
            if (const auto work = takeFirst(weak))
                work();
        }
        return G_SOURCE_CONTINUE;
    }

    static void finalize(GSource* source) { std::destroy_at(&reinterpret_cast<Source*>(source)->state); }
};

MainQueue::MainQueue()
    : _state(std::make_shared<State>())
{
    static GSourceFuncs functions{
        Source::prepare, Source::check, Source::dispatch, Source::finalize, nullptr, nullptr};
    _state->source = g_source_new(&functions, sizeof(Source));
    std::construct_at(&reinterpret_cast<Source*>(_state->source)->state, _state);
    // The source has the priority of the toolkit's drawing. A stream of work then takes turns with frames
    // instead of starving them, and input comes before both.
    g_source_set_priority(_state->source, G_PRIORITY_HIGH_IDLE + 20);
    g_source_set_can_recurse(_state->source, TRUE); // a nested loop still runs the queue
    g_source_set_static_name(_state->source, "main queue");
    g_source_attach(_state->source, nullptr);
}

MainQueue::~MainQueue()
{
    std::deque<Work> dropped;
    {
        const std::lock_guard lock(_state->mutex);
        dropped.swap(_state->pending);
    }
    g_source_destroy(_state->source);
    g_source_unref(_state->source);
}

void MainQueue::async(Work work)
{
    bool wasEmpty;
    {
        const std::lock_guard lock(_state->mutex);
        wasEmpty = _state->pending.empty();
        _state->pending.push_back(std::move(work));
    }
    if (wasEmpty)
        g_main_context_wakeup(nullptr);
}

} // namespace host::system
