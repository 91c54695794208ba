// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace platform {

/// Whether bytes are a whole document or only its beginning, whose last character may be cut in two.
enum class TextEnd { Whole, Cut };

/// Decodes texts from the time before Unicode, whose encodings nothing names. Texts that are UTF-8 or have a
/// byte order mark are decoded by the caller and do not come here. Any thread may call, several at once.
class TextDecoder {
public:
    virtual ~TextDecoder() = default;

    /// Answers the text as UTF-8, read in the encoding that its bytes most likely have. It answers nothing
    /// when the bytes do not tell, as when there are too few beyond ASCII; the caller then chooses an
    /// encoding. A character that the cut went through is left out, and a broken one becomes the replacement
    /// character. The call takes as long as the text is large.
    virtual std::optional<std::string> decode(std::string_view bytes, TextEnd end) const = 0;
};

} // namespace platform
