// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>
#include <string_view>

namespace platform {

/// Classes of characters in the version of Unicode that the platform follows. Any thread.
class CharacterData {
public:
    virtual ~CharacterData() = default;

    /// Whether a code point is a non-character or is not assigned.
    virtual bool isIllegal(char32_t point) const = 0;
    /// Whether a code point is a control or a format character (general categories Cc and Cf).
    virtual bool isControlOrFormat(char32_t point) const = 0;
    /// Appends a text as names are compared to find them: without case, accents and compatibility forms
    /// ("Café" as "cafe").
    virtual void appendFolded(std::string_view text, std::string& folded) const = 0;
};

} // namespace platform
