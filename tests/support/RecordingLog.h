// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Log.h"

#include <algorithm>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

namespace testing_support {

/// Keeps every log line, with private values, while it is installed. Any thread may log.
class RecordingLog : public platform::LogSink {
public:
    /// Makes a log and installs it as the process's sink, at the lowest level.
    static std::shared_ptr<RecordingLog> install()
    {
        auto log = std::make_shared<RecordingLog>();
        platform::installLogSink(log);
        platform::setLogLevel(platform::LogLevel::Debug);
        return log;
    }

    void write(const platform::LogLine& line) override
    {
        static constexpr const char* names[] = {"DEBUG ", "INFO ", "WARNING ", "ERROR "};
        auto text = names[static_cast<int>(line.level)]
            + platform::formatLogMessage(line.format, line.values, platform::PrivateValues::Shown);
        const std::lock_guard lock(_mutex);
        _lines.push_back(std::move(text));
    }
    void openActivity(std::string_view label) override
    {
        const std::lock_guard lock(_mutex);
        _activities.emplace_back(label);
    }

    /// Answers the messages so far, each as "LEVEL message" ("DEBUG ...", "INFO ...", "WARNING ...", "ERROR
    /// ...").
    std::vector<std::string> lines() const
    {
        const std::lock_guard lock(_mutex);
        return _lines;
    }
    /// Answers how often a line was logged, by its level and whole message.
    std::size_t count(std::string_view line) const
    {
        const std::lock_guard lock(_mutex);
        return static_cast<std::size_t>(std::ranges::count(_lines, line));
    }
    std::vector<std::string> activities() const
    {
        const std::lock_guard lock(_mutex);
        return _activities;
    }
    void clear()
    {
        const std::lock_guard lock(_mutex);
        _lines.clear();
        _activities.clear();
    }

private:
    mutable std::mutex _mutex;
    std::vector<std::string> _lines;
    std::vector<std::string> _activities;
};

} // namespace testing_support
