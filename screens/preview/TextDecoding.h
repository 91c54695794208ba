// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/CopyName.h"
#include "platform/TextDecoder.h"
#include "screens/PlatformNames.h"

#include <cstddef>
#include <string>
#include <string_view>

namespace screens {

/// Answers the text of a document as UTF-8. The encoding is that of its byte-order mark (UTF-8, UTF-16 or
/// UTF-32 of either order); else UTF-16 where every other byte is NUL; else UTF-8 where it is well-formed;
/// else the one that `decoder` finds likely; else Windows-1252, which is Latin-1 with more characters. A
/// character that the cut went through is left out, a broken one becomes the replacement character, and NUL
/// characters are dropped.
std::string decodedText(std::string_view bytes, TextEnd end, const TextDecoder& decoder);

using platform::withoutCutCharacter;

/// Answers the text with every longer line cut at a character, and an ellipsis in place of the rest.
std::string withoutLongLines(const std::string& text, std::size_t maxLineBytes);

} // namespace screens
