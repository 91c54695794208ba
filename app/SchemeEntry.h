// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Url.h"

#include <optional>
#include <string_view>

namespace tarrow {

/// What a URL of the application's own scheme asks for.
struct SchemeEntry {
    /// The item to show; nothing when the URL names none.
    std::optional<platform::Url> target;
    int previewMode;

    /// Nothing for a text that is no URL and for any other scheme; letter case counts. The URL's path is an
    /// absolute file path; the last "mode" item of the query decides how it is previewed.
    ///
    /// Path and query are percent-decoded twice: whoever makes these URLs encodes the path, and then the URL.
    static std::optional<SchemeEntry> parse(std::string_view text);
};

} // namespace tarrow
