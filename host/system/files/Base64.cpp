// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/files/Base64.h"

#include <glib.h>

#include <cstring>
#include <memory>

namespace host::system {

using platform::Data;

std::string base64Encoded(const Data& data)
{
    const std::unique_ptr<char, decltype(&g_free)> text(
        g_base64_encode(reinterpret_cast<const guchar*>(data.data()), data.size()), g_free);
    return text.get();
}

std::optional<Data> base64Decoded(const std::string& text)
{
    gsize length = 0;
    const std::unique_ptr<guchar, decltype(&g_free)> bytes(g_base64_decode(text.c_str(), &length), g_free);
    Data data(length);
    if (length > 0)
        std::memcpy(data.data(), bytes.get(), length);
    // GLib's decoder skips what it does not know, so what it made of a damaged text is told by the way back.
    return base64Encoded(data) == text ? std::optional(std::move(data)) : std::nullopt;
}

} // namespace host::system
