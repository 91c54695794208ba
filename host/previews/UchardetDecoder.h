// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/TextDecoder.h"

namespace host::previews {

/// Guesses encodings with uchardet, by how often which characters follow each other, and decodes with the C
/// library's iconv.
class UchardetDecoder : public platform::TextDecoder {
public:
    std::optional<std::string> likelyEncoding(std::string_view bytes) const override;
    std::string decode(
        std::string_view bytes, const std::string& encoding, platform::TextEnd end) const override;
};

} // namespace host::previews
