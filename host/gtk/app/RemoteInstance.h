// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/app/CommandLine.h"

#include <string>

namespace host::gtk {

/// The running process of the application, reached over the session bus. It needs no display.
class RemoteInstance {
public:
    explicit RemoteInstance(std::string applicationId);

    /// Passes the requests to the running process, or brings its window to the front when there are none.
    /// Answers false when there is no such process.
    bool forward(const std::vector<LaunchRequest>& requests) const;

private:
    std::string _applicationId;
};

/// The names of the application's actions on the bus.
namespace ActionNames {

inline constexpr const char* openUrl = "open-url"; ///< s: the URL
inline constexpr const char* search = "search"; ///< no parameter: the launcher's shortcut
inline constexpr const char* recentDocument = "recent-document"; ///< no parameter: the launcher's shortcut
inline constexpr const char* continueActivity =
    "continue-activity"; ///< a{sv}: "type", and the user information

} // namespace ActionNames

} // namespace host::gtk
