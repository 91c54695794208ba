// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/sweep/support/SweepFixture.h"
#include "tests/sweep/support/Tally.h"

#include <gmock/gmock.h>

#include <sys/syscall.h>

#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <numeric>

namespace {

using sweep_tests::Ending;
using sweep_tests::Fault;
using sweep_tests::FileCall;

/// Lets calls meet what is rarer than an error: less than was asked for, an interruption, a second fault.
class HardFaults : public sweep_tests::SweepFixture {
protected:
    HardFaults()
    {
        makeDrive();
        before = seen();
        run();
        after = seen();
    }
    /// Answers about so many of the elements, and all of them, or a hundred of very many, in the long run.
    template <typename Element>
    static std::vector<Element> some(const std::vector<Element>& all, std::size_t few)
    {
        const auto wanted = ::getenv("TARROW_LONG_SWEEP") ? std::size_t{100} : few;
        std::vector<Element> chosen;
        for (std::size_t i = 0; i < all.size(); i += all.size() / wanted + 1)
            chosen.push_back(all[i]);
        return chosen;
    }
    static std::string textOf(const FileCall& call)
    {
        return "call " + std::to_string(call.index) + ", " + std::to_string(call.number) + " on "
            + call.subject;
    }
    /// Answers the calls of the operation for which there is a fault.
    std::vector<FileCall> callsWith(const sweep_tests::FaultFor& faultFor)
    {
        std::vector<FileCall> calls;
        makeDrive();
        run([&](const FileCall& call) {
            if (!faultFor(call).isNone())
                calls.push_back(call);
            return Fault{};
        });
        return calls;
    }
    /// Lets each call for which there is a fault meet it, on a new drive, and demands that all is done.
    void expectNoDifference(const sweep_tests::FaultFor& faultFor)
    {
        for (const auto& met : callsWith(faultFor)) {
            SCOPED_TRACE(textOf(met));
            makeDrive();
            const auto ending =
                run([&](const FileCall& call) { return call.index == met.index ? faultFor(call) : Fault{}; });
            EXPECT_EQ(ending.status, 0);
            EXPECT_TRUE(seen() == after) << differences(seen(), after);
            EXPECT_THAT(leftovers(), testing::IsEmpty());
        }
    }
    /// Runs the operation while the calls of two numbers meet the faults. Answers the ending.
    Ending runWithTwo(int first, const Fault& fault, int second, const Fault& secondFault)
    {
        makeDrive();
        return run([&](const FileCall& call) {
            return call.index == first ? fault : call.index == second ? secondFault : Fault{};
        });
    }
    /// Lets a call for which there is a fault, and all such calls that follow, meet it.
    void expectWholeFromThereOn(const sweep_tests::FaultFor& faultFor)
    {
        for (const auto& first : some(callsWith(faultFor), 12)) {
            SCOPED_TRACE("from there on, " + textOf(first));
            makeDrive();
            expectWhole(run(
                [&](const FileCall& call) { return call.index < first.index ? Fault{} : faultFor(call); }));
        }
    }
    /// Demands that nothing is lost or half, and that the next start makes one of two whole drives of it.
    void expectWhole(const Ending& ending)
    {
        const auto now = seen();
        EXPECT_TRUE(isNothingHalf(now, before));
        EXPECT_TRUE(isAllThere(isRemoval() ? after : before));
        startAgain();
        const auto settled = noticed();
        EXPECT_TRUE(ending.status == 0 ? settled == after : isBeforeAfterOrBoth(settled, before, after))
            << "status " << ending.status << differences(settled, before);
    }

    sweep_tests::Drive before, after;
};

TEST_P(HardFaults, AShortReadOrWriteIsGoneOnWith)
{
    expectNoDifference(
        [](const FileCall& call) { return Fault{.isShort = call.isTransfer() && call.length > 1}; });
}

TEST_P(HardFaults, AnInterruptedCallIsMadeAgainOrLeavesAllAsItWas)
{
    const auto fault = [](const FileCall& call) {
        const bool isPossible = call.isTransfer() || call.opensFile() || call.number == SYS_fsync;
        return Fault{isPossible ? EINTR : 0};
    };
    for (const auto& met : some(callsWith(fault), 12)) {
        SCOPED_TRACE(textOf(met));
        makeDrive();
        expectWhole(
            run([&](const FileCall& call) { return call.index == met.index ? fault(call) : Fault{}; }));
    }
}

TEST_P(HardFaults, ASecondFaultWhileTheFirstIsTakenBackLosesNothing)
{
    int pairs = 0;
    const auto tryAfter = [&](const FileCall& first, const Fault& fault) {
        const int last = runWithTwo(first.index, fault, 0, {}).calls;
        std::vector<int> seconds(static_cast<std::size_t>(std::max(0, last - first.index)));
        std::iota(seconds.begin(), seconds.end(), first.index + 1);
        for (const int second : some(seconds, 3)) {
            for (const auto& then : {Fault{EIO}, Fault{.isKill = true}}) {
                SCOPED_TRACE((fault.isShort ? "short, " : "EIO, ") + textOf(first)
                    + (then.isKill ? "; killed" : "; EIO") + " at call " + std::to_string(second));
                expectWhole(runWithTwo(first.index, fault, second, then));
                ++pairs;
                ++sweep_tests::tally().pairs;
            }
        }
    };
    for (const auto& first : some(callsWith([](const FileCall&) { return Fault{EIO}; }), 8)) {
        tryAfter(first, {EIO});
        if (first.mayNeedSpace() && first.length > 1)
            tryAfter(first, {.isShort = true});
    }
    EXPECT_GT(pairs, 0);
    RecordProperty("pairs", pairs);
}

TEST_P(HardFaults, ADiskThatBecomesFullLosesNothing)
{
    expectWholeFromThereOn([](const FileCall& call) { return Fault{call.mayNeedSpace() ? ENOSPC : 0}; });
}

TEST_P(HardFaults, AProcessWithoutDescriptorsLosesNothing)
{
    expectWholeFromThereOn([](const FileCall& call) { return Fault{call.opensFile() ? EMFILE : 0}; });
}

INSTANTIATE_TEST_SUITE_P(
    Operations, HardFaults, testing::ValuesIn(sweep_tests::operations()), testing::PrintToStringParamName());

} // namespace
