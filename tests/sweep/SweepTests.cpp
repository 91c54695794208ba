// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/sweep/support/SweepFixture.h"

#include <gmock/gmock.h>

#include <sys/syscall.h>

#include <algorithm>
#include <cerrno>
#include <cstring>

namespace {

using sweep_tests::Drive;
using sweep_tests::Fault;
using sweep_tests::FileCall;

class Sweep : public sweep_tests::SweepFixture {
protected:
    /// After an interrupted save only the user can say which of the two versions is wanted, so both may be
    /// left.
    static testing::Matcher<std::vector<std::string>> isWhatMayBeLeft()
    {
        if (GetParam().arguments[0] == "save")
            return testing::Each(std::string("trash/file.txt"));
        return testing::IsEmpty();
    }
};

bool isPart(const Drive& part, const Drive& whole)
{
    return std::ranges::includes(whole, part);
}

TEST_P(Sweep, AKillAtAnyCallLosesNothingAndTheNextStartPutsItRight)
{
    makeDrive();
    const auto before = seen();
    const auto whole = run([](const FileCall&) { return Fault{}; });
    ASSERT_EQ(whole.status, 0);
    const auto after = seen();
    ASSERT_NE(before, after);
    ASSERT_THAT(leftovers(), testing::IsEmpty());
    ASSERT_GE(whole.calls, 10);
    RecordProperty("calls", whole.calls);

    for (int point = 1; point <= whole.calls; ++point) {
        makeDrive();
        std::string what;
        const auto ending = run([&](const FileCall& call) {
            if (call.index != point)
                return Fault{};
            what = std::to_string(call.number) + " on " + call.subject;
            return Fault{Fault::Kind::Kill};
        });
        SCOPED_TRACE("killed at call " + std::to_string(point) + ", " + what);
        if (ending.calls < point) {
            // The index of identifiers follows a change in the background, and the program may end before it
            // does.
            ASSERT_EQ(ending.status, 0);
            EXPECT_TRUE(seen() == after) << differences(seen(), after);
            continue;
        }
        ASSERT_TRUE(ending.wasKilled);
        EXPECT_TRUE(isNothingHalf(seen(), before));
        EXPECT_TRUE(isAllThere(isRemoval() ? after : before));
        startAgain();
        const auto now = seen();
        const bool isOnTheWay =
            GetParam().arguments[0] == "mkdir" && isPart(before, now) && isPart(now, after);
        EXPECT_TRUE(now == before || now == after || isOnTheWay) << differences(now, before);
        EXPECT_THAT(leftovers(), isWhatMayBeLeft());
    }
}

TEST_P(Sweep, AFailureOfAnyCallLeavesAllAsItWasOrAllDone)
{
    makeDrive();
    const auto before = seen();
    const auto whole = run([](const FileCall&) { return Fault{}; });
    const auto after = seen();
    for (const int error : {ENOSPC, EIO, EACCES}) {
        for (int point = 1; point <= whole.calls; ++point) {
            makeDrive();
            FileCall met;
            const auto ending = run([&](const FileCall& call) {
                const bool isMet = call.index == point && (error != ENOSPC || call.mayNeedSpace())
                    && (error != EACCES || call.takesPath());
                if (isMet)
                    met = call;
                return isMet ? Fault{Fault::Kind::Error, error} : Fault{};
            });
            if (met.index == 0)
                continue;
            SCOPED_TRACE(std::string(::strerrorname_np(error)) + " at call " + std::to_string(point) + ", "
                + std::to_string(met.number) + " on " + met.subject);
            const auto now = noticed();
            // Once a change is made, only syncing it to the disk can still fail.
            EXPECT_TRUE((now == before && ending.status != 0)
                || (now == after && (ending.status == 0 || met.number == SYS_fsync)))
                << "status " << ending.status << differences(now, before);
            if (!leftovers().empty())
                startAgain();
            EXPECT_THAT(leftovers(), isWhatMayBeLeft());
            EXPECT_TRUE(noticed() == now) << differences(noticed(), now);
        }
    }
}

INSTANTIATE_TEST_SUITE_P(Operations, Sweep, testing::ValuesIn(sweep_tests::operations()),
    [](const auto& row) { return std::string(row.param.name); });

} // namespace
