// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/desktop/JournalLogSink.h"

#include <glib.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <string>

namespace host::system {

using platform::LogLevel;
using platform::LogLine;
using platform::PrivateValues;

namespace {

#ifdef TRW_PRIVATE_LOG
constexpr bool isDevelopmentBuild = true;
#else
constexpr bool isDevelopmentBuild = false;
#endif

thread_local std::string currentActivity;

GLogLevelFlags glibLevel(LogLevel level)
{
    switch (level) {
    case LogLevel::Debug:
        return G_LOG_LEVEL_DEBUG;
    case LogLevel::Info:
        return G_LOG_LEVEL_INFO;
    case LogLevel::Warning:
        return G_LOG_LEVEL_MESSAGE;
    case LogLevel::Error:
        break;
    }
    return G_LOG_LEVEL_WARNING;
}

const char* journalPriority(LogLevel level)
{
    static constexpr const char* priorities[] = {"7", "6", "4", "3"}; // the numbers of syslog(3)
    return priorities[static_cast<int>(level)];
}

/// Removes control characters, so that a message stays one line whatever the names in it contain.
std::string withoutControlCharacters(const std::string& text)
{
    std::string out;
    for (const char c : text) {
        const auto byte = static_cast<unsigned char>(c);
        if (byte >= 0x20 && byte != 0x7f) {
            out.push_back(c);
            continue;
        }
        char escape[5];
        std::snprintf(escape, sizeof escape, "\\x%02x", byte);
        out += escape;
    }
    return out;
}

void writeWhole(int descriptor, std::string_view text)
{
    while (!text.empty()) {
        const auto written = ::write(descriptor, text.data(), text.size());
        if (written < 0 && errno == EINTR)
            continue;
        if (written <= 0)
            return; // there is no other place to report it
        text.remove_prefix(static_cast<std::size_t>(written));
    }
}

} // namespace

LogSettings LogSettings::fromEnvironment()
{
    LogSettings settings{isDevelopmentBuild ? LogLevel::Debug : LogLevel::Info,
        isDevelopmentBuild ? PrivateValues::Shown : PrivateValues::Hidden};
    if (const char* asked = std::getenv("TARROW_LOG_PRIVATE"); asked && *asked)
        settings.privacy = std::string_view(asked) == "1" ? PrivateValues::Shown : PrivateValues::Hidden;
    static constexpr const char* levels[] = {"debug", "info", "warning", "error"};
    const char* asked = std::getenv("TARROW_LOG_LEVEL");
    for (int i = 0; asked && i < 4; ++i) {
        if (std::string_view(asked) == levels[i])
            settings.lowest = static_cast<LogLevel>(i);
    }
    return settings;
}

JournalLogSink::JournalLogSink(PrivateValues privacy)
    : _privacy(privacy)
    , _isJournal(g_log_writer_is_journald(STDERR_FILENO))
{
}

void JournalLogSink::write(const LogLine& line)
{
    if (_isJournal)
        return writeToJournal(line);
    writeWhole(STDERR_FILENO, withoutControlCharacters(logLineText(line, _privacy)) + '\n');
}

void JournalLogSink::openActivity(std::string_view label)
{
    currentActivity = label;
}

void JournalLogSink::writeToJournal(const LogLine& line) const
{
    const auto message = logLineText(line, _privacy);
    const std::string operation(line.operation), sourceLine = std::to_string(line.line);
    const GLogField fields[] = {
        {"MESSAGE", message.data(), static_cast<gssize>(message.size())},
        {"PRIORITY", journalPriority(line.level), -1},
        {"SYSLOG_IDENTIFIER", "tarrow-drive", -1},
        {"CODE_FUNC", operation.c_str(), -1},
        {"CODE_LINE", sourceLine.c_str(), -1},
        {"TRW_USER_ACTION", currentActivity.c_str(), -1},
    };
    const std::size_t count = std::size(fields) - (currentActivity.empty() ? 1 : 0);
    g_log_writer_journald(glibLevel(line.level), fields, count, nullptr);
}

void installSystemLog()
{
    const auto settings = LogSettings::fromEnvironment();
    platform::installLogSink(std::make_shared<JournalLogSink>(settings.privacy));
    platform::setLogLevel(settings.lowest);
}

} // namespace host::system
