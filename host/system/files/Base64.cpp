// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/files/Base64.h"

#include <glib.h>

#include <algorithm>
#include <cstring>
#include <memory>

namespace host::system {

using platform::Data;

namespace {

std::string encoded(const void* bytes, std::size_t length)
{
    const std::unique_ptr<char, decltype(&g_free)> text(
        g_base64_encode(static_cast<const guchar*>(bytes), length), g_free);
    return text.get();
}

/// Decodes a text. Answers nothing when encoding the result does not give the same text.
template <typename Bytes>
std::optional<Bytes> decoded(const std::string& text)
{
    gsize length = 0;
    const std::unique_ptr<guchar, decltype(&g_free)> decoded(g_base64_decode(text.c_str(), &length), g_free);
    Bytes bytes;
    bytes.resize(length);
    if (length > 0)
        std::memcpy(bytes.data(), decoded.get(), length);
    // GLib's decoder skips characters that it does not know, so encoding the result again shows whether the
    // text was damaged.
    return encoded(bytes.data(), bytes.size()) == text ? std::optional(std::move(bytes)) : std::nullopt;
}

} // namespace

std::string base64Encoded(const Data& data)
{
    return encoded(data.data(), data.size());
}

std::optional<Data> base64Decoded(const std::string& text)
{
    return decoded<Data>(text);
}

std::string base64UrlEncoded(std::string_view bytes)
{
    auto text = encoded(bytes.data(), bytes.size());
    std::erase(text, '=');
    std::ranges::replace(text, '+', '-');
    std::ranges::replace(text, '/', '_');
    return text;
}

std::optional<std::string> base64UrlDecoded(std::string_view text)
{
    if (text.find_first_of("+/=") != std::string_view::npos)
        return std::nullopt;
    std::string padded(text);
    padded.append((4 - text.size() % 4) % 4, '=');
    std::ranges::replace(padded, '-', '+');
    std::ranges::replace(padded, '_', '/');
    return decoded<std::string>(padded);
}

} // namespace host::system
