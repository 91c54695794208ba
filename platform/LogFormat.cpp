// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/LogFormat.h"

#include <array>
#include <cstdio>
#include <ctime>

namespace platform {

std::string logText(const std::string& value)
{
    return value;
}

std::string logText(std::string_view value)
{
    return std::string(value);
}

std::string logText(const char* value)
{
    return value ? value : "(null)";
}

std::string logText(const Url& value)
{
    return value.absoluteString();
}

std::string logText(const Date& value)
{
    const auto second = static_cast<std::time_t>(value.nanoseconds / 1'000'000'000);
    std::tm utc{};
    std::array<char, 40> buffer{};
    if (!gmtime_r(&second, &utc)
        || std::strftime(buffer.data(), buffer.size(), "%Y-%m-%d %H:%M:%S +0000", &utc) == 0)
        return std::to_string(value.nanoseconds) + " ns";
    return buffer.data();
}

std::string logText(const Error& value)
{
    return value.debugDescription();
}

std::string logText(const PropertyDictionary& value)
{
    std::string text = "{";
    for (const auto& [key, entry] : value)
        text.append(text.size() > 1 ? ", " : "").append(key).append(" = ").append(logText(entry));
    return text + "}";
}

std::string logText(const PropertyValue& value)
{
    return std::visit(
        [](const auto& v) -> std::string {
            using T = std::decay_t<decltype(v)>;
            if constexpr (std::is_same_v<T, std::monostate>)
                return "(null)";
            else if constexpr (std::is_same_v<T, bool>)
                return v ? "true" : "false";
            else if constexpr (std::is_same_v<T, Data>)
                return "<" + std::to_string(v.size()) + " bytes>";
            else if constexpr (std::is_same_v<T, double>)
                return std::to_string(v);
            else
                return logText(v);
        },
        value.variant());
}

namespace {

std::string realText(double value, std::string_view placeholder)
{
    std::array<char, 400> buffer{};
    std::snprintf(buffer.data(), buffer.size(), placeholder.ends_with('g') ? "%g" : "%f", value);
    return buffer.data();
}

std::string valueText(const LogValue& value, std::string_view placeholder)
{
    return std::visit(
        [&](const auto& v) -> std::string {
            using T = std::decay_t<decltype(v)>;
            if constexpr (std::is_same_v<T, std::string>)
                return v;
            else if constexpr (std::is_same_v<T, double>)
                return realText(v, placeholder);
            else
                return std::to_string(v);
        },
        value);
}

} // namespace

std::string formatLogMessage(
    std::string_view format, const std::vector<LogValue>& values, PrivateValues privacy)
{
    std::string message;
    std::size_t copied = 0, used = 0;
    for (auto p = nextPlaceholder(format, 0); p.conversion; p = nextPlaceholder(format, p.end)) {
        message.append(format.substr(copied, p.begin - copied));
        copied = p.end;
        if (p.conversion == '%')
            message.push_back('%');
        else if (used < values.size()) {
            const bool hidden = p.conversion == '@' && !p.isPublic && privacy == PrivateValues::Hidden;
            message +=
                hidden ? "<private>" : valueText(values[used], format.substr(p.begin, p.end - p.begin));
            ++used;
        }
    }
    return message.append(format.substr(copied));
}

} // namespace platform
