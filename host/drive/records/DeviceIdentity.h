// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>

namespace host::drive {

/// Identifies this device among the account's devices. The identifier is stored in the state folder, so two
/// state folders on one drive are two devices.
struct DeviceIdentity {
    std::string identifier; ///< letters, digits and hyphens; it stays the same
    std::string name; ///< the name that the user knows

    /// Reads the identifier from a file. When the file is missing or damaged, it makes an identifier and the
    /// file. When the file cannot be written, the identifier is valid for this process only. Any thread.
    static DeviceIdentity atFile(const std::string& path);
    /// Answers the identifier in the file; empty when there is none. Any thread.
    static std::string identifierAt(const std::string& path);
};

} // namespace host::drive
