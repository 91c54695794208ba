// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/Weakly.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

using platform::weakly;
using platform::weaklyOr;

namespace {

/// Writes down its steps in a list that outlives it.
struct Listener : std::enable_shared_from_this<Listener> {
    explicit Listener(std::vector<std::string>& heard)
        : list(heard)
    {
    }
    ~Listener() { list.emplace_back("end"); }

    void step() { list.emplace_back("step"); }
    void hear(const std::string& what, int number) { list.push_back(what + " " + std::to_string(number)); }
    bool answer(int number) const { return number == 7; }

    std::vector<std::string>& list;
};

class Weakly : public testing::Test {
protected:
    std::vector<std::string> heard;
    std::shared_ptr<Listener> listener = std::make_shared<Listener>(heard);
};

using Lines = std::vector<std::string>;

TEST_F(Weakly, CallsAMemberUntilTheObjectIsGone)
{
    const std::function<void()> pointer = weakly(listener.get(), &Listener::step);
    const std::function<void()> strong = weakly(listener, &Listener::step);
    const std::function<void()> weak = weakly(std::weak_ptr(listener), &Listener::step);
    for (const auto& call : {pointer, strong, weak})
        call();
    EXPECT_EQ(heard, (Lines{"step", "step", "step"}));
    listener.reset();
    heard.clear();
    for (const auto& call : {pointer, strong, weak})
        call();
    EXPECT_TRUE(heard.empty());
}

TEST_F(Weakly, PassesBoundArgumentsFirstAndLeavesOutWhatTheStepDoesNotTake)
{
    const std::function<void(int)> bound = weakly(listener, &Listener::hear, std::string("bound"));
    bound(1);
    bound(2);
    const std::function<void(int)> without = weakly(listener, &Listener::step);
    without(3);
    EXPECT_EQ(heard, (Lines{"bound 1", "bound 2", "step"}));
}

TEST_F(Weakly, KeepsTheObjectUntilTheStepIsOver)
{
    const auto call = weakly(listener, [this](Listener& self, int number) {
        listener.reset();
        self.hear("alive", number);
    });
    call(1);
    EXPECT_EQ(heard, (Lines{"alive 1", "end"}));
}

TEST_F(Weakly, AnswersTheFallbackOnceTheObjectIsGone)
{
    const Listener* const constant = listener.get();
    const std::function<bool(int)> asked = weaklyOr(true, constant, &Listener::answer);
    EXPECT_TRUE(asked(7));
    EXPECT_FALSE(asked(8));
    listener.reset();
    EXPECT_TRUE(asked(8));
}

TEST_F(Weakly, CountsAnObjectThatNobodyHoldsAsGone)
{
    Listener held(heard);
    weakly(&held, &Listener::step)();
    EXPECT_TRUE(heard.empty());
}

} // namespace
