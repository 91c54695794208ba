// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"

#include <cstdint>
#include <string>

namespace host::drive {

/// The space in bytes of the file system that holds the drive, as far as an ordinary user may fill it.
struct StorageSpace {
    std::int64_t free = 0;
    std::int64_t total = 0;

    /// Answers whether less than a tenth is free.
    bool isLow() const { return free < total / 10; }

    /// Reads the space of the file system, and may wait for it.
    static platform::Result<StorageSpace> of(const std::string& path);
};

} // namespace host::drive
