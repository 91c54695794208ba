// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/Signal.h"

#include <gtk/gtk.h>

#include <functional>

namespace host::gtk {

/// Notes when the first list with rows is on the screen: the end of the start, which the start's benchmark
/// waits for. Main thread only.
class FirstList {
public:
    FirstList() = default;
    ~FirstList();
    FirstList(const FirstList&) = delete;
    FirstList& operator=(const FirstList&) = delete;

    /// A list has rows. At the first call its next frame is awaited and logged; further calls are cheap.
    void note(GtkWidget* list);
    /// Called once, after that frame, when the main loop has nothing else to do.
    void setOnShown(std::function<void()> callback) { _onShown = std::move(callback); }

private:
    void painted();

    bool _isNoted = false;
    std::function<void()> _onShown;
    SignalConnection _onPaint;
    guint _idle = 0;
};

} // namespace host::gtk
