// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/DisplayName.h"

#include "platform/Url.h"
#include "screens/PlatformNames.h"

#include <algorithm>

namespace screens {

namespace {

constexpr std::string_view replacement = "\xEF\xBF\xBD";

/// The overrides, embeddings and isolates of Unicode's bidirectional algorithm all begin with these bytes.
constexpr std::string_view embeddings = "\xE2\x80", isolates = "\xE2\x81";

bool turnsDirection(std::string_view character)
{
    const auto last = static_cast<unsigned char>(character.back());
    return (character.starts_with(embeddings) && last >= 0xAA && last <= 0xAE) // U+202A to U+202E
        || (character.starts_with(isolates) && last >= 0xA6 && last <= 0xA9); // U+2066 to U+2069
}

bool isControl(char c)
{
    const auto byte = static_cast<unsigned char>(c);
    return byte < 0x20 || byte == 0x7F;
}

/// Answers the number of bytes of a text's first character, or 0 when it does not begin with a valid one.
std::size_t leadingCharacter(std::string_view text)
{
    for (std::size_t length = 1; length <= std::min<std::size_t>(4, text.size()); ++length) {
        if (isValidUtf8(text.substr(0, length)))
            return length;
    }
    return 0;
}

} // namespace

std::string displayName(std::string_view bytes)
{
    std::string shown;
    shown.reserve(bytes.size());
    if (isValidUtf8(bytes) && bytes.find(embeddings) == std::string_view::npos
        && bytes.find(isolates) == std::string_view::npos) {
        shown = bytes;
    } else {
        while (!bytes.empty()) {
            const auto length = leadingCharacter(bytes);
            const auto character = bytes.substr(0, length);
            shown += length && !turnsDirection(character) ? character : replacement;
            bytes.remove_prefix(std::max<std::size_t>(length, 1));
        }
    }
    std::ranges::replace_if(shown, isControl, ' ');
    return shown;
}

std::string_view nameExtension(std::string_view name)
{
    const auto dot = name.rfind('.');
    return dot == std::string_view::npos || dot == 0 ? std::string_view() : name.substr(dot + 1);
}

} // namespace screens
