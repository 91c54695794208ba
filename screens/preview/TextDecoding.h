// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/TextDecoder.h"
#include "screens/PlatformNames.h"

#include <cstddef>
#include <string>
#include <string_view>

namespace screens {

/// The text of a document as UTF-8, by its byte-order mark (UTF-8, UTF-16 or UTF-32 of either order), as
/// UTF-16 without a mark where every other byte is NUL, else as UTF-8 where it is well-formed, else as
/// `older` reads it; where that does not know, as Windows-1252, which is Latin-1 with more signs. A character
/// that the cut went through is left out, a broken one becomes the replacement character, NUL characters are
/// dropped.
std::string decodedText(std::string_view bytes, TextEnd end, const TextDecoder& older);

/// The text with every line that is longer than so many bytes cut at a character, and an ellipsis put there.
std::string withoutLongLines(const std::string& text, std::size_t maxLineBytes);

} // namespace screens
