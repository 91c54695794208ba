// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Log.h"

#include <memory>
#include <mutex>
#include <string>
#include <vector>

namespace testing_support {

/// Keeps every log line, with private values, while it is installed. Any thread may log.
class RecordingLog : public platform::LogSink {
public:
    /// Makes a log and installs it as the process's sink, at the lowest level.
    static std::shared_ptr<RecordingLog> install();

    void write(const platform::LogLine& line) override;
    void openActivity(std::string_view label) override;

    /// Answers the messages so far, each as "LEVEL message" ("DEBUG ...", "INFO ...", "WARNING ...", "ERROR
    /// ...").
    std::vector<std::string> lines() const;
    /// Answers how often a line was logged, by its level and whole message.
    std::size_t count(std::string_view line) const;
    std::vector<std::string> activities() const;
    void clear();

private:
    mutable std::mutex _mutex;
    std::vector<std::string> _lines;
    std::vector<std::string> _activities;
};

} // namespace testing_support
