// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/files/PromisedNames.h"

#include "host/system/files/AtomicWrite.h"
#include "host/system/files/DriveNames.h"
#include "host/system/files/ItemPaths.h"

#include <nlohmann/json.hpp>

#include <fcntl.h>
#include <sys/xattr.h>

#include <array>
#include <cerrno>
#include <optional>

namespace host::system {

namespace {

constexpr std::size_t largestPromise = 64 * 1024;

std::string pathIn(const FileDescriptor& folder, std::string_view name)
{
    return "/proc/self/fd/" + std::to_string(folder.get()) + '/' + std::string(name);
}

/// Answers which of several names with slashes between them a promise's name is made from.
std::optional<std::string> matching(std::string_view names, std::string_view promiseName)
{
    while (!names.empty()) {
        const auto name = names.substr(0, names.find('/'));
        names.remove_prefix(std::min(names.size(), name.size() + 1));
        const bool isLong = name.size() > longestNameInPromise && name.find('\0') == std::string_view::npos;
        if (isLong && promisePath(name) == promiseName)
            return std::string(name);
    }
    return std::nullopt;
}

/// Reads the member of a promise that has no attributes.
SystemResult<std::string> nameInJson(const std::string& path)
{
    const FileDescriptor folder(::open(parentPath(path).c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC));
    auto text = folder ? readWholeFile(folder, std::string(lastName(path)), largestPromise)
                       : SystemResult<std::string>(SystemError::last(path));
    if (!text)
        return text.error.is(EFBIG) ? SystemError(EBADMSG, path) : text.error;
    const auto promise = nlohmann::json::parse(*text, nullptr, false);
    const auto name = promise.is_object() ? promise.find("name") : promise.end();
    if (!promise.is_object() || name == promise.end() || !name->is_string())
        return SystemError(EBADMSG, path);
    return name->get<std::string>();
}

SystemResult<std::string> namesAt(const std::string& path)
{
    std::array<char, 1024> names; // two names of 255 bytes have room
    const auto length = ::lgetxattr(path.c_str(), promisedNameAttribute, names.data(), names.size());
    if (length >= 0)
        return std::string(names.data(), static_cast<std::size_t>(length));
    return errno == ENODATA || errno == EOPNOTSUPP ? nameInJson(path)
        : errno == ERANGE                          ? SystemError(EBADMSG, path)
                                                   : SystemError::last(path);
}

} // namespace

SystemResult<std::string> promisedName(const std::string& path, std::string_view promiseName)
{
    if (!isLongPromiseName(promiseName)) {
        auto name = itemName(promiseName);
        return name == promiseName ? SystemError(EBADMSG, path) : SystemResult<std::string>(std::move(name));
    }
    const auto names = namesAt(path);
    if (!names)
        return names.error;
    auto name = matching(*names, promiseName);
    return name ? SystemResult<std::string>(std::move(*name)) : SystemError(EBADMSG, path);
}

SystemResult<std::string> promisedName(const std::string& promisePath)
{
    return promisedName(promisePath, lastName(promisePath));
}

SystemResult<std::string> promisedName(const FileDescriptor& folder, std::string_view promiseName)
{
    return promisedName(pathIn(folder, promiseName), promiseName);
}

SystemError addPromisedName(
    const FileDescriptor& folder, const std::string& promiseName, std::string_view newItemName)
{
    if (newItemName.size() <= longestNameInPromise)
        return {};
    const auto path = pathIn(folder, promiseName);
    std::string names(newItemName);
    if (isLongPromiseName(promiseName)) {
        const auto own = promisedName(path, promiseName);
        // A promise that says no name of its own has none to keep.
        if (!own && !own.error.is(EBADMSG))
            return own.error;
        if (own && *own != newItemName)
            names = *own + '/' + names;
    }
    const int done = ::lsetxattr(path.c_str(), promisedNameAttribute, names.data(), names.size(), 0);
    return SystemError::unless(done == 0, promiseName);
}

void settlePromisedName(
    const FileDescriptor& folder, const std::string& promiseName, std::string_view itemName)
{
    const auto path = pathIn(folder, promiseName);
    if (isLongPromiseName(promiseName))
        ::lsetxattr(path.c_str(), promisedNameAttribute, itemName.data(), itemName.size(), 0);
    else
        ::lremovexattr(path.c_str(), promisedNameAttribute);
}

} // namespace host::system
