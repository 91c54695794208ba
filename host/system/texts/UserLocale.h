// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>
#include <vector>

namespace host::system {

/// The user's languages and region.
struct UserLocale {
    /// The languages for texts, the preferred one first, separated by colons ("de_AT:de:en").
    std::string languages;
    /// The locale of dates, numbers and sorting, by ICU's name ("de_AT").
    std::string formats;

    /// Reads LANGUAGE, LC_ALL, LC_MESSAGES, LC_TIME, LC_COLLATE and LANG like the C library. When nothing or
    /// only the "C" locale is asked for, the answer is English.
    static UserLocale fromEnvironment();

    /// Answers the parts of `languages`.
    std::vector<std::string> languageList() const;
};

} // namespace host::system
