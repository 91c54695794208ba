#include "platform/components/TextDecoding.h"

#include "platform/Url.h"

#include <algorithm>
#include <cstdint>

namespace platform::components {

namespace {

constexpr char32_t replacementCharacter = 0xFFFD;

void append(std::string& text, char32_t point)
{
    const auto tail = [&](unsigned shift) { text += static_cast<char>(0x80 | ((point >> shift) & 0x3F)); };
    if (point < 0x80) {
        text += static_cast<char>(point);
    } else if (point < 0x800) {
        text += static_cast<char>(0xC0 | (point >> 6));
        tail(0);
    } else if (point < 0x10000) {
        text += static_cast<char>(0xE0 | (point >> 12));
        tail(6);
        tail(0);
    } else {
        text += static_cast<char>(0xF0 | (point >> 18));
        tail(12);
        tail(6);
        tail(0);
    }
}

bool isHighSurrogate(char32_t unit)
{
    return unit >= 0xD800 && unit <= 0xDBFF;
}
bool isLowSurrogate(char32_t unit)
{
    return unit >= 0xDC00 && unit <= 0xDFFF;
}

enum class ByteOrder { LittleEndian, BigEndian };

char32_t unitAt(std::string_view bytes, std::size_t index, ByteOrder order)
{
    const auto first = static_cast<unsigned char>(bytes[2 * index]);
    const auto second = static_cast<unsigned char>(bytes[2 * index + 1]);
    return order == ByteOrder::BigEndian ? (first << 8 | second) : (second << 8 | first);
}

std::string fromUtf16(std::string_view bytes, ByteOrder order)
{
    std::string text;
    const auto count = bytes.size() / 2;
    for (std::size_t i = 0; i < count; ++i) {
        const auto unit = unitAt(bytes, i, order);
        const auto next = i + 1 < count ? unitAt(bytes, i + 1, order) : 0;
        if (isHighSurrogate(unit) && isLowSurrogate(next)) {
            append(text, 0x10000 + ((unit - 0xD800) << 10) + (next - 0xDC00));
            ++i;
        } else if (isHighSurrogate(unit) && i + 1 == count) {
            break;
        } else {
            append(text, isHighSurrogate(unit) || isLowSurrogate(unit) ? replacementCharacter : unit);
        }
    }
    return text;
}

std::string fromLatin1(std::string_view bytes)
{
    std::string text;
    text.reserve(bytes.size() + bytes.size() / 8);
    for (const char byte : bytes)
        append(text, static_cast<unsigned char>(byte));
    return text;
}

/// The bytes without the beginning of a character at their end.
std::string_view withoutCutCharacter(std::string_view bytes)
{
    for (std::size_t back = 1; back <= std::min<std::size_t>(4, bytes.size()); ++back) {
        const auto byte = static_cast<unsigned char>(bytes[bytes.size() - back]);
        if ((byte & 0xC0) == 0x80)
            continue;
        const std::size_t length = byte >= 0xF0 ? 4 : byte >= 0xE0 ? 3 : byte >= 0xC0 ? 2 : 1;
        return length > back ? bytes.substr(0, bytes.size() - back) : bytes;
    }
    return bytes;
}

std::string fromUtf8OrLatin1(std::string_view bytes, TextEnd end)
{
    const auto whole = end == TextEnd::Cut ? withoutCutCharacter(bytes) : bytes;
    return isValidUtf8(whole) ? std::string(whole) : fromLatin1(bytes);
}

} // namespace

std::string decodedText(std::string_view bytes, TextEnd end)
{
    std::string text;
    if (bytes.starts_with("\xFF\xFE"))
        text = fromUtf16(bytes.substr(2), ByteOrder::LittleEndian);
    else if (bytes.starts_with("\xFE\xFF"))
        text = fromUtf16(bytes.substr(2), ByteOrder::BigEndian);
    else if (bytes.starts_with("\xEF\xBB\xBF"))
        text = fromUtf8OrLatin1(bytes.substr(3), end);
    else
        text = fromUtf8OrLatin1(bytes, end);
    std::erase(text, '\0');
    return text;
}

} // namespace platform::components
