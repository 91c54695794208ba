// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Log.h"

#include <string>

namespace host::system {

/// The settings that the environment gives the log. TARROW_LOG_LEVEL is "debug", "info", "warning" or "error"
/// (otherwise debug in development builds, else info). TARROW_LOG_PRIVATE=1 shows private values and 0 hides
/// them (otherwise they are shown in development builds only).
struct LogSettings {
    platform::LogLevel lowest;
    platform::PrivateValues privacy;

    static LogSettings fromEnvironment();
};

/// Writes the log to the journal when standard error is connected to it, with the level, the operation and
/// the user action as fields, and otherwise to standard error as text. Each line is one write.
class JournalLogSink : public platform::LogSink {
public:
    explicit JournalLogSink(platform::PrivateValues privacy);

    void write(const platform::LogLine& line) override;
    void openActivity(std::string_view label) override;

private:
    void writeToJournal(const platform::LogLine& line) const;

    platform::PrivateValues _privacy;
    bool _isJournal;
};

/// Makes the sink that the environment asks for and installs it with its level. Call this first in main.
void installSystemLog();

} // namespace host::system
