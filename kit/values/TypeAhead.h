// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/PlatformNames.h"
#include "platform/Date.h"

#include <cstddef>
#include <string>
#include <string_view>

namespace kit {

/// What is typed in quick succession to find a row by the beginning of its name. A value.
class TypeAhead {
public:
    /// A pause of more than this many seconds begins a new text.
    static constexpr double pause = 1;

    /// Adds a character, as UTF-8, that was typed at a time.
    void type(std::string_view character, Date now);
    void clear() { _text.clear(); }
    /// Whether a key pressed now goes on with the text.
    bool isActive(Date now) const;

    /// What to look for: one character typed again and again is looked for as one, so that it leads to the
    /// next row each time.
    std::string_view sought() const;
    /// Where to begin to look, with the keyboard at a row.
    std::size_t start(std::size_t focused) const;

private:
    bool isRepeated() const;

    std::string _text, _first;
    Date _last{};
};

} // namespace kit
