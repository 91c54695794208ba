// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "DriveTests.h"

#include <gmock/gmock.h>

namespace e2e {
namespace {

class BrowseTests : public DriveTests { };

TEST_F(BrowseTests, ASearchFindsWhatLiesElsewhereAndShowsItsPlace)
{
    start();
    const auto search = [this](const char* text) {
        program->pressUntil("Search", [this] { return !program->entries().empty(); });
        ASSERT_FALSE(program->entries().empty());
        EXPECT_TRUE(program->entries().back().enter(text));
    };
    program->press("Desktop");
    expectShown("To do.txt");
    search("TUSC");
    program->press("Summer in Tuscany");
    EXPECT_TRUE(
        eventually([this] { return program->shows("05 Hot springs.jpg") && program->entries().empty(); }));
    program->press("Back");
    EXPECT_TRUE(eventually([this] { return program->shows("Winter hike"); })) << "not in its real place";

    search("tusc");
    ASSERT_TRUE(eventually([this] { return program->shows("Tuscany.md"); }));
    EXPECT_TRUE(program->buttons("Tuscany.md").back().perform("row.menu"));
    program->press("Show in Its Folder");
    EXPECT_TRUE(eventually([this] { return program->entries().empty() && program->shows("Tuscany.md"); }));
    program->press("Back");
    EXPECT_TRUE(eventually([this] { return program->shows("Ideas.md"); })) << "not in its real place";

    search("tag:fam");
    EXPECT_TRUE(eventually([this] { return program->shows("Grandma's plum dumplings.txt"); }));
    EXPECT_FALSE(program->shows("Lemon cake.md")) << "it has another tag";
}

TEST_F(BrowseTests, AnItemGoesToANewFolderThroughThePicker)
{
    start();
    program->press("Desktop");
    ASSERT_TRUE(eventually([this] { return program->shows("To do.txt"); }));
    EXPECT_TRUE(program->buttons("To do.txt").back().perform("row.menu"));
    program->press("Move");
    ASSERT_TRUE(eventually([this] { return program->shows("Move Here"); }));
    EXPECT_FALSE(program->buttons("Move Here").back().isSensitive()) << "it lies here already";
    program->pressUntil("Back", [this] { return program->shows("Photos"); });
    program->press("Photos");
    ASSERT_TRUE(eventually([this] { return program->shows("Winter hike"); }));
    program->press("New Folder");
    ASSERT_TRUE(eventually([this] { return !program->entries().empty(); }));
    EXPECT_EQ(program->entries().back().name(), "Name");
    EXPECT_TRUE(program->entries().back().enter("Lists"));
    program->press("Create");
    ASSERT_TRUE(eventually([this] { return program->entries().empty() && program->says("Lists"); }));
    program->pressUntil("Move Here", [this] { return !program->shows("Move Here"); });
    expectGone("To do.txt");
    EXPECT_TRUE(std::filesystem::exists(top / "Photos/Lists/To do.txt"));
    EXPECT_TRUE(program->shows("Packing list.md"));
    EXPECT_TRUE(eventually([this] { return program->says("“To do.txt” was moved to “Lists”"); }));
    pressKey('z', Modifier::Control);
    expectShown("To do.txt");
    EXPECT_TRUE(std::filesystem::exists(top / "Desktop/To do.txt"));
    EXPECT_TRUE(eventually([this] { return !program->shows("Undo"); })) << "its message went";
}

TEST_F(BrowseTests, WhatIsCopiedInOneFolderIsPastedInAnother)
{
    start();
    program->press("Desktop");
    ASSERT_TRUE(eventually([this] { return program->shows("To do.txt"); }));
    EXPECT_TRUE(program->buttons("To do.txt").back().perform("row.menu"));
    program->press("Copy");
    EXPECT_TRUE(eventually([this] { return program->says("“To do.txt” was copied"); }));
    for (const auto* name : {"To do.txt", "To do 2.txt"}) {
        program->pressUntil("Back", [this] { return program->shows("Photos"); });
        program->press("Photos");
        ASSERT_TRUE(eventually([this] { return program->shows("Winter hike"); }));
        pressKey('v', Modifier::Control);
        expectShown(name);
        EXPECT_TRUE(std::filesystem::exists(top / "Photos" / name));
    }
    pressKey('z', Modifier::Control);
    expectGone("To do 2.txt");
    EXPECT_TRUE(std::filesystem::exists(top / "Photos/To do.txt"));
    EXPECT_TRUE(std::filesystem::exists(top / "Desktop/To do.txt"));
}

TEST_F(BrowseTests, ADownloadIsRemovedAndComesBack)
{
    start();
    program->press("Desktop");
    ASSERT_TRUE(eventually([this] { return program->shows("To do.txt"); }));
    const auto document = top / "Desktop/To do.txt";
    const auto size = std::filesystem::file_size(document);
    EXPECT_TRUE(program->buttons("To do.txt").back().perform("row.menu"));
    program->press("Remove Download");
    EXPECT_TRUE(eventually([this] { return program->says("1 download was removed"); }));
    EXPECT_TRUE(program->shows("To do.txt"));
    EXPECT_FALSE(std::filesystem::exists(document));
    EXPECT_TRUE(program->buttons("To do.txt").back().perform("row.menu"));
    program->press("Download");
    EXPECT_TRUE(eventually([&] { return std::filesystem::exists(document); }));
    EXPECT_EQ(std::filesystem::file_size(document), size);
}

TEST_F(BrowseTests, AWindowSaysWhatNeedsNoAnswer)
{
    start();
    program->pressUntil("Desktop", [this] { return program->shows("System pictures"); });
    program->press("System pictures");
    EXPECT_TRUE(eventually(
        [this] { return program->says("“System pictures” leads to a place outside the drive."); }));
    std::filesystem::rename(top / "Desktop", top / "Elsewhere");
    EXPECT_TRUE(eventually([this] { return program->says("“Desktop” is no longer there."); }));
    EXPECT_TRUE(eventually([this] { return program->shows("Elsewhere"); }));
}

} // namespace
} // namespace e2e
