// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ObjectRef.h"
#include "host/gtk/base/SignalConnection.h"

#include <gtk/gtk.h>

#include <functional>
#include <map>
#include <memory>
#include <vector>

namespace host::gtk {

/// Gathers changes and shows them once a frame, before the window's layout. Until the window has a frame
/// clock, the work waits. Main thread only.
class FrameScheduler : public std::enable_shared_from_this<FrameScheduler> {
public:
    using Work = std::function<void()>;

    ~FrameScheduler();

    /// Runs `work` in the next frame. A later request of the same owner replaces the earlier one. An owner
    /// cancels its work before it is destroyed.
    void schedule(const void* owner, Work work);
    void cancel(const void* owner);
    /// Runs `work` in the next frame that begins; when this is called inside a frame, in the one after.
    void scheduleNextFrame(const void* owner, Work work);
    /// Runs the waiting work now. Work that is scheduled meanwhile runs as well, up to a limit that ends
    /// endless chains.
    void flush();
    bool isIdle() const { return _pending.empty() && _later.empty(); }

    /// From now on the window's frame clock drives the work.
    void attach(GtkWidget* window);

    /// Keeps an object alive until the main loop is idle, so that a peer is never destroyed inside one of its
    /// own callbacks.
    void release(std::shared_ptr<void> object);

private:
    void requestFrame();
    void windowWasRealized();

    std::map<const void*, Work> _pending, _later;
    std::vector<const void*> _order;
    ObjectRef<GdkFrameClock> _clock;
    SignalConnection _onUpdate, _onRealize, _onUnrealize;
    GtkWidget* _window = nullptr;
    std::vector<std::shared_ptr<void>> _released;
    guint _releaseSource = 0;
};

} // namespace host::gtk
