// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/SignalConnection.h"

#include <gtk/gtk.h>

#include <functional>

namespace host::gtk {

/// Notes when the first list with rows is on the screen. That is the end of the start, for which the start's
/// benchmark waits. Main thread only.
class FirstList {
public:
    FirstList() = default;
    ~FirstList();
    FirstList(const FirstList&) = delete;
    FirstList& operator=(const FirstList&) = delete;

    /// A list has rows. The first call waits for the list's next frame and logs it; further calls are cheap.
    void note(GtkWidget* list);
    /// The callback runs once, after that frame, when the main loop is idle.
    void setOnShown(std::function<void()> callback) { _onShown = std::move(callback); }

private:
    void painted();

    bool _isNoted = false;
    std::function<void()> _onShown;
    SignalConnection _onPaint;
    guint _idle = 0;
};

} // namespace host::gtk
