// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>
#include <string_view>

namespace host::system {

/// Whether a path is the folder's own or lies below it, compared name by name.
bool isPathWithin(std::string_view path, std::string_view folder);
/// The folder that a path lies in; "." for a name alone.
std::string parentPath(std::string_view path);
/// What follows a path's last slash: the name, empty for a path that ends with a slash.
std::string_view lastName(std::string_view path);
/// The path of another name in the folder that a path lies in.
std::string siblingPath(std::string_view path, std::string_view name);
/// The path of an item's promise.
std::string promisePath(std::string_view path);
/// The name of the item that a promise of this name stands for; any other name stays as it is.
std::string itemName(std::string_view name);
/// Whether a name is one that the drive gives to what is only on its way.
bool isPassingName(std::string_view name);
/// Whether an item is there, or its promise.
bool isItemThere(const std::string& path);

} // namespace host::system
