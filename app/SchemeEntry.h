// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Url.h"

#include <optional>
#include <string_view>

namespace tarrow {

/// The request in a URL of the application's own scheme.
struct SchemeEntry {
    /// The item to show; absent when the URL names none.
    std::optional<platform::Url> target;
    int previewMode;

    /// Answers nothing for a text that is not a URL and for any other scheme; letter case counts. The URL's
    /// path is an absolute file path. The last "mode" item of the query decides how the item is previewed.
    ///
    /// Path and query are percent-decoded twice, because the makers of these URLs encode first the path and
    /// then the URL.
    static std::optional<SchemeEntry> parse(std::string_view text);
};

} // namespace tarrow
