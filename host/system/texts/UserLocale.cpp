// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/texts/UserLocale.h"

#include <algorithm>
#include <cstdlib>
#include <initializer_list>

namespace host::system {

namespace {

/// Answers the value of the first variable that is set and not empty.
std::string firstOf(std::initializer_list<const char*> names)
{
    for (const char* name : names) {
        if (const char* value = std::getenv(name); value && *value)
            return value;
    }
    return {};
}

/// Answers a locale's name without its codeset ("de_AT.UTF-8" becomes "de_AT"); empty for locales that are
/// not a language.
std::string plainName(const std::string& locale)
{
    const auto name = locale.substr(0, locale.find_first_of(".@"));
    return name == "C" || name == "POSIX" ? std::string() : name;
}

} // namespace

UserLocale UserLocale::fromEnvironment()
{
    const auto messages = plainName(firstOf({"LC_ALL", "LC_MESSAGES", "LANG"}));
    const auto formats = plainName(firstOf({"LC_ALL", "LC_TIME", "LC_COLLATE", "LANG"}));
    // The C library ignores LANGUAGE in the C locale, so this does as well.
    const auto wanted = messages.empty() ? std::string() : firstOf({"LANGUAGE"});
    UserLocale locale;
    locale.languages = !wanted.empty() ? wanted : messages.empty() ? "en" : messages;
    if ((":" + locale.languages + ":").find(":en:") == std::string::npos)
        locale.languages += ":en";
    locale.formats = formats.empty() ? "en_US" : formats;
    return locale;
}

std::vector<std::string> UserLocale::languageList() const
{
    std::vector<std::string> list;
    for (std::size_t begin = 0; begin <= languages.size();) {
        const auto end = std::min(languages.find(':', begin), languages.size());
        list.push_back(languages.substr(begin, end - begin));
        begin = end + 1;
    }
    return list;
}

} // namespace host::system
