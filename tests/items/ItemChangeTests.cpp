// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/queues/GLibDispatch.h"
#include "items/ItemChange.h"
#include "tests/support/DriveFixture.h"

#include <gmock/gmock.h>

#include <future>
#include <thread>

namespace tarrow {
namespace {

using namespace testing_support;
using testing::ElementsAre;

/// Changes on the queues and threads of the host.
class ItemChangeTest : public testing::Test {
protected:
    ItemChangeTest()
    {
        auto set = drive.installed;
        set.dispatch = dispatch;
        platform::installServices(std::move(set));
    }

    DriveFixture drive;
    std::shared_ptr<host::system::GLibDispatch> dispatch = std::make_shared<host::system::GLibDispatch>();
};

TEST_F(ItemChangeTest, ChangesWaitForTheOnesBegunBeforeAndNobodyWaitsForThem)
{
    const auto main = std::this_thread::get_id();
    std::promise<void> isHeld;
    std::vector<std::string> order;
    int ended = 0;
    const auto end = [&](std::thread::id worker) {
        EXPECT_NE(worker, main);
        EXPECT_EQ(std::this_thread::get_id(), main);
        ++ended;
    };
    ItemChange::begin(
        AccountSession(), {},
        [&, held = isHeld.get_future().share()](ItemChange&) {
            held.wait();
            order.emplace_back("first");
            return std::this_thread::get_id();
        },
        end);
    ItemChange::begin(
        AccountSession(), {},
        [&](ItemChange&) {
            order.emplace_back("second");
            return std::this_thread::get_id();
        },
        end);
    isHeld.set_value();
    dispatch->runMainQueueUntil([&] { return ended == 2; });
    EXPECT_THAT(order, ElementsAre("first", "second"));
}

TEST_F(ItemChangeTest, CancelStopsBetweenItemsAndIsNoFailure)
{
    const auto a = drive.writeDocument("a.txt", "a"), b = drive.writeDocument("b.txt", "b"),
               c = drive.writeDocument("c.txt", "c");
    std::optional<std::vector<Error>> errors;
    const auto change = ItemChange::begin(
        AccountSession(), {drive.url("gone.txt"), a, b, c},
        [&](ItemChange& begun) {
            return begun.forEachItem([&](const Url& item) {
                if (item == b)
                    begun.cancel();
                return FileUtils::remove(item, begun.stillWanted());
            });
        },
        [&](std::vector<Error> answer) { errors = std::move(answer); });
    dispatch->runMainQueueUntil([&] { return errors.has_value(); });
    EXPECT_EQ(errors->size(), 1) << "only the item that was not there";
    EXPECT_EQ(change->doneCount(), 3);
    EXPECT_FALSE(FileUtils::exists(a));
    EXPECT_TRUE(FileUtils::exists(b)) << "its turn had come, but nothing had changed";
    EXPECT_TRUE(FileUtils::exists(c));
}

} // namespace
} // namespace tarrow
