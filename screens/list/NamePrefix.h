// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>
#include <string_view>
#include <unordered_map>

namespace screens {

/// A text that names are asked for to begin with, without case and accents, in every script. Names whose
/// first characters decide are not folded, so that a hundred thousand of them are asked in a few
/// milliseconds.
class NamePrefix {
public:
    explicit NamePrefix(std::string_view text);

    bool begins(std::string_view name);

private:
    bool mayBegin(std::string_view character);
    bool beginsFolded(std::string_view name);

    std::string _text; ///< folded
    std::unordered_map<std::string, bool> _firstCharacters; ///< whether a name that begins with it may do
    std::string _asked, _folded; ///< as much of the name that was folded last as decided
    bool _answer = false;
};

} // namespace screens
