// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace platform {

/// Whether bytes are a whole document or only its beginning, whose last character may be cut in two.
enum class TextEnd { Whole, Cut };

/// Decodes texts that are not UTF-8. Any thread may call, several at once.
class TextDecoder {
public:
    virtual ~TextDecoder() = default;

    /// Answers the encoding that a text from the time before Unicode most likely has, by a name that decode()
    /// knows. It answers nothing when the bytes do not tell, as when there are too few beyond ASCII; the
    /// caller then chooses an encoding. Texts that are UTF-8 or have a byte order mark do not come here.
    virtual std::optional<std::string> likelyEncoding(std::string_view bytes) const = 0;

    /// Answers the text as UTF-8. `encoding` is a name of the IANA's list, such as "UTF-16LE" or
    /// "WINDOWS-1252". A character that the cut went through is left out, and a broken one becomes the
    /// replacement character. The call takes as long as the text is large.
    virtual std::string decode(std::string_view bytes, const std::string& encoding, TextEnd end) const = 0;
};

} // namespace platform
