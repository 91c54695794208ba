// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>
#include <string_view>
#include <unordered_map>

namespace screens {

/// Answers whether names begin with a text, regardless of case and accents, in every script. A name is not
/// folded when its first characters decide, so that a hundred thousand names take a few milliseconds.
class NamePrefix {
public:
    explicit NamePrefix(std::string_view text);

    bool begins(std::string_view name);

private:
    bool mayBegin(std::string_view character);
    bool beginsFolded(std::string_view name);

    std::string _text; ///< folded
    std::unordered_map<std::string, bool>
        _firstCharacters; ///< by first character: whether a name that begins with it may match
    std::string _asked, _folded; ///< the part of the last folded name that decided the answer
    bool _answer = false;
};

} // namespace screens
