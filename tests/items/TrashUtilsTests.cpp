// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/TrashUtils.h"
#include "platform/CopyName.h"
#include "tests/support/DriveFixture.h"

namespace {

using namespace tarrow;
using testing_support::contentOf;

class TrashUtilsTest : public testing::Test, public testing_support::DriveFixture { };

TEST_F(TrashUtilsTest, AnItemThatComesBackTakesNoPlace)
{
    std::vector<TrashedItem> moved;
    for (const auto* content : {"first", "second", "third"})
        moved.push_back(*TrashUtils::moveToTrash(writeDocument("inner/a.tar", content)).value);
    EXPECT_EQ(*TrashUtils::restore(moved[0]).value, url("inner/a.tar"));
    EXPECT_TRUE(TrashUtils::restore(moved[1]).error->is(FileErrorCode::ItemExists));
    EXPECT_EQ(*TrashUtils::restoreBeside(moved[1]).value, url("inner/a 2.tar"));
    EXPECT_EQ(*TrashUtils::restoreBeside(moved[2]).value, url("inner/a 3.tar"));
    EXPECT_EQ(contentOf(url("inner/a 3.tar")), "third");
}

TEST_F(TrashUtilsTest, WhatIsNotWantedAnyMoreStays)
{
    const auto item = writeDocument("a.txt");
    const auto unwanted = [] { return false; };
    EXPECT_TRUE(TrashUtils::moveToTrash(item, unwanted).error->is(FileErrorCode::Cancelled));
    const auto moved = TrashUtils::moveToTrash(item);
    ASSERT_TRUE(moved);
    EXPECT_TRUE(TrashUtils::restore(*moved, unwanted).error->is(FileErrorCode::Cancelled));
    EXPECT_FALSE(FileUtils::exists(item));
}

TEST(CopyNames, FitTheFileSystem)
{
    const struct {
        std::string name;
        int number;
        std::string copy;
    } rows[] = {
        {"Plan.pdf", 1, "Plan.pdf"},
        {"Plan.pdf", 2, "Plan 2.pdf"},
        {".hidden", 3, ".hidden 3"},
        {std::string(251, 'n') + ".txt", 12, std::string(248, 'n') + " 12.txt"},
        {std::string(250, 'n') + "ü.x", 2, std::string(250, 'n') + " 2.x"},
        {std::string(249, 'n') + "ü.xy", 2, std::string(249, 'n') + " 2.xy"},
    };
    for (const auto& row : rows)
        EXPECT_EQ(platform::copyName(row.name, row.number), row.copy);
}

} // namespace
