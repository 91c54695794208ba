// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/support/RecordingLog.h"

#include <algorithm>

namespace testing_support {

std::shared_ptr<RecordingLog> RecordingLog::install()
{
    auto log = std::make_shared<RecordingLog>();
    platform::installLogSink(log);
    platform::setLogLevel(platform::LogLevel::Debug);
    return log;
}

void RecordingLog::write(const platform::LogLine& line)
{
    static constexpr const char* names[] = {"DEBUG ", "INFO ", "WARNING ", "ERROR "};
    auto text = names[static_cast<int>(line.level)]
        + platform::formatLogMessage(line.format, line.values, platform::PrivateValues::Shown);
    const std::lock_guard lock(_mutex);
    _lines.push_back(std::move(text));
}

void RecordingLog::openActivity(std::string_view label)
{
    const std::lock_guard lock(_mutex);
    _activities.emplace_back(label);
}

std::vector<std::string> RecordingLog::lines() const
{
    const std::lock_guard lock(_mutex);
    return _lines;
}

std::size_t RecordingLog::count(std::string_view line) const
{
    const std::lock_guard lock(_mutex);
    return static_cast<std::size_t>(std::ranges::count(_lines, line));
}

std::vector<std::string> RecordingLog::activities() const
{
    const std::lock_guard lock(_mutex);
    return _activities;
}

void RecordingLog::clear()
{
    const std::lock_guard lock(_mutex);
    _lines.clear();
    _activities.clear();
}

} // namespace testing_support
