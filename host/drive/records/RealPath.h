// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <optional>
#include <string>

namespace host::drive {

/// An absolute path with every symbolic link in it resolved, the last name's too, as far as the path exists;
/// what does not exist is appended as it stands. Nothing when there are too many links (a loop), or when ".."
/// would leave something that does not exist.
std::optional<std::string> realPath(const std::string& path);

/// The same, but a link as the last name stays a link.
std::optional<std::string> realPathOfEntry(const std::string& path);

} // namespace host::drive
