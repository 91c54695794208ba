// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/list/NamePrefix.h"

#include "platform/CharacterData.h"
#include "platform/Services.h"
#include "screens/PlatformNames.h"

#include <algorithm>

namespace screens {

namespace {

/// A name's prefix has at most so many bytes more than the text, unless accents are separate characters.
constexpr std::size_t usualExcess = 4;

bool isAscii(char c)
{
    return static_cast<unsigned char>(c) < 0x80;
}

char lower(char c)
{
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}

/// Answers the beginning of a text of so many bytes, and the rest of the character at its end.
std::string_view beginning(std::string_view text, std::size_t bytes)
{
    const auto isInside = [&](std::size_t at) {
        return (static_cast<unsigned char>(text[at]) & 0xc0) == 0x80;
    };
    while (bytes < text.size() && isInside(bytes))
        ++bytes;
    return text.substr(0, bytes);
}

} // namespace

NamePrefix::NamePrefix(std::string_view text)
{
    services().characterData().appendFolded(text, _text);
}

bool NamePrefix::begins(std::string_view name)
{
    std::size_t at = 0;
    for (; at < _text.size() && at < name.size() && isAscii(name[at]); ++at) {
        if (lower(name[at]) != _text[at])
            return false;
    }
    if (at == _text.size() || at == name.size())
        return at == _text.size();
    return (at > 0 || mayBegin(beginning(name, 1))) && beginsFolded(name);
}

bool NamePrefix::mayBegin(std::string_view character)
{
    const auto [known, isNew] = _firstCharacters.try_emplace(std::string(character));
    if (isNew) {
        std::string folded;
        services().characterData().appendFolded(character, folded);
        const auto common = std::min(folded.size(), _text.size());
        known->second = _text.compare(0, common, folded, 0, common) == 0;
    }
    return known->second;
}

bool NamePrefix::beginsFolded(std::string_view name)
{
    if (!_asked.empty() && name.starts_with(_asked))
        return _answer;
    std::string_view part;
    for (auto bytes = _text.size() + usualExcess; part.size() < name.size(); bytes *= 2) {
        part = beginning(name, std::min(bytes, name.size()));
        _folded.clear();
        services().characterData().appendFolded(part, _folded);
        if (_folded.size() >= _text.size())
            break;
    }
    _asked = part;
    // The whole name was folded. A longer name that begins with it could continue its last character, so the
    // answer is not reused.
    if (part.size() == name.size())
        _asked.clear();
    _answer = _folded.starts_with(_text);
    return _answer;
}

} // namespace screens
