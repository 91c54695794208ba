// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/AppRegistry.h"

namespace platform {

std::string logText(const AppHandle& app)
{
    return app.localizedName + " (" + app.bundleIdentifier + ")";
}

} // namespace platform
