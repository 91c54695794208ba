// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <memory>

namespace kit {

class Window;

/// The service that shows windows. Without one the kit works on the model alone. Main thread only.
class WindowHost {
public:
    virtual ~WindowHost() = default;

    /// Shows a window: the host makes a peer for it, attaches the peer with `Window::setObserver` and reports
    /// the size.
    virtual void showWindow(const std::shared_ptr<Window>& window) = 0;

    static std::shared_ptr<WindowHost> current();
    static void install(std::shared_ptr<WindowHost> host); ///< null: none
};

} // namespace kit
