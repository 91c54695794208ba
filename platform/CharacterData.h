// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>
#include <string_view>

namespace platform {

/// Classes of characters in the version of Unicode that the platform follows. Any thread may ask; no call
/// fails or waits.
class CharacterData {
public:
    virtual ~CharacterData() = default;

    /// Whether a code point is a non-character (such as U+FFFF) or is not assigned to a character. Such a
    /// code point must not be part of a file name.
    virtual bool isIllegal(char32_t point) const = 0;
    /// Whether a code point is a control or a format character (general categories Cc and Cf), which is
    /// invisible in a name.
    virtual bool isControlOrFormat(char32_t point) const = 0;
    /// Appends a text in the form in which names are compared for a search, that is without case, accents and
    /// compatibility forms: "Café" becomes "cafe". Bytes of `text` that are no UTF-8 become the replacement
    /// character. `folded` keeps what it held before, so that one buffer can hold many names.
    virtual void appendFolded(std::string_view text, std::string& folded) const = 0;
};

} // namespace platform
