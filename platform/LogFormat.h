// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Date.h"
#include "platform/Error.h"
#include "platform/PropertyValue.h"
#include "platform/Url.h"

#include <concepts>
#include <optional>
#include <source_location>
#include <string>
#include <string_view>
#include <type_traits>
#include <variant>
#include <vector>

namespace platform {

/// One argument of a log line, in one of the few forms that a line can hold.
using LogValue = std::variant<std::int64_t, std::uint64_t, double, std::string>;

/// Answers how a value reads in a log line under "%@". A type becomes loggable when an overload stands beside
/// its declaration. Texts are taken as they are, dates read in UTC, a null pointer and an empty optional read
/// "(null)".
std::string logText(const std::string& value);
std::string logText(std::string_view value);
std::string logText(const char* value);
std::string logText(const Url& value);
std::string logText(const Date& value);
std::string logText(const Error& value);
std::string logText(const PropertyValue& value);
std::string logText(const PropertyDictionary& value);
template <std::integral T>
std::string logText(T value)
{
    return std::to_string(value);
}
template <typename T>
std::string logText(const std::optional<T>& value)
{
    return value ? logText(*value) : std::string("(null)");
}
template <typename T>
std::string logText(const std::vector<T>& values)
{
    std::string text = "(";
    for (const auto& value : values)
        text.append(text.size() > 1 ? ", " : "").append(logText(value));
    return text + ")";
}

/// Brings an argument to the form that its placeholder needs; an enumeration counts as its number.
template <typename T>
LogValue logValue(const T& value)
{
    if constexpr (std::is_same_v<T, bool> || std::signed_integral<T> || std::is_enum_v<T>)
        return static_cast<std::int64_t>(value);
    else if constexpr (std::unsigned_integral<T>)
        return static_cast<std::uint64_t>(value);
    else if constexpr (std::floating_point<T>)
        return static_cast<double>(value);
    else
        return logText(value);
}

/// What a placeholder can take, which is known when the program is compiled.
enum class LogValueKind { Integer, Real, Text };

template <typename T>
constexpr LogValueKind logValueKind = std::floating_point<std::remove_cvref_t<T>>     ? LogValueKind::Real
    : std::integral<std::remove_cvref_t<T>> || std::is_enum_v<std::remove_cvref_t<T>> ? LogValueKind::Integer
                                                                                      : LogValueKind::Text;

/// One placeholder of a format: where it stands and what it takes.
struct LogPlaceholder {
    std::size_t begin = 0,
                end = 0; ///< the placeholder's bytes in the format, from '%' to behind its last letter
    char conversion = 0; ///< '@', 's', 'd', 'u' or 'f'; '%' for a literal percent sign
    bool isPublic = false; ///< marked {public}; only "%@" can be private
};

/// Finds the next placeholder at or after `from`. Its `conversion` is 0 when there is none and '?' when it is
/// not understood. These are understood: %@ %{public}@ %s %d %ld %lld %zd %u %lu %llu %zu %g %f %lf %%.
constexpr LogPlaceholder nextPlaceholder(std::string_view format, std::size_t from)
{
    const auto percent = format.find('%', from);
    if (percent == std::string_view::npos)
        return {};
    LogPlaceholder found{percent, percent + 1, '?', false};
    if (format.substr(found.end).starts_with("{public}")) {
        found.isPublic = true;
        found.end += 8;
    }
    while (found.end < format.size() && (format[found.end] == 'l' || format[found.end] == 'z'))
        ++found.end;
    if (found.end == format.size())
        return found;
    switch (const char c = format[found.end++]) {
    case '@':
    case 's':
    case 'd':
    case 'u':
    case 'f':
    case '%':
        found.conversion = c;
        break;
    case 'g':
        found.conversion = 'f';
        break;
    default:
        break;
    }
    return found;
}

/// Is never defined. A format that disagrees with its arguments calls it while it is compiled, so that the
/// compiler's message names it.
void logFormatAndArgumentsDisagree();

/// A log format together with the place of the call. It is made from a literal while the program is compiled,
/// and its placeholders are checked against the arguments' types there.
template <typename... Args>
struct LogFormat {
    std::string_view text;
    std::source_location location;

    template <std::size_t N>
    consteval LogFormat(const char (&format)[N], std::source_location where = std::source_location::current())
        : text(format, N - 1)
        , location(where)
    {
        constexpr LogValueKind kinds[] = {logValueKind<Args>..., LogValueKind::Text};
        std::size_t used = 0;
        for (auto p = nextPlaceholder(text, 0); p.conversion; p = nextPlaceholder(text, p.end)) {
            if (p.conversion == '%')
                continue;
            if (p.conversion == '?' || used == sizeof...(Args) || !accepts(p.conversion, kinds[used]))
                logFormatAndArgumentsDisagree();
            ++used;
        }
        if (used != sizeof...(Args))
            logFormatAndArgumentsDisagree();
    }

private:
    static constexpr bool accepts(char conversion, LogValueKind kind)
    {
        if (conversion == '@')
            return true;
        if (conversion == 's')
            return kind == LogValueKind::Text;
        return conversion == 'f' ? kind == LogValueKind::Real : kind == LogValueKind::Integer;
    }
};

/// Whether a message shows what may tell something of the person: names and places of documents.
enum class PrivateValues { Shown, Hidden };
/// Puts a message together. The value of a "%@" without {public} is private and reads "<private>" when such
/// values are hidden; all others are always shown. A placeholder without a value is left out.
std::string formatLogMessage(
    std::string_view format, const std::vector<LogValue>& values, PrivateValues privacy);

} // namespace platform
