// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/CopyName.h"

#include <algorithm>
#include <cstddef>

namespace platform {

std::string_view withoutCutCharacter(std::string_view bytes)
{
    for (std::size_t back = 1; back <= std::min<std::size_t>(4, bytes.size()); ++back) {
        const auto byte = static_cast<unsigned char>(bytes[bytes.size() - back]);
        if ((byte & 0xC0) == 0x80)
            continue;
        const std::size_t length = byte >= 0xF0 ? 4 : byte >= 0xE0 ? 3 : byte >= 0xC0 ? 2 : 1;
        return length > back ? bytes.substr(0, bytes.size() - back) : bytes;
    }
    return bytes;
}

std::string copyName(const std::string& name, int number)
{
    constexpr std::size_t longestName = 255; // bytes; the limit of Linux file systems
    if (number == 1)
        return name;
    const auto dot = name.rfind('.');
    const auto end = dot == std::string::npos || dot == 0 ? name.size() : dot;
    const auto tail = ' ' + std::to_string(number) + name.substr(end);
    const auto room = longestName - std::min(tail.size(), longestName);
    const std::string_view stem(name.data(), end);
    return std::string(end <= room ? stem : withoutCutCharacter(stem.substr(0, room))) + tail;
}

} // namespace platform
