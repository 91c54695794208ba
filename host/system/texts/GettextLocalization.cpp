// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/texts/GettextLocalization.h"

#include "host/system/texts/Translate.h"
#include "host/system/texts/UserLocale.h"

#include <libintl.h>
#include <unicode/uloc.h>

#include <clocale>
#include <cmath>
#include <cstdlib>
#include <limits>
#include <string_view>

namespace host::system {

namespace {

/// The C library looks up no texts in the "C" locale, and falls back to it when the user's locale is not
/// installed. "C.UTF-8" always exists and obeys LANGUAGE. It is set in the environment, because the toolkit
/// sets the locale from there again.
void leaveTheCLocale()
{
    const bool isInstalled = std::setlocale(LC_ALL, "") != nullptr;
    const char* current = std::setlocale(LC_MESSAGES, nullptr);
    const bool isC = current && (std::string_view(current) == "C" || std::string_view(current) == "POSIX");
    if (isInstalled && !isC)
        return;
    const char* all = std::getenv("LC_ALL");
    ::setenv(!isInstalled || (all && *all) ? "LC_ALL" : "LC_MESSAGES", "C.UTF-8", 1);
    std::setlocale(LC_ALL, "");
}

/// Answers the language of the catalogue in use, from its header.
std::string catalogueLanguage()
{
    const std::string_view header = dgettext(textDomain, "");
    constexpr std::string_view field = "Language: ";
    const auto begin = header.find(field);
    if (begin == std::string_view::npos)
        return "en";
    const auto value = header.substr(begin + field.size());
    return std::string(value.substr(0, value.find('\n')));
}

/// gettext's rules know whole numbers only. A fraction is answered as a hundred, because both are plurals in
/// every language that we have.
unsigned long pluralNumber(double number)
{
    const auto size = std::fabs(number);
    if (size != std::trunc(size) || !(size < static_cast<double>(std::numeric_limits<long>::max())))
        return 100;
    return static_cast<unsigned long>(size);
}

} // namespace

GettextLocalization::GettextLocalization(const std::string& folder, const UserLocale& locale)
{
    ::setenv("LANGUAGE", locale.languages.c_str(), 1);
    leaveTheCLocale();
    bindtextdomain(textDomain, folder.c_str());
    bind_textdomain_codeset(textDomain, "UTF-8");
    _isRightToLeft = uloc_isRightToLeft(catalogueLanguage().c_str());
}

std::string GettextLocalization::text(const std::string& key) const
{
    // The empty key would answer the catalogue's header.
    return key.empty() ? key : dgettext(textDomain, key.c_str());
}

std::string GettextLocalization::pluralText(const std::string& key, double number) const
{
    return dngettext(textDomain, key.c_str(), key.c_str(), pluralNumber(number));
}

} // namespace host::system
