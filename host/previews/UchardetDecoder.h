// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/TextDecoder.h"

namespace host::previews {

/// Guesses encodings with uchardet, by how often which characters follow each other.
class UchardetDecoder : public platform::TextDecoder {
public:
    std::optional<std::string> decode(std::string_view bytes, platform::TextEnd end) const override;
};

} // namespace host::previews
