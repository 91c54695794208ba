// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/preview/TextDecoding.h"

#include "platform/Url.h"

#include <algorithm>
#include <cstdint>
#include <optional>

namespace screens {

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

std::string fromUtf32(std::string_view bytes, ByteOrder order)
{
    std::string text;
    for (std::size_t i = 0; i + 4 <= bytes.size(); i += 4) {
        const auto upper = unitAt(bytes.substr(i), order == ByteOrder::BigEndian ? 0 : 1, order);
        const auto lower = unitAt(bytes.substr(i), order == ByteOrder::BigEndian ? 1 : 0, order);
        const char32_t point = upper << 16 | lower;
        const bool isPoint = point <= 0x10FFFF && !isHighSurrogate(point) && !isLowSurrogate(point);
        append(text, isPoint ? point : replacementCharacter);
    }
    return text;
}

/// Guesses the byte order of UTF-16 without a byte-order mark: in the usual scripts one half of spaces,
/// digits and line ends is NUL.
std::optional<ByteOrder> guessedByteOrder(std::string_view bytes)
{
    constexpr std::size_t looked = 4096, fewest = 8;
    if (bytes.size() < fewest)
        return std::nullopt;
    std::size_t nulls[2] = {0, 0};
    const auto count = std::min(bytes.size(), looked) / 2 * 2;
    for (std::size_t i = 0; i < count; ++i)
        nulls[i % 2] += bytes[i] == '\0' ? 1 : 0;
    const auto isMany = [&](std::size_t half) { return nulls[half] * 8 > count && nulls[1 - half] == 0; };
    if (isMany(0))
        return ByteOrder::BigEndian;
    return isMany(1) ? std::optional(ByteOrder::LittleEndian) : std::nullopt;
}

/// The characters that Windows-1252 has in place of Latin-1's control characters; 0 means none.
constexpr char16_t windowsSigns[32] = {0x20AC, 0, 0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021, 0x02C6,
    0x2030, 0x0160, 0x2039, 0x0152, 0, 0x017D, 0, 0, 0x2018, 0x2019, 0x201C, 0x201D, 0x2022, 0x2013, 0x2014,
    0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0, 0x017E, 0x0178};

std::string fromWindows1252(std::string_view bytes)
{
    std::string text;
    text.reserve(bytes.size() + bytes.size() / 8);
    for (const char character : bytes) {
        const auto byte = static_cast<unsigned char>(character);
        const bool isSign = byte >= 0x80 && byte < 0xA0 && windowsSigns[byte - 0x80] != 0;
        append(text, isSign ? windowsSigns[byte - 0x80] : byte);
    }
    return text;
}

/// Answers the bytes without an incomplete character at their end.
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

/// Answers whether the text switches between alphabets of ASCII bytes, as Japanese mail does. Such a text is
/// well-formed UTF-8 as well.
bool switchesAlphabets(std::string_view bytes)
{
    return bytes.find("\x1B$") != std::string_view::npos;
}

std::string fromUtf8OrOlder(std::string_view bytes, TextEnd end, const TextDecoder& older)
{
    const auto whole = end == TextEnd::Cut ? withoutCutCharacter(bytes) : bytes;
    const bool isUtf8 = isValidUtf8(whole);
    if (isUtf8 && !switchesAlphabets(whole))
        return std::string(whole);
    if (auto text = older.decode(bytes, end))
        return *std::move(text);
    return isUtf8 ? std::string(whole) : fromWindows1252(bytes);
}

} // namespace

std::string decodedText(std::string_view bytes, TextEnd end, const TextDecoder& older)
{
    using namespace std::string_view_literals;
    std::string text;
    if (bytes.starts_with("\xFF\xFE\0\0"sv))
        text = fromUtf32(bytes.substr(4), ByteOrder::LittleEndian);
    else if (bytes.starts_with("\0\0\xFE\xFF"sv))
        text = fromUtf32(bytes.substr(4), ByteOrder::BigEndian);
    else if (bytes.starts_with("\xFF\xFE"))
        text = fromUtf16(bytes.substr(2), ByteOrder::LittleEndian);
    else if (bytes.starts_with("\xFE\xFF"))
        text = fromUtf16(bytes.substr(2), ByteOrder::BigEndian);
    else if (const auto order = guessedByteOrder(bytes))
        text = fromUtf16(bytes, *order);
    else
        text = fromUtf8OrOlder(bytes.starts_with("\xEF\xBB\xBF") ? bytes.substr(3) : bytes, end, older);
    std::erase(text, '\0');
    return text;
}

std::string withoutLongLines(const std::string& text, std::size_t maxLineBytes)
{
    std::string cut;
    cut.reserve(text.size());
    for (std::size_t start = 0; start < text.size();) {
        const auto found = text.find('\n', start);
        const auto end = found == std::string::npos ? text.size() : found;
        const std::string_view line(text.data() + start, end - start);
        if (line.size() > maxLineBytes) {
            cut += withoutCutCharacter(line.substr(0, maxLineBytes));
            cut += "…";
        } else {
            cut += line;
        }
        if (end < text.size())
            cut += '\n';
        start = end + 1;
    }
    return cut;
}

} // namespace screens
