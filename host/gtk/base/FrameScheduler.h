// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ObjectRef.h"
#include "host/gtk/base/Signal.h"

#include <gtk/gtk.h>

#include <functional>
#include <map>
#include <memory>
#include <vector>

namespace host::gtk {

/// Gathers what has to be shown and shows it once a frame, before the window lays itself out. While the
/// window has no frame clock yet, work waits for it. Main thread only.
class FrameScheduler : public std::enable_shared_from_this<FrameScheduler> {
public:
    using Work = std::function<void()>;

    ~FrameScheduler();

    /// Runs `work` in the next frame; a later request for the same owner replaces the earlier one. An owner
    /// that ends before takes its work back with `cancel`.
    void schedule(const void* owner, Work work);
    void cancel(const void* owner);
    /// Runs `work` in a frame of its own: when it is called inside of a frame, in the one after.
    void scheduleNextFrame(const void* owner, Work work);
    /// Runs what waits now. What is scheduled meanwhile runs as well, up to a limit that ends endless chains.
    void flush();
    bool isIdle() const { return _pending.empty() && _later.empty(); }

    /// The window's frames drive the work from now on.
    void attach(GtkWidget* window);

    /// Keeps an object until the main loop is idle: peers end there, never inside one of their own callbacks.
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
