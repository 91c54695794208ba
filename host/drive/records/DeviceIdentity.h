// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>

namespace host::drive {

/// Tells this device from the account's other devices. The identifier lies in the state folder, so that two
/// state folders on one drive are two devices.
struct DeviceIdentity {
    std::string identifier; ///< letters, digits and hyphens; stays the same
    std::string name; ///< as its user knows it

    /// Reads the identifier from a file; makes one, and the file, when there is none or it is damaged. Where
    /// the file cannot be written the identifier holds for this process. Any thread.
    static DeviceIdentity atFile(const std::string& path);
    /// The identifier in the file; empty when there is none. Any thread.
    static std::string identifierAt(const std::string& path);
};

} // namespace host::drive
