// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/base/FrameScheduler.h"

#include <algorithm>

namespace host::gtk {

namespace {

constexpr int maximumRounds = 8;

} // namespace

FrameScheduler::~FrameScheduler()
{
    if (_releaseSource)
        g_source_remove(_releaseSource);
}

void FrameScheduler::schedule(const void* owner, Work work)
{
    if (_pending.insert_or_assign(owner, std::move(work)).second)
        _order.push_back(owner);
    requestFrame();
}

void FrameScheduler::scheduleNextFrame(const void* owner, Work work)
{
    _later.insert_or_assign(owner, std::move(work));
    requestFrame();
}

void FrameScheduler::cancel(const void* owner)
{
    _later.erase(owner);
    if (_pending.erase(owner))
        std::erase(_order, owner);
}

void FrameScheduler::flush()
{
    const auto self = shared_from_this();
    for (auto& [owner, work] : std::exchange(_later, {}))
        schedule(owner, work);
    for (int round = 0; round < maximumRounds && !_pending.empty(); ++round) {
        const auto owners = std::exchange(_order, {});
        for (const void* owner : owners) {
            // Each one is taken out before it runs, because its work may cancel later ones.
            const auto found = _pending.extract(owner);
            if (!found.empty())
                found.mapped()();
        }
    }
    if (!isIdle())
        requestFrame();
}

void FrameScheduler::attach(GtkWidget* window)
{
    _window = window;
    _onRealize = connectSignal<void()>(window, "realize", [this] { windowWasRealized(); });
    _onUnrealize = connectSignal<void()>(window, "unrealize", [this] {
        _onUpdate.disconnect();
        _clock.reset();
    });
    if (gtk_widget_get_realized(window))
        windowWasRealized();
}

void FrameScheduler::windowWasRealized()
{
    _clock = ObjectRef<GdkFrameClock>::retain(gtk_widget_get_frame_clock(_window));
    _onUpdate = connectSignal<void()>(_clock.get(), "update", [this] { flush(); });
    if (!isIdle())
        requestFrame();
}

void FrameScheduler::requestFrame()
{
    if (_clock)
        gdk_frame_clock_request_phase(_clock.get(), GDK_FRAME_CLOCK_PHASE_UPDATE);
}

void FrameScheduler::release(std::shared_ptr<void> object)
{
    _released.push_back(std::move(object));
    if (_releaseSource)
        return;
    _releaseSource = g_idle_add(
        [](gpointer data) -> gboolean {
            auto* self = static_cast<FrameScheduler*>(data);
            self->_releaseSource = 0;
            const auto keepsSelf = self->shared_from_this();
            const auto released = std::exchange(self->_released, {});
            return G_SOURCE_REMOVE;
        },
        this);
}

} // namespace host::gtk
