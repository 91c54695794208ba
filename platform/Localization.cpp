// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/Localization.h"

#include "platform/Formatters.h"
#include "platform/Services.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cstdio>

namespace platform {

namespace {

/// A name may hold marks that turn the text after them around (U+202A to U+202E); in a sentence they would
/// turn the sentence, so that they show as the replacement character.
std::string withoutOverrides(std::string text)
{
    constexpr std::string_view lead = "\xE2\x80", replacement = "\xEF\xBF\xBD";
    for (auto at = text.find(lead); at != std::string::npos; at = text.find(lead, at + lead.size())) {
        const auto last =
            at + lead.size() < text.size() ? static_cast<unsigned char>(text[at + lead.size()]) : 0;
        if (last >= 0xAA && last <= 0xAE)
            text.replace(at, replacement.size(), replacement);
    }
    return text;
}

std::string argumentText(const TextArgument& argument)
{
    if (const auto* text = std::get_if<std::string>(&argument))
        return withoutOverrides(*text);
    if (const auto* integer = std::get_if<std::int64_t>(&argument))
        return services().formatters().number(*integer);
    std::array<char, 40> buffer{};
    std::snprintf(buffer.data(), buffer.size(), "%g", std::get<double>(argument));
    return buffer.data();
}

/// The argument that "2$@..." names (counted from 0), taken off the text; `next` when it names none.
std::size_t takePosition(std::string_view& rest, std::size_t next)
{
    std::size_t number = 0;
    const auto [end, error] = std::from_chars(rest.data(), rest.data() + rest.size(), number);
    const auto length = static_cast<std::size_t>(end - rest.data());
    if (error != std::errc{} || number == 0 || length >= rest.size() || rest[length] != '$')
        return next;
    rest.remove_prefix(length + 1);
    return number - 1;
}

double leadingNumber(const std::vector<TextArgument>& arguments)
{
    if (arguments.empty())
        return 0;
    if (const auto* integer = std::get_if<std::int64_t>(&arguments.front()))
        return static_cast<double>(*integer);
    const auto* real = std::get_if<double>(&arguments.front());
    return real ? *real : 0;
}

} // namespace

std::string formatText(std::string_view format, const std::vector<TextArgument>& arguments)
{
    std::string out;
    std::size_t next = 0;
    while (!format.empty()) {
        const auto percent = std::min(format.find('%'), format.size());
        out.append(format.substr(0, percent));
        format.remove_prefix(percent);
        if (format.size() < 2)
            return out.append(format);
        format.remove_prefix(1);
        if (format[0] == '%') {
            out.push_back('%');
        } else {
            const auto position = takePosition(format, next++);
            if (position < arguments.size())
                out += argumentText(arguments[position]);
        }
        format.remove_prefix(std::min<std::size_t>(1, format.size()));
    }
    return out;
}

std::string localized(const std::string& key)
{
    return services().localization().text(key);
}

std::string localized(const std::string& key, const std::vector<TextArgument>& arguments)
{
    return formatText(services().localization().text(key), arguments);
}

std::string localizedPlural(const std::string& key, const std::vector<TextArgument>& arguments)
{
    return formatText(services().localization().pluralText(key, leadingNumber(arguments)), arguments);
}

} // namespace platform
