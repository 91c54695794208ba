// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/desktop/JournalLogSink.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <functional>
#include <sstream>
#include <thread>
#include <vector>

using namespace platform;
using host::system::LogSettings;

namespace {

class JournalLogSinkTest : public testing::Test {
protected:
    void TearDown() override
    {
        ::unsetenv("TARROW_LOG_LEVEL");
        ::unsetenv("TARROW_LOG_PRIVATE");
        installLogSink(nullptr);
        setLogLevel(LogLevel::Debug);
    }
    /// Answers the lines that the work logs.
    static std::vector<std::string> logged(const std::function<void()>& work)
    {
        testing::internal::CaptureStderr();
        host::system::installSystemLog();
        work();
        std::vector<std::string> lines;
        std::istringstream text(testing::internal::GetCapturedStderr());
        for (std::string line; std::getline(text, line);)
            lines.push_back(line);
        return lines;
    }

    static constexpr Operation op{"-[Test logs]"};
};

TEST_F(JournalLogSinkTest, EnvironmentChoosesLevelAndPrivacy)
{
    ::setenv("TARROW_LOG_LEVEL", "warning", 1);
    ::setenv("TARROW_LOG_PRIVATE", "0", 1);
    EXPECT_EQ(LogSettings::fromEnvironment().lowest, LogLevel::Warning);
    const auto lines = logged([] {
        op.info("not written");
        op.warning("Item %@ of %{public}@", std::string("secret"), std::string("all"));
    });
    ASSERT_EQ(lines.size(), 1U);
    EXPECT_TRUE(lines[0].starts_with("(TRW)[WARNING] -[Test logs] ("));
    EXPECT_TRUE(lines[0].ends_with(") Item <private> of all"));
    ::setenv("TARROW_LOG_PRIVATE", "1", 1);
    ::setenv("TARROW_LOG_LEVEL", "nonsense", 1);
    EXPECT_EQ(LogSettings::fromEnvironment().privacy, PrivateValues::Shown);
    EXPECT_LE(LogSettings::fromEnvironment().lowest, LogLevel::Info);
}

TEST_F(JournalLogSinkTest, AMessageIsOneLineWhateverItHoldsAndWhoeverWrites)
{
    ::setenv("TARROW_LOG_PRIVATE", "1", 1);
    const auto lines = logged([] {
        op.error("Name %@", std::string("two\nlines\x1b[31m"));
        std::vector<std::jthread> threads;
        for (int thread = 0; thread < 4; ++thread)
            threads.emplace_back([] {
                for (int i = 0; i < 200; ++i)
                    op.error("%@", std::string(300, 'x'));
            });
    });
    ASSERT_EQ(lines.size(), 801U);
    EXPECT_TRUE(lines[0].ends_with("Name two\\x0alines\\x1b[31m"));
    for (std::size_t i = 1; i < lines.size(); ++i)
        EXPECT_EQ(lines[i].substr(lines[i].rfind(' ') + 1), std::string(300, 'x'));
}

} // namespace
