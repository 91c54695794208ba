// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/preview/TextDecoding.h"

#include "platform/Url.h"

#include <algorithm>
#include <utility>

namespace screens {

namespace {

/// Guesses whether the text is UTF-16 without a byte-order mark, and in which byte order: in the usual
/// scripts one half of spaces, digits and line ends is NUL.
const char* guessedUtf16(std::string_view bytes)
{
    constexpr std::size_t looked = 4096, fewest = 8;
    if (bytes.size() < fewest)
        return nullptr;
    std::size_t nulls[2] = {0, 0};
    const auto count = std::min(bytes.size(), looked) / 2 * 2;
    for (std::size_t i = 0; i < count; ++i)
        nulls[i % 2] += bytes[i] == '\0' ? 1 : 0;
    const auto isMany = [&](std::size_t half) { return nulls[half] * 8 > count && nulls[1 - half] == 0; };
    return isMany(0) ? "UTF-16BE" : isMany(1) ? "UTF-16LE" : nullptr;
}

/// Answers whether the text switches between alphabets of ASCII bytes, as Japanese mail does. Such a text is
/// well-formed UTF-8 as well.
bool switchesAlphabets(std::string_view bytes)
{
    return bytes.find("\x1B$") != std::string_view::npos;
}

std::string fromUtf8OrOlder(std::string_view bytes, TextEnd end, const TextDecoder& decoder)
{
    const auto whole = end == TextEnd::Cut ? withoutCutCharacter(bytes) : bytes;
    const bool isUtf8 = isValidUtf8(whole);
    if (isUtf8 && !switchesAlphabets(whole))
        return std::string(whole);
    if (const auto encoding = decoder.likelyEncoding(bytes))
        return decoder.decode(bytes, *encoding, end);
    return isUtf8 ? std::string(whole) : decoder.decode(bytes, "WINDOWS-1252", end);
}

} // namespace

std::string decodedText(std::string_view bytes, TextEnd end, const TextDecoder& decoder)
{
    using namespace std::string_view_literals;
    // UTF-32 is tried first, because its byte-order mark begins with that of UTF-16.
    static constexpr std::pair<std::string_view, const char*> marks[] = {{"\xFF\xFE\0\0"sv, "UTF-32LE"},
        {"\0\0\xFE\xFF"sv, "UTF-32BE"}, {"\xFF\xFE"sv, "UTF-16LE"}, {"\xFE\xFF"sv, "UTF-16BE"}};
    const auto* mark =
        std::ranges::find_if(marks, [bytes](const auto& known) { return bytes.starts_with(known.first); });
    std::string text;
    if (mark != std::end(marks))
        text = decoder.decode(bytes.substr(mark->first.size()), mark->second, end);
    else if (const auto* guessed = guessedUtf16(bytes))
        text = decoder.decode(bytes, guessed, end);
    else
        text = fromUtf8OrOlder(bytes.starts_with("\xEF\xBB\xBF") ? bytes.substr(3) : bytes, end, decoder);
    std::erase(text, '\0');
    return text;
}

std::string withoutLongLines(const std::string& text, std::size_t maxLineBytes)
{
    std::string cut;
    cut.reserve(text.size());
    for (std::size_t start = 0; start < text.size();) {
        const auto found = text.find_first_of("\r\n", start);
        const auto end = found == std::string::npos ? text.size() : found;
        const std::string_view line(text.data() + start, end - start);
        if (line.size() > maxLineBytes) {
            cut += withoutCutCharacter(line.substr(0, maxLineBytes));
            cut += "…";
        } else {
            cut += line;
        }
        if (end < text.size())
            cut += text[end];
        start = end + 1;
    }
    return cut;
}

} // namespace screens
