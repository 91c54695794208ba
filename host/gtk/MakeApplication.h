#pragma once

#include "platform/Application.h"

#include <memory>
#include <string>

namespace host::gtk {

struct ApplicationSettings {
    std::string applicationId = "app.tarrow.Drive";
    std::string version;
    std::string stateFile; ///< path of the file that keeps the interface's state
};

/// The application's loop on GTK (see GtkApplicationLoop), behind the platform's interface.
std::unique_ptr<platform::Application> makeApplication(ApplicationSettings settings);

} // namespace host::gtk
