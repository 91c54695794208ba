#include "platform/components/DisplayName.h"

#include "platform/Url.h"

#include <algorithm>

namespace platform::components {

namespace {

constexpr std::string_view replacement = "\xEF\xBF\xBD";

bool isControl(char c)
{
    const auto byte = static_cast<unsigned char>(c);
    return byte < 0x20 || byte == 0x7F;
}

/// The number of bytes of the character that a text begins with; 0 when it begins with none.
std::size_t leadingCharacter(std::string_view text)
{
    for (std::size_t length = 1; length <= std::min<std::size_t>(4, text.size()); ++length) {
        if (isValidUtf8(text.substr(0, length)))
            return length;
    }
    return 0;
}

} // namespace

std::string displayName(std::string_view bytes)
{
    std::string shown;
    shown.reserve(bytes.size());
    if (isValidUtf8(bytes)) {
        shown = bytes;
    } else {
        while (!bytes.empty()) {
            const auto length = leadingCharacter(bytes);
            shown += length ? bytes.substr(0, length) : replacement;
            bytes.remove_prefix(std::max<std::size_t>(length, 1));
        }
    }
    std::replace_if(shown.begin(), shown.end(), isControl, ' ');
    return shown;
}

std::string_view nameExtension(std::string_view name)
{
    const auto dot = name.rfind('.');
    return dot == std::string_view::npos || dot == 0 ? std::string_view() : name.substr(dot + 1);
}

} // namespace platform::components
