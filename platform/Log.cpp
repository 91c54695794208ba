// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/Log.h"

namespace platform {

namespace {

std::shared_ptr<LogSink>& installedSink()
{
    static std::shared_ptr<LogSink> sink;
    return sink;
}

std::string_view levelName(LogLevel level)
{
    switch (level) {
    case LogLevel::Debug:
        return "[DEBUG]";
    case LogLevel::Info:
        return "[INFO]";
    case LogLevel::Warning:
        return "[WARNING]";
    case LogLevel::Error:
        break;
    }
    return "[ERROR]";
}

} // namespace

void installLogSink(std::shared_ptr<LogSink> sink)
{
    installedSink() = std::move(sink);
}

void setLogLevel(LogLevel lowest)
{
    detail::lowestLogLevel = lowest;
}

std::string logLineText(const LogLine& line, PrivateValues privacy)
{
    std::string text = "(TRW)";
    text.append(levelName(line.level));
    text += formatLogMessage(" %s (%d) ", {std::string(line.operation), std::int64_t{line.line}}, privacy);
    return text + formatLogMessage(line.format, line.values, privacy);
}

void detail::writeLogLine(const LogLine& line)
{
    if (const auto& sink = installedSink())
        sink->write(line);
}

void Operation::userAction(std::string_view label, std::source_location where) const
{
    if (const auto& sink = installedSink())
        sink->openActivity(label);
    if (LogLevel::Info < detail::lowestLogLevel.load(std::memory_order_relaxed))
        return;
    const std::vector<LogValue> values{std::string(label)};
    detail::writeLogLine({LogLevel::Info, _name, where.line(), "================= %s", values});
}

} // namespace platform
