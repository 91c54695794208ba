// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/Log.h"
#include "tests/support/RecordingLog.h"

#include <gtest/gtest.h>

using namespace platform;

namespace {

TEST(Log, FillsPlaceholdersOfEveryKind)
{
    const auto log = testing_support::RecordingLog::install();
    static constexpr Operation op{"-[Test fills]"};
    op.info("%@ %{public}@ %s %d %u %lu %lf 100%%", Url::fileURL("/a b"), std::string("p"), "s", -3, 4U, 5UL,
        0.5);
    op.warning("%@", std::optional<Url>());
    op.debug("%@", std::vector<std::string>{"a", "b"});
    EXPECT_EQ(log->lines(),
        (std::vector<std::string>{
            "INFO file:///a%20b p s -3 4 5 0.500000 100%", "WARNING (null)", "DEBUG (a, b)"}));
    installLogSink(nullptr);
}

} // namespace
