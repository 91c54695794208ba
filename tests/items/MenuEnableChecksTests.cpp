// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/MenuEnableChecks.h"
#include "screens/list/DocumentListController.h"
#include "tests/items/support/ItemsFixture.h"

#include <set>

namespace tarrow {
namespace {

using items_tests::ItemsFixture;
using screens::DocumentListController;
using List = std::shared_ptr<DocumentListController>;

class MenuEnableChecksTest : public ItemsFixture {
protected:
    /// Answers a list that was shown, in edit mode, with these of its items selected.
    List shown(const List& list, const std::vector<Url>& selection = {}) const
    {
        list->view();
        settle();
        list->setEditingAnimated(true, false);
        list->setSelectedItems(selection);
        EXPECT_EQ(list->selectedItems().size(), selection.size());
        return list;
    }
    List shown(const Url& folder, const std::vector<Url>& selection = {}) const
    {
        return shown(DocumentListController::initWithURL(folder), selection);
    }
    Url library(const std::string& identifier, const std::string& levels) const
    {
        return describeContainer(
            identifier, levels.empty() ? "{}" : R"({"supportedFolderLevels": ")" + levels + R"("})");
    }
};

TEST_F(MenuEnableChecksTest, TheDrivesStructureIsKept)
{
    const auto sketches = library("sketches", "any"), notes = library("notes", "one");
    const auto file = writeDocument("a.txt"), folder = makeFolder("Folder");
    const struct {
        std::vector<Url> selection;
        bool mayMove, mayDelete;
    } rows[] = {
        {{}, false, false},
        {{file}, true, true},
        {{file, folder}, true, true},
        {{at("Desktop")}, false, false},
        {{file, folder, at("Documents")}, false, false},
        {{sketches}, false, true},
        {{sketches, notes}, false, true},
        {{sketches, file}, false, false},
        {{sketches, at("Desktop")}, false, false},
    };
    for (const auto& row : rows) {
        const auto list = shown(DocumentListController::createRootList(), row.selection);
        EXPECT_EQ(MenuEnableChecks::canShowMoveForSelectedItems(*list), row.mayMove)
            << platform::logText(row.selection);
        EXPECT_EQ(MenuEnableChecks::canShowDeleteForSelectedItems(*list), row.mayDelete)
            << platform::logText(row.selection);
    }
}

TEST_F(MenuEnableChecksTest, TheFolderLevelsOfAContainerAreKept)
{
    const struct {
        const char* levels;
        bool newFolderAtTop, newFolderBelow, mayMoveFolders;
        std::string topLine;
    } rows[] = {
        {"", true, true, true, "DEBUG Container box has no depth. Enabling new folder button"},
        {"any", true, true, true, "DEBUG Container box supports any folder. Enabling new folder button"},
        {"one", true, false, false,
            "DEBUG Container box supports one folder. File is depth 0. Enabling new folder button"},
        {"none", false, false, false, "DEBUG Container box supports no folders. Disabling new folder button"},
        {"two", false, false, false,
            "WARNING Container box has unknown depth option two. Disabling new folder button"},
    };
    for (const auto& row : rows) {
        const auto top = library("box", row.levels);
        const auto folder = top.appendingPathComponent("Folder"), file = top.appendingPathComponent("a.txt");
        std::filesystem::create_directories(folder.path() + "/Deeper");
        testing_support::writeFile(file.path(), "1");
        log->clear();
        EXPECT_EQ(MenuEnableChecks::canEnableNewFolderForSelectedItems(*shown(top)), row.newFolderAtTop);
        EXPECT_EQ(log->count(row.topLine), 1U) << row.levels;
        EXPECT_EQ(MenuEnableChecks::canEnableNewFolderForSelectedItems(*shown(folder)), row.newFolderBelow);
        EXPECT_EQ(MenuEnableChecks::canShowMoveForSelectedItems(*shown(top, {file})), true) << row.levels;
        EXPECT_EQ(
            MenuEnableChecks::canShowMoveForSelectedItems(*shown(top, {file, folder})), row.mayMoveFolders)
            << row.levels;
        EXPECT_EQ(MenuEnableChecks::containerSupportsAnyDepth(*shown(folder)), row.mayMoveFolders);
    }
    log->clear();
    library("box", "one");
    const auto deep = layout().containerDocuments("box") + "/Folder/Deeper";
    EXPECT_FALSE(MenuEnableChecks::canEnableNewFolderForSelectedItems(*shown(Url::fileURL(deep))));
    EXPECT_EQ(
        log->count("DEBUG Container box supports one folder. File is depth 2. Disabling new folder button"),
        1U);
}

TEST_F(MenuEnableChecksTest, WithoutAContainerNothingIsOffered)
{
    const auto outside = Url::fileURL(folder().at("outside"));
    const auto file = testing_support::writeFile(outside.path() + "/a.txt", "1");
    std::filesystem::create_directories(outside.path() + "/Folder");
    const auto list = shown(outside, {outside.appendingPathComponent("Folder")});
    log->clear();
    EXPECT_FALSE(MenuEnableChecks::canEnableNewFolderForSelectedItems(*list));
    EXPECT_FALSE(MenuEnableChecks::containerSupportsAnyDepth(*list));
    EXPECT_FALSE(MenuEnableChecks::canShowMoveForSelectedItems(*list));
    EXPECT_THAT(log->lines(),
        testing::Contains(testing::StartsWith("ERROR Couldn't get container for URL ")).Times(3));
    EXPECT_TRUE(MenuEnableChecks::containerHasSubfolders(file));
}

TEST_F(MenuEnableChecksTest, OnlyFoldersThatAreShownTakeMovedItems)
{
    const auto top = library("box", "any");
    const auto file = testing_support::writeFile(top.path() + "/a.txt", "1");
    for (const auto* name : {"/.hidden", "/Book.textbundle"})
        std::filesystem::create_directories(top.path() + name);
    std::filesystem::create_directory_symlink(top.path() + "/.hidden", top.path() + "/link");
    testing_support::writeFile(top.path() + "/.b.txt.trwpromise", host::drive::PromiseRecord{}.toJson());
    EXPECT_FALSE(MenuEnableChecks::containerHasSubfolders(file));

    host::drive::PromiseRecord promised;
    promised.kind = host::drive::PromiseRecord::Kind::Directory;
    testing_support::writeFile(top.path() + "/.Far.trwpromise", promised.toJson());
    EXPECT_TRUE(MenuEnableChecks::containerHasSubfolders(file)) << "a promised folder";
    std::filesystem::remove(top.path() + "/.Far.trwpromise");
    std::filesystem::create_directory(top.path() + "/Folder");
    EXPECT_TRUE(MenuEnableChecks::containerHasSubfolders(file));

    std::filesystem::remove_all(top.path());
    EXPECT_FALSE(MenuEnableChecks::containerHasSubfolders(top));

    EXPECT_EQ(MenuEnableChecks::numFoldersInURLArray({at("gone"), at("Desktop"), at("Documents")}), 1U);
    EXPECT_EQ(MenuEnableChecks::numFoldersInURLArray({at("gone"), writeDocument("b.txt")}), 0U);
}

TEST_F(MenuEnableChecksTest, OneFolderIsEnoughToLookAt)
{
    const auto top = library("box", "any");
    for (int number = 0; number < 50; ++number)
        std::filesystem::create_directories(top.path() + "/Folder " + std::to_string(number));
    std::set<std::string> looked;
    changeValues([&](const Url& item, AttributeMap&) {
        if (item.path().starts_with(top.path() + "/Folder "))
            looked.insert(item.path());
    });
    EXPECT_TRUE(MenuEnableChecks::containerHasSubfolders(top));
    EXPECT_EQ(looked.size(), 1U);
}

} // namespace
} // namespace tarrow
