// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/Log.h"
#include "tests/support/RecordingLog.h"

#include <gtest/gtest.h>

using namespace platform;

namespace {

class LogTest : public testing::Test {
protected:
    void TearDown() override
    {
        installLogSink(nullptr);
        setLogLevel(LogLevel::Debug);
    }
    std::shared_ptr<testing_support::RecordingLog> log = testing_support::RecordingLog::install();
};

TEST_F(LogTest, FillsPlaceholdersOfEveryKind)
{
    static constexpr Operation op{"-[Test fills]"};
    op.info("%@ %{public}@ %s %d %u %lu %lf 100%%", Url::fileURL("/a b"), std::string("p"), "s", -3, 4U, 5UL,
        0.5);
    op.warning("%@", std::optional<Url>());
    op.debug("%@", std::vector<std::string>{"a", "b"});
    EXPECT_EQ(log->lines(),
        (std::vector<std::string>{
            "INFO file:///a%20b p s -3 4 5 0.500000 100%", "WARNING (null)", "DEBUG (a, b)"}));
}

TEST_F(LogTest, DropsLevelsThatAreOffAndOpensActivities)
{
    static constexpr Operation op{"-[Test drops]"};
    setLogLevel(LogLevel::Warning);
    op.info("not written");
    op.userAction("Pressed Move");
    setLogLevel(LogLevel::Info);
    op.userAction("Pressed Move");
    EXPECT_EQ(log->lines(), std::vector<std::string>{"INFO ================= Pressed Move"});
    EXPECT_EQ(log->activities().size(), 2U);
}

} // namespace
