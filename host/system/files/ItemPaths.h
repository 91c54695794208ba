// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>
#include <string_view>

namespace host::system {

/// Answers whether a path is the folder's own or lies below it, compared name by name.
bool isPathWithin(std::string_view path, std::string_view folder);
/// Answers the folder of a path; "." for a name alone.
std::string parentPath(std::string_view path);
/// Answers the part behind a path's last slash, which is the name, or empty when the path ends with a slash.
std::string_view lastName(std::string_view path);
/// Answers the path of another name in the folder of a path.
std::string siblingPath(std::string_view path, std::string_view name);
/// Answers the path of an item's promise.
std::string promisePath(std::string_view path);
/// Answers the name of the item for which a promise of this name stands. Any other name stays as it is, also
/// that of a promise with a long name (PromisedNames.h).
std::string itemName(std::string_view name);
/// Answers whether a name has the form that the promises of long names have.
bool isLongPromiseName(std::string_view name);
/// Answers whether a name is the drive's private name of an item that is being written, moved or removed.
bool isPassingName(std::string_view name);
/// Answers whether an item or its promise exists.
bool isItemThere(const std::string& path);

} // namespace host::system
