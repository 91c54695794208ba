// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/files/ItemPaths.h"

#include "host/system/files/DriveNames.h"

#include <glib.h>
#include <sys/stat.h>

#include <algorithm>
#include <memory>

namespace host::system {

bool isPathWithin(std::string_view path, std::string_view folder)
{
    return path.starts_with(folder)
        && (path.size() == folder.size() || folder == "/" || path[folder.size()] == '/');
}

std::string parentPath(std::string_view path)
{
    const auto slash = path.rfind('/');
    return slash == std::string_view::npos ? "."
                                           : std::string(path.substr(0, std::max<std::size_t>(slash, 1)));
}

std::string_view lastName(std::string_view path)
{
    return path.substr(path.rfind('/') + 1);
}

std::string siblingPath(std::string_view path, std::string_view name)
{
    return std::string(path.substr(0, path.rfind('/') + 1)).append(name);
}

namespace {

std::string hashOf(std::string_view name)
{
    const std::unique_ptr<char, decltype(&g_free)> digits(
        g_compute_checksum_for_data(
            G_CHECKSUM_SHA256, reinterpret_cast<const guchar*>(name.data()), name.size()),
        &g_free);
    return digits.get();
}

} // namespace

std::string promisePath(std::string_view path)
{
    const auto nameAt = path.rfind('/') + 1;
    if (path.size() - nameAt > longestNameInPromise)
        return siblingPath(path, std::string(longPromisePrefix) + hashOf(path.substr(nameAt)));
    std::string promise;
    promise.reserve(path.size() + 1 + promiseSuffix.size());
    promise.append(path.substr(0, nameAt)).append(".").append(path.substr(nameAt)).append(promiseSuffix);
    return promise;
}

std::string itemName(std::string_view name)
{
    const bool isPromise = name.starts_with('.') && name.ends_with(promiseSuffix)
        && name.size() > promiseSuffix.size() + 1
        && name.size() <= promiseSuffix.size() + 1 + longestNameInPromise;
    const auto item = isPromise ? name.substr(1, name.size() - promiseSuffix.size() - 1) : name;
    // A promise of "." or ".." would stand for the folder that it lies in, or for the one above.
    return std::string(item == "." || item == ".." ? name : item);
}

bool isLongPromiseName(std::string_view name)
{
    return name.starts_with(longPromisePrefix);
}

bool isPassingName(std::string_view name)
{
    return name.starts_with(passingPrefix) && !isLongPromiseName(name);
}

bool isItemThere(const std::string& path)
{
    struct stat found;
    return ::lstat(path.c_str(), &found) == 0 || ::lstat(promisePath(path).c_str(), &found) == 0;
}

} // namespace host::system
