// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/PlatformNames.h"
#include "platform/Date.h"

#include <cstddef>
#include <string>
#include <string_view>

namespace kit {

/// The characters that the user types in quick succession to find a row by the beginning of its name. A
/// value.
class TypeAhead {
public:
    /// A pause of more than this many seconds begins a new text.
    static constexpr double pause = 1;

    /// Adds a character, as UTF-8, that was typed at the time `now`.
    void type(std::string_view character, Date now);
    void clear() { _text.clear(); }
    /// Answers whether a key pressed now continues the text.
    bool isActive(Date now) const;

    /// Answers the text to look for. One character typed again and again is answered as one, so that each
    /// press leads to the next row.
    std::string_view sought() const;
    /// Answers the row at which the search begins when the keyboard is at the row `focused`.
    std::size_t start(std::size_t focused) const;

private:
    bool isRepeated() const;

    std::string _text, _first;
    Date _last{};
};

} // namespace kit
