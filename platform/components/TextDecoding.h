#pragma once

#include <string>
#include <string_view>

namespace platform::components {

/// Whether the bytes are the whole document, or were cut somewhere.
enum class TextEnd { Whole, Cut };

/// The text of a document as UTF-8, by its byte-order mark (UTF-8 or UTF-16 of either order), else as UTF-8
/// where it is well-formed, else as Latin-1. A character that the cut went through is left out, a broken one
/// becomes the replacement character, NUL characters are dropped.
std::string decodedText(std::string_view bytes, TextEnd end);

} // namespace platform::components
