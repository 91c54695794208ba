// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace platform {

/// Whether the bytes are the whole document, or were cut somewhere.
enum class TextEnd { Whole, Cut };

/// Reads texts of the time before Unicode, whose encodings nothing names. Any thread.
class TextDecoder {
public:
    virtual ~TextDecoder() = default;

    /// The text as UTF-8 in the encoding that its bytes most likely have; nothing when they do not tell. A
    /// character that the cut went through is left out, a broken one becomes the replacement character. Takes
    /// as long as its bytes are many.
    virtual std::optional<std::string> decode(std::string_view bytes, TextEnd end) const = 0;
};

} // namespace platform
