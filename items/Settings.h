// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string_view>

namespace tarrow {

/// The program's fixed settings.
class Settings {
public:
    Settings() = delete;

    /// Answers whether a tap on a document opens it at once.
    static constexpr bool quickLaunch() { return true; }

    /// Answers the type of the activity that hands a viewed document over to another device.
    static constexpr std::string_view batonneTarrowActivityType() { return "BrindleDocsID.viewing"; }
};

} // namespace tarrow
