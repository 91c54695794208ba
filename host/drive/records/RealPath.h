// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <optional>
#include <string>

namespace host::drive {

/// Resolves every symbolic link in an absolute path, also in its last name, as far as the path exists. The
/// part that does not exist is appended unchanged. Answers nothing when there are too many links (a loop), or
/// when ".." follows something that is no folder.
std::optional<std::string> realPath(const std::string& path);

/// Resolves a path like realPath(), but keeps a link as the last name.
std::optional<std::string> realPathOfEntry(const std::string& path);

} // namespace host::drive
