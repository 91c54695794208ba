// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Date.h"
#include "platform/UserActivity.h"

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

namespace host::drive {

/// What one device tells the others of its current activity, as it lies in the account's folder.
struct ActivityRecord {
    /// Largest file that is read, in bytes.
    static constexpr std::size_t maximumFileSize = 16 * 1024;

    std::string device; ///< identifier: letters, digits and hyphens
    std::string deviceName;
    std::string account; ///< identity
    platform::UserActivity activity; ///< only texts of its information are kept
    platform::Date time; ///< when it was written, in whole seconds

    bool operator==(const ActivityRecord&) const = default;

    static std::string fileName(const std::string& device) { return device + ".json"; }
    static bool isDevice(std::string_view identifier);

    std::string toJson() const;
    /// Nothing for a text that is no record. Unknown members are passed over.
    static std::optional<ActivityRecord> parse(std::string_view text);
};

} // namespace host::drive
