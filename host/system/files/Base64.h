// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PropertyValue.h"

#include <optional>
#include <string>
#include <string_view>

namespace host::system {

/// Encodes bytes as base64 with padding (RFC 4648, section 4).
std::string base64Encoded(const platform::Data& data);
/// Answers nothing for a text that base64Encoded() would not have made.
std::optional<platform::Data> base64Decoded(const std::string& text);

/// Encodes bytes in the alphabet that is safe in URLs, without padding (RFC 4648, section 5).
std::string base64UrlEncoded(std::string_view bytes);
/// Answers nothing for a text that base64UrlEncoded() would not have made.
std::optional<std::string> base64UrlDecoded(std::string_view text);

} // namespace host::system
