// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/FileChanges.h"

#include "platform/Url.h"

#include <algorithm>

namespace platform {

bool isTag(std::string_view text)
{
    constexpr std::size_t longest = 255;
    const auto isForbidden = [](unsigned char c) { return c < 0x20 || c == 0x7f || c == ','; };
    return !text.empty() && text.size() <= longest && text.front() != ' ' && text.back() != ' '
        && isValidUtf8(text) && std::ranges::none_of(text, isForbidden);
}

} // namespace platform
