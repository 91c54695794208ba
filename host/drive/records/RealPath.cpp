// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/RealPath.h"

#include <sys/stat.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <climits>
#include <string_view>

namespace host::drive {

namespace {

constexpr int mostLinks = 40; // the kernel's own limit

enum class LastName { Follow, Keep };

std::string_view takeName(std::string_view& rest)
{
    while (rest.starts_with('/'))
        rest.remove_prefix(1);
    const auto name = rest.substr(0, rest.find('/'));
    rest.remove_prefix(name.size());
    return name;
}

bool isLastName(std::string_view rest)
{
    return rest.find_first_not_of('/') == std::string_view::npos;
}

void removeLastName(std::string& path)
{
    path.resize(path.rfind('/'));
}

// Answers the target of a link, or nothing for anything else.
std::optional<std::string> linkTarget(const std::string& path, bool& exists)
{
    std::array<char, PATH_MAX> target;
    const auto length = ::readlink(path.c_str(), target.data(), target.size());
    exists = length >= 0 || errno == EINVAL;
    return length > 0 ? std::optional(std::string(target.data(), static_cast<std::size_t>(length)))
                      : std::nullopt;
}

bool isFolder(const std::string& path)
{
    struct stat found { };
    return ::lstat(path.c_str(), &found) == 0 && S_ISDIR(found.st_mode);
}

std::optional<std::string> resolve(const std::string& path, LastName lastName)
{
    std::string pending = path, resolved;
    std::string_view rest = pending;
    bool exists = true;
    for (int links = 0;;) {
        const auto name = takeName(rest);
        if (name.empty())
            return resolved.empty() ? "/" : resolved;
        if (name == ".")
            continue;
        if (name == "..") {
            if (!resolved.empty() && !(exists && isFolder(resolved)))
                return std::nullopt;
            if (!resolved.empty())
                removeLastName(resolved);
            continue;
        }
        resolved.append("/").append(name);
        if (!exists || (lastName == LastName::Keep && isLastName(rest)))
            continue;
        const auto target = linkTarget(resolved, exists);
        if (!target)
            continue;
        if (++links > mostLinks)
            return std::nullopt;
        removeLastName(resolved);
        if (target->starts_with('/'))
            resolved.clear();
        pending = *target + std::string(rest);
        rest = pending;
    }
}

} // namespace

std::optional<std::string> realPath(const std::string& path)
{
    return resolve(path, LastName::Follow);
}

std::optional<std::string> realPathOfEntry(const std::string& path)
{
    return resolve(path, LastName::Keep);
}

} // namespace host::drive
