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

/// The file in the account's folder by which one device tells the others of its current activity.
struct ActivityRecord {
    /// Larger files are not read. The limit is in bytes.
    static constexpr std::size_t maximumFileSize = 16 * 1024;

    std::string device; ///< identifier: letters, digits and hyphens
    std::string deviceName;
    std::string account; ///< the account's identity
    platform::UserActivity activity; ///< only texts of its user information are stored
    platform::Date time; ///< the time of the writing, in whole seconds

    bool operator==(const ActivityRecord&) const = default;

    static std::string fileName(const std::string& device) { return device + ".json"; }
    static bool isDevice(std::string_view identifier);

    std::string toJson() const;
    /// Answers nothing for a text that is not a record. Unknown members are ignored.
    static std::optional<ActivityRecord> parse(std::string_view text);
};

} // namespace host::drive
