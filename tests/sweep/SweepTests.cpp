// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/PromiseFile.h"
#include "tests/sweep/support/Reasons.h"
#include "tests/sweep/support/SweepFixture.h"
#include "tests/sweep/support/Tally.h"

#include <gmock/gmock.h>

#include <sys/syscall.h>

#include <cerrno>
#include <cstring>
#include <filesystem>
#include <iterator>
#include <set>
#include <sstream>

namespace {

namespace fs = std::filesystem;

using sweep_tests::Ending;
using sweep_tests::Fault;
using sweep_tests::FileCall;

class Sweep : public sweep_tests::SweepFixture { };

TEST_P(Sweep, AKillAtAnyCallLosesNothingAndTheNextStartPutsItRight)
{
    makeDrive();
    const auto before = seen();
    const auto whole = run();
    ASSERT_EQ(whole.status, 0);
    const auto after = seen();
    ASSERT_FALSE(before == after);
    ASSERT_THAT(leftovers(), testing::IsEmpty());
    ASSERT_GE(whole.calls, 10);
    RecordProperty("calls", whole.calls);

    const auto kill = [](const FileCall&) { return Fault{.isKill = true}; };
    const auto killsBefore = sweep_tests::tally().kills;
    atEachCall(kill, [&](const FileCall&, const Ending& ending) {
        if (!ending.wasKilled) {
            // The index of identifiers follows a change in the background, and the program may end before it
            // does, or just when it does.
            ASSERT_EQ(ending.status, 0);
            EXPECT_TRUE(seen() == after) << differences(seen(), after);
            return;
        }
        ++sweep_tests::tally().kills;
        EXPECT_TRUE(isNothingHalf(seen(), before));
        EXPECT_TRUE(isAllThere(isRemoval() ? after : before));
        startAgain();
        const auto now = seen();
        EXPECT_TRUE(isBeforeOrAfter(now, before, after)) << differences(now, before);
        EXPECT_THAT(leftovers(), testing::IsEmpty());
    });
    EXPECT_GE(sweep_tests::tally().kills - killsBefore, whole.calls / 2);
}

TEST_P(Sweep, AFailureOfAnyCallLeavesAllAsItWasOrAllDone)
{
    makeDrive();
    const auto before = seen();
    run();
    const auto after = seen();
    for (const int error : {ENOSPC, EIO, EACCES}) {
        SCOPED_TRACE(::strerrorname_np(error));
        const auto isPossible = [&](const FileCall& call) {
            return (error != ENOSPC || call.mayNeedSpace()) && (error != EACCES || call.takesPath());
        };
        const auto fail = [&](const FileCall&) { return Fault{error}; };
        const auto check = [&](const FileCall& met, const Ending& ending) {
            if (met.index != 0)
                ++sweep_tests::tally().errors;
            EXPECT_EQ(ending.status == 0 ? "" : sweep_tests::faultOfReason(ending, error), "");
            const auto now = noticed();
            // Once a change is made, only syncing it to the disk can still fail.
            EXPECT_TRUE((now == before && ending.status != 0)
                || (now == after && (ending.status == 0 || met.number == SYS_fsync)))
                << "status " << ending.status << differences(now, before);
            if (!leftovers().empty())
                startAgain();
            EXPECT_THAT(leftovers(), testing::IsEmpty());
            EXPECT_TRUE(noticed() == now) << differences(noticed(), now);
        };
        atEachCall(fail, check, isPossible, Turns::Some);
    }
}

/// Every start removes what was released.
class CollectionSweep : public sweep_tests::SweepFixture {
protected:
    /// Releases the package that is in the cloud, as its deletion does. Answers its place then.
    std::string release() const
    {
        const auto promise = host::drive::PromiseRecord::pathFor(at("inner/far.textbundle"));
        const auto content = host::drive::readPromise(promise).value->content;
        fs::create_directories(_layout.released());
        fs::rename(_layout.cloud() + '/' + content, _layout.released() + '/' + content);
        fs::remove(promise);
        return _layout.released() + '/' + content;
    }
    static std::ptrdiff_t itemsIn(const std::string& folder)
    {
        return std::distance(fs::recursive_directory_iterator(folder), {});
    }
};

TEST_P(CollectionSweep, AKillLeavesNoHalfOfAPackageAsAContent)
{
    int kills = 0;
    for (int point = 1, isKilled = 1; isKilled; ++point) {
        makeDrive();
        const auto content = release();
        const auto whole = itemsIn(content);
        int met = 0;
        const auto ending = run([&](const FileCall& call) {
            met += call.subject.find("/released/") != std::string::npos;
            return Fault{.isKill = met == point};
        });
        isKilled = ending.wasKilled;
        kills += isKilled;
        SCOPED_TRACE("at call " + std::to_string(point) + " in the folder of released contents");
        EXPECT_TRUE(!fs::exists(content) || itemsIn(content) == whole);
        startAgain();
        EXPECT_TRUE(fs::is_empty(_layout.released()));
        EXPECT_THAT(leftovers(), testing::IsEmpty());
    }
    sweep_tests::tally().kills += kills;
    EXPECT_GT(kills, 10);
}

std::set<std::string> listed(const std::string& said)
{
    std::set<std::string> lines;
    std::istringstream all(said);
    for (std::string line; std::getline(all, line);) {
        if (line.find('\t') != std::string::npos)
            lines.insert(line);
    }
    return lines;
}

class ListingSweep : public sweep_tests::SweepFixture { };

TEST_P(ListingSweep, AFailureOfAnyCallIsSaidUnlessTheListIsWhole)
{
    makeDrive();
    const auto whole = listed(run().said);
    ASSERT_GE(whole.size(), 10U);
    const auto fail = [](const FileCall&) { return Fault{EIO}; };
    atEachCall(fail, [&](const FileCall& met, const Ending& ending) {
        sweep_tests::tally().errors += met.index != 0;
        if (ending.status == 0)
            EXPECT_EQ(listed(ending.said), whole);
        else
            EXPECT_EQ(sweep_tests::faultOfReason(ending, EIO), "");
    });
}

INSTANTIATE_TEST_SUITE_P(Operations, CollectionSweep,
    testing::Values(sweep_tests::Operation{"list", {"list"}}), testing::PrintToStringParamName());

INSTANTIATE_TEST_SUITE_P(Operations, ListingSweep, testing::Values(sweep_tests::Operation{"list", {"list"}}),
    testing::PrintToStringParamName());

INSTANTIATE_TEST_SUITE_P(
    Operations, Sweep, testing::ValuesIn(sweep_tests::operations()), testing::PrintToStringParamName());

} // namespace
