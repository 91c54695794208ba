// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/LogFormat.h"

#include <atomic>
#include <cstdint>
#include <memory>

namespace platform {

/// How important a line is, the least important first.
enum class LogLevel : std::uint8_t { Debug, Info, Warning, Error };

/// One line of the log, before its message is put together. It is valid only during the call that hands it
/// over.
struct LogLine {
    LogLevel level;
    std::string_view operation; ///< the full name of the operation that logs
    unsigned line; ///< the source line of the call
    std::string_view format; ///< the message with its placeholders
    const std::vector<LogValue>& values; ///< what fills the placeholders, in their order
};

/// Where log lines go. Its calls come on any thread, several at once, and it must not log itself.
class LogSink {
public:
    virtual ~LogSink() = default;
    /// Writes one line. It cannot fail: a line that cannot be written is lost.
    virtual void write(const LogLine& line) = 0;
    /// Opens a named user-action activity, the thing that the person did last. The lines of this thread
    /// belong to it until the next one is opened.
    virtual void openActivity(std::string_view label) = 0;
};

/// Replaces the process's sink; with null every line is dropped, as it is before the first call. It must be
/// called before other threads log, because nothing guards the exchange.
void installLogSink(std::shared_ptr<LogSink> sink);

/// Sets the lowest level that is written; it is Debug at first. Any thread.
void setLogLevel(LogLevel lowest);

/// Answers a line as it stands in the log: the tag, the level, the operation with its source line, and the
/// message, as in
/// "(TRW)[ERROR] -[DRItem initWithURL:] (42) Failed to ...".
std::string logLineText(const LogLine& line, PrivateValues privacy);

namespace detail {
inline std::atomic<LogLevel> lowestLogLevel{LogLevel::Debug};
void writeLogLine(const LogLine& line);
} // namespace detail

/// An operation that logs, named once and in full: "-[Class first:second:]", and with "+" for a class
/// operation. It is a `static constexpr` local of the function. Its calls take a format with placeholders
/// (see LogFormat.h), which is checked against the arguments when it is compiled. A level that is switched
/// off costs one branch, and its arguments are not turned into text. Any thread may log; no call fails.
class Operation {
public:
    consteval explicit Operation(std::string_view name)
        : _name(name)
    {
    }

    /// The name that the operation was made with.
    constexpr std::string_view name() const { return _name; }

    /// What only a developer wants to follow.
    template <typename... Args>
    void debug(LogFormat<std::type_identity_t<Args>...> format, const Args&... args) const
    {
        log(LogLevel::Debug, format, args...);
    }
    /// What happened, as far as it explains a later problem.
    template <typename... Args>
    void info(LogFormat<std::type_identity_t<Args>...> format, const Args&... args) const
    {
        log(LogLevel::Info, format, args...);
    }
    /// Something went wrong that the program could make up for.
    template <typename... Args>
    void warning(LogFormat<std::type_identity_t<Args>...> format, const Args&... args) const
    {
        log(LogLevel::Warning, format, args...);
    }
    /// Something went wrong and was not done.
    template <typename... Args>
    void error(LogFormat<std::type_identity_t<Args>...> format, const Args&... args) const
    {
        log(LogLevel::Error, format, args...);
    }

    /// Whether lines of this level are written, for a loop whose every turn would make arguments for a line.
    static bool isWritten(LogLevel level)
    {
        return level >= detail::lowestLogLevel.load(std::memory_order_relaxed);
    }

    /// Opens the user-action activity with this label, which is public, and logs the label. It is called
    /// where the person's action arrives.
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
