// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string_view>

namespace tarrow {

/// What the program is set to.
class Settings {
public:
    Settings() = delete;

    /// Whether a tap on a document opens it at once.
    static constexpr bool quickLaunch() { return true; }

    /// The type of the activity under which a viewed document is handed over to another device.
    static constexpr std::string_view batonneTarrowActivityType() { return "BrindleDocsID.viewing"; }
};

} // namespace tarrow
