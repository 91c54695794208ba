// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/SmallFile.h"

#include "host/system/files/SystemErrors.h"
#include "host/system/texts/Translate.h"
#include "platform/Localization.h"

#include <fcntl.h>

#include <array>
#include <cerrno>

namespace host::drive {

namespace {

using platform::Error;
namespace errorKey = platform::errorKey;

// Reads once, and tries again only after an interruption by a signal.
ssize_t readSome(const host::system::FileDescriptor& file, char* into, std::size_t size)
{
    ssize_t count = 0;
    do
        count = ::read(file.get(), into, size);
    while (count < 0 && errno == EINTR);
    return count;
}

} // namespace

Error itemError(int errorNumber, const std::string& path)
{
    if (errorNumber == EBADMSG)
        return damagedRecord(path, "its file holds no promise");
    return host::system::systemError(errorNumber == ENOTDIR ? ENOENT : errorNumber, path);
}

Error cloudError(CloudErrorCode code, const std::string& path, const char* sentence)
{
    return Error(platform::errorDomain::cloud, static_cast<int>(code),
        {{std::string(errorKey::filePath), path},
            {std::string(errorKey::localizedDescription), host::system::translated(sentence)}});
}

Error damagedRecord(const std::string& path, const std::string& reason)
{
    auto sentence = platform::formatText(
        host::system::translated("“%@” is damaged and can’t be used."), {host::system::displayName(path)});
    return Error(platform::errorDomain::cloud, static_cast<int>(CloudErrorCode::DamagedRecord),
        {{std::string(errorKey::filePath), path},
            {std::string(errorKey::localizedDescription), std::move(sentence)},
            {std::string(errorKey::localizedFailureReason), reason}});
}

std::string reasonOf(const Error& error)
{
    if (auto reason = error.text(errorKey::localizedFailureReason))
        return *reason;
    return error.text(errorKey::localizedDescription).value_or("it failed");
}

platform::Result<std::string> readSmallFile(const std::string& path, std::size_t limit)
{
    const host::system::FileDescriptor file(
        ::open(path.c_str(), O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC));
    if (!file)
        return itemError(errno, path);
    return readSmallFile(file, path, limit);
}

platform::Result<std::string> readSmallFile(
    const host::system::FileDescriptor& file, const std::string& path, std::size_t limit)
{
    std::array<char, 4096> buffer;
    std::string text;
    for (;;) {
        const auto count = readSome(file, buffer.data(), buffer.size());
        if (count < 0)
            return itemError(errno, path);
        if (count == 0)
            return text;
        text.append(buffer.data(), static_cast<std::size_t>(count));
        if (text.size() > limit)
            return damagedRecord(path, "it is larger than " + std::to_string(limit) + " bytes");
    }
}

} // namespace host::drive
