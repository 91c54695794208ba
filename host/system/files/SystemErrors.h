// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/SystemError.h"
#include "platform/Error.h"

#include <optional>
#include <string>
#include <string_view>

namespace host::system {

/// The error for a system call that failed with `errorNumber` on a path: ENOENT is NoSuchItem, EEXIST is
/// ItemExists, ENAMETOOLONG and EILSEQ are InvalidName, all in errorDomain::file; anything else is
/// errorDomain::system with the number as its code. The user information holds the path, the destination of a
/// move when there is one, and a sentence for the user that names the item.
platform::Error systemError(
    int errorNumber, std::string_view path, const std::optional<std::string>& destination = std::nullopt);
inline platform::Error systemError(const SystemError& failure, std::string_view path,
    const std::optional<std::string>& destination = std::nullopt)
{
    return systemError(failure.number(), path, destination);
}

/// A failure as a log line has it: the name of its errno and what it was about.
std::string logText(const SystemError& failure);

/// The last name of a path as text for people: bytes that are no UTF-8 become replacement characters.
std::string displayName(std::string_view path);

} // namespace host::system
