// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Application.h"

#include <functional>
#include <memory>
#include <string>

namespace platform {
class Dispatch;
}

namespace host::gtk {

class PreviewModule;

struct ApplicationSettings {
    std::string applicationId = "app.tarrow.Drive";
    std::string version;
    std::string stateFile; ///< path of the file that keeps the interface's state
    std::shared_ptr<platform::Dispatch> dispatch; ///< null: that file is written on the main thread
    std::shared_ptr<PreviewModule> previews;
    /// Called once, when the first list is on the screen and the main loop is idle, to begin work that can
    /// wait.
    std::function<void()> onFirstList;
};

/// Makes the application's loop on GTK (see GtkApplicationLoop), behind the platform's interface.
std::unique_ptr<platform::Application> makeApplication(ApplicationSettings settings);

} // namespace host::gtk
