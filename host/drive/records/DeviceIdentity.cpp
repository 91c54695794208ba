// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/DeviceIdentity.h"

#include "host/drive/records/ActivityRecord.h"
#include "host/drive/records/SmallFile.h"
#include "host/system/files/AtomicWrite.h"
#include "platform/Log.h"

#include <glib.h>

#include <filesystem>
#include <memory>

namespace host::drive {

namespace {

constexpr std::size_t longestFile = 256, longestInformation = 64 * 1024; // bytes
/// The system's description of the machine, in the form of shell assignments.
constexpr const char* machineInformation = "/etc/machine-info";

using Text = std::unique_ptr<char, decltype(&g_free)>;

std::string makeIdentifier(const std::string& path)
{
    static constexpr platform::Operation op{"+[DeviceIdentity atFile:]"};
    const std::string identifier = Text(g_uuid_string_random(), g_free).get();
    std::error_code problem;
    std::filesystem::create_directories(std::filesystem::path(path).parent_path(), problem);
    if (const auto error = host::system::writeFileAtomically(path, identifier + '\n'))
        op.warning("Cannot keep what tells this device from others: %@", *error);
    return identifier;
}

/// Answers the name that the user gave the machine, else its network name.
std::string machineName()
{
    constexpr std::string_view key = "\nPRETTY_HOSTNAME=";
    const auto information = '\n' + readSmallFile(machineInformation, longestInformation).value.value_or("");
    const auto found = information.find(key);
    if (found == std::string::npos)
        return g_get_host_name();
    const auto begin = found + key.size();
    auto name = information.substr(begin, information.find('\n', begin) - begin);
    std::erase_if(name, [](char c) { return c == '"' || c == '\\'; });
    return name.empty() ? g_get_host_name() : name;
}

} // namespace

std::string DeviceIdentity::identifierAt(const std::string& path)
{
    auto text = readSmallFile(path, longestFile).value.value_or("");
    while (!text.empty() && g_ascii_isspace(text.back()))
        text.pop_back();
    return ActivityRecord::isDevice(text) ? text : std::string();
}

DeviceIdentity DeviceIdentity::atFile(const std::string& path)
{
    auto identifier = identifierAt(path);
    if (identifier.empty())
        identifier = makeIdentifier(path);
    return {std::move(identifier), machineName()};
}

} // namespace host::drive
