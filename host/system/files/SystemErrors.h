// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/SystemError.h"
#include "platform/Error.h"

#include <optional>
#include <string>
#include <string_view>

namespace host::system {

/// Answers the error for a system call that failed with `errorNumber` on a path. ENOENT is NoSuchItem, EEXIST
/// is ItemExists, ENAMETOOLONG and EILSEQ are InvalidName, all in errorDomain::file; any other number is a
/// code of errorDomain::system. The user information contains the path, the destination of a move when there
/// is one, and a sentence for the user that names the item.
platform::Error systemError(
    int errorNumber, std::string_view path, const std::optional<std::string>& destination = std::nullopt);
/// Answers the same for an error value. One of the drive's own files is never an error of the file domain,
/// and its sentence does not say that the item is missing, taken or forbidden.
platform::Error systemError(const SystemError& failure, std::string_view path,
    const std::optional<std::string>& destination = std::nullopt);

/// Answers an error as a text for the log: the name of its errno and the name that it is about.
std::string logText(const SystemError& failure);

/// Answers the last name of a path as text for people. Bytes that are not UTF-8 become replacement
/// characters.
std::string displayName(std::string_view path);

} // namespace host::system
