// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/LogFormat.h"

#include <atomic>
#include <cstdint>
#include <memory>

namespace platform {

enum class LogLevel : std::uint8_t { Debug, Info, Warning, Error };

/// One line of the log, before it is laid out.
struct LogLine {
    LogLevel level;
    std::string_view operation; ///< the full name of the operation that logs
    unsigned line; ///< source line of the call
    std::string_view format;
    const std::vector<LogValue>& values;
};

/// Where log lines go. Called on any thread, several at once; must not log itself.
class LogSink {
public:
    virtual ~LogSink() = default;
    virtual void write(const LogLine& line) = 0;
    /// Opens a named user-action activity: later lines of this thread belong to it until the next one is
    /// opened.
    virtual void openActivity(std::string_view label) = 0;
};

/// Replaces the process's sink; null drops every line. Call it before other threads log.
void installLogSink(std::shared_ptr<LogSink> sink);

/// The lowest level that is written (Debug at first).
void setLogLevel(LogLevel lowest);

/// A line as it stands in the log: the tag, the level, the operation with its source line, the message.
std::string logLineText(const LogLine& line, PrivateValues privacy);

namespace detail {
inline std::atomic<LogLevel> lowestLogLevel{LogLevel::Debug};
void writeLogLine(const LogLine& line);
} // namespace detail

/// An operation that logs, named once in full ("-[Class first:second:]"; a class operation begins with "+").
/// A level that is switched off costs one branch; arguments are then not turned into text.
class Operation {
public:
    consteval explicit Operation(std::string_view name)
        : _name(name)
    {
    }

    constexpr std::string_view name() const { return _name; }

    template <typename... Args>
    void debug(LogFormat<std::type_identity_t<Args>...> format, const Args&... args) const
    {
        log(LogLevel::Debug, format, args...);
    }
    template <typename... Args>
    void info(LogFormat<std::type_identity_t<Args>...> format, const Args&... args) const
    {
        log(LogLevel::Info, format, args...);
    }
    template <typename... Args>
    void warning(LogFormat<std::type_identity_t<Args>...> format, const Args&... args) const
    {
        log(LogLevel::Warning, format, args...);
    }
    template <typename... Args>
    void error(LogFormat<std::type_identity_t<Args>...> format, const Args&... args) const
    {
        log(LogLevel::Error, format, args...);
    }

    /// Whether lines of this level are written, for a loop whose every turn would log.
    static bool isWritten(LogLevel level)
    {
        return level >= detail::lowestLogLevel.load(std::memory_order_relaxed);
    }

    /// Opens the user-action activity with this label and logs the label.
    void userAction(
        std::string_view label, std::source_location where = std::source_location::current()) const;

private:
    template <typename... Args>
    void log(
        LogLevel level, const LogFormat<std::type_identity_t<Args>...>& format, const Args&... args) const
    {
        if (level < detail::lowestLogLevel.load(std::memory_order_relaxed)) [[likely]]
            return;
        const std::vector<LogValue> values{logValue(args)...};
        detail::writeLogLine({level, _name, format.location.line(), format.text, values});
    }

    std::string_view _name;
};

} // namespace platform
