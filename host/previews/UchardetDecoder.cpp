// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/previews/UchardetDecoder.h"

#include "host/system/texts/DisplayableText.h"

#include <glib.h>
#include <uchardet.h>

#include <algorithm>
#include <cerrno>
#include <memory>
#include <type_traits>

namespace host::previews {

using platform::TextEnd;

namespace {

/// Looking at more bytes does not improve the guess.
constexpr std::size_t looked = 256U << 10U;
/// A text with fewer bytes beyond ASCII tells the statistics nothing. Most such texts are Western.
constexpr std::ptrdiff_t fewestTelling = 6;
constexpr auto replacement = "\uFFFD";

bool isBeyondAscii(char byte)
{
    return (static_cast<unsigned char>(byte) & 0x80U) != 0;
}

/// Answers whether the text has bytes for which the standard encodings have control characters, which no text
/// uses, and the Windows encodings have quotes and letters.
bool hasWindowsSigns(std::string_view bytes)
{
    return std::ranges::any_of(
        bytes, [](char byte) { return (static_cast<unsigned char>(byte) & 0xE0U) == 0x80; });
}

std::string encodingOf(std::string_view bytes)
{
    const std::unique_ptr<std::remove_pointer_t<uchardet_t>, decltype(&uchardet_delete)> detector(
        uchardet_new(), uchardet_delete);
    const auto part = bytes.substr(0, looked);
    if (uchardet_handle_data(detector.get(), part.data(), part.size()) != 0)
        return {};
    uchardet_data_end(detector.get());
    return uchardet_get_charset(detector.get());
}

/// Answers the Windows code page with the letters of a standard encoding, most of them at the same codes.
std::string windowsPage(const std::string& standard)
{
    constexpr std::pair<const char*, const char*> pages[] = {{"ISO-8859-1", "WINDOWS-1252"},
        {"ISO-8859-2", "WINDOWS-1250"}, {"ISO-8859-5", "WINDOWS-1251"}, {"ISO-8859-6", "WINDOWS-1256"},
        {"ISO-8859-7", "WINDOWS-1253"}, {"ISO-8859-8", "WINDOWS-1255"}, {"ISO-8859-9", "WINDOWS-1254"},
        {"ISO-8859-13", "WINDOWS-1257"}, {"ISO-8859-15", "WINDOWS-1252"}};
    const auto* found = std::ranges::find(pages, standard, [](const auto& page) { return page.first; });
    return found == std::end(pages) ? standard : found->second;
}

struct CloseConverter {
    void operator()(GIConv converter) const { g_iconv_close(converter); }
};
using Converter = std::unique_ptr<std::remove_pointer_t<GIConv>, CloseConverter>;

/// Answers null for an encoding that the C library does not know.
Converter converterFrom(const std::string& encoding)
{
    auto* opened = g_iconv_open("UTF-8", encoding.c_str());
    // NOLINTNEXTLINE(performance-no-int-to-ptr): the library says so that it knows no such encoding
    return Converter(opened == reinterpret_cast<GIConv>(-1) ? nullptr : opened);
}

std::string converted(const Converter& converter, std::string_view bytes, std::size_t unit, TextEnd end)
{
    std::string text;
    char* from = const_cast<char*>(bytes.data()); // iconv only reads it
    gsize left = bytes.size();
    while (left > 0) {
        char piece[4096];
        char* to = piece;
        gsize room = sizeof piece;
        const auto result = g_iconv(converter.get(), &from, &left, &to, &room);
        const int problem = result == static_cast<gsize>(-1) ? errno : 0;
        text.append(piece, sizeof piece - room);
        if (problem == 0 || problem == E2BIG)
            continue;
        // An incomplete unit at the end of UTF-16 or UTF-32 is dropped, because it is not a character that
        // could be broken.
        if (problem == EINVAL && (end == TextEnd::Cut || unit > 1))
            break;
        text += replacement;
        const auto broken = std::min(unit, left);
        from += broken;
        left -= broken;
    }
    return text;
}

} // namespace

std::optional<std::string> UchardetDecoder::likelyEncoding(std::string_view bytes) const
{
    const bool hasEscapes = bytes.find("\x1B$") != std::string_view::npos;
    if (!hasEscapes && std::ranges::count_if(bytes, isBeyondAscii) < fewestTelling)
        return std::nullopt;
    auto encoding = encodingOf(bytes);
    if (hasWindowsSigns(bytes))
        encoding = windowsPage(encoding);
    // Well-formed UTF-8 has already been decoded elsewhere.
    if (encoding.empty() || encoding.starts_with("UTF-") || encoding == "ASCII")
        return std::nullopt;
    return converterFrom(encoding) ? std::optional(std::move(encoding)) : std::nullopt;
}

std::string UchardetDecoder::decode(std::string_view bytes, const std::string& encoding, TextEnd end) const
{
    const auto converter = converterFrom(encoding);
    if (!converter)
        return host::system::displayableText(bytes);
    const std::size_t unit = encoding.starts_with("UTF-32") ? 4 : encoding.starts_with("UTF-16") ? 2 : 1;
    return converted(converter, bytes, unit, end);
}

} // namespace host::previews
