// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"

#include <cstdint>
#include <string>

namespace host::drive {

/// The space of the file system that holds the drive, in bytes, as an ordinary user may fill it.
struct StorageSpace {
    std::int64_t free = 0;
    std::int64_t total = 0;

    /// Less than a tenth is free.
    bool isLow() const { return free < total / 10; }

    /// Asks the file system; may wait for it.
    static platform::Result<StorageSpace> of(const std::string& path);
};

} // namespace host::drive
