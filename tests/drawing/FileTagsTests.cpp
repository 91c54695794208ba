// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "drawing/FileTags.h"
#include "platform/Log.h"
#include "platform/NotificationCenter.h"
#include "tests/support/DriveFixture.h"

#include <cstdio>
#include <latch>
#include <thread>

namespace tarrow {
namespace {

using namespace testing;

class FileTagsTest : public testing::Test {
protected:
    /// Replaces the store's file as another program does, and delivers the notice of the change.
    void store(const std::string& json)
    {
        const auto path = drive.layout().keyValueStore(), beside = path + ".new";
        std::ofstream(beside) << json;
        ASSERT_EQ(std::rename(beside.c_str(), path.c_str()), 0);
        drive.settle();
    }
    void storeTags(const std::string& entries, int version = 2)
    {
        store(R"({"PathwellTagDict": {"PathwellTagDictVersion": )" + std::to_string(version)
            + R"(, "PathwellTags": [)" + entries + "]}}");
    }

    testing_support::DriveFixture drive;
    const std::string emptyLine = "WARNING Pathwell tag dictionary is empty";
};

// One test tells the whole story, because the table is kept for the life of the process.
TEST_F(FileTagsTest, TheTableFollowsTheStore)
{
    const auto& colors = FileTags::_tagBlipColors();
    // The first questions come from several threads at once.
    std::latch together(8);
    std::vector<std::jthread> threads;
    for (int i = 0; i < 8; ++i) {
        threads.emplace_back([&together] {
            together.arrive_and_wait();
            EXPECT_THAT(FileTags::tagColorsByTag(), IsEmpty());
        });
    }
    // Meanwhile this thread observes and delivers other notices.
    for (int i = 0; i < 100; ++i) {
        const auto observation =
            drive.notifications->observe(platform::Notification::DownloadsDidChange, [](const auto&) {});
        drive.notifications->post(platform::Notification::DownloadsDidChange);
    }
    threads.clear();
    EXPECT_THAT(FileTags::allTags(), IsEmpty());
    EXPECT_EQ(drive.log->count(emptyLine), 1U) << "the table is read once";

    storeTags(R"({"n": "Work", "l": 2}, {"n": "Home"}, {"n": "Work", "l": 6}, {"n": "Far", "l": 9},
        {"n": "Odd", "l": -1}, {"l": 3}, {"n": 4}, "Loose", {"n": "", "l": 7})");
    EXPECT_THAT(FileTags::allTags(), ElementsAre("Work", "Home", "Work", "Far", "Odd", ""));
    auto byTag = FileTags::tagColorsByTag();
    EXPECT_EQ(byTag.at("Work"), colors[6]);
    EXPECT_EQ(byTag.at("Home"), colors[0]);
    EXPECT_EQ(byTag.at("Far"), colors[0]);
    EXPECT_EQ(byTag.at("Odd"), colors[0]);
    EXPECT_EQ(byTag.at(""), colors[7]);
    EXPECT_EQ(FileTags::colorOfTag("Work"), colors[6]);
    EXPECT_EQ(FileTags::colorOfTag("work"), std::nullopt);

    drive.log->clear();
    storeTags(R"({"n": "Work", "l": 2})", 1);
    EXPECT_THAT(FileTags::allTags(), IsEmpty());
    EXPECT_THAT(FileTags::tagColorsByTag(), IsEmpty());
    EXPECT_THAT(drive.log->lines(),
        ElementsAre("DEBUG Pathwell tag dictionary has incorrect version (1, should be 2)", emptyLine));

    storeTags(R"({"n": "Work", "l": 2})");
    EXPECT_EQ(FileTags::tagColorsByTag().at("Work"), colors[2]);
    drive.log->clear();
    store(R"({"PathwellTagDict": {}})");
    EXPECT_THAT(drive.log->lines(),
        ElementsAre("DEBUG Pathwell tag dictionary has incorrect version (0, should be 2)", emptyLine));
}

} // namespace
} // namespace tarrow
