// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/listing/ThreadedFolderLister.h"

#include "host/system/desktop/MimeTypeRegistry.h"
#include "host/system/files/ItemPaths.h"
#include "host/system/files/PromisedNames.h"
#include "host/system/queues/GLibDispatch.h"
#include "tests/support/TemporaryDirectory.h"
#include "tests/support/VirtualDispatch.h"

#include <fcntl.h>
#include <glib.h>
#include <gtest/gtest.h>
#include <sys/stat.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <numeric>
#include <random>
#include <thread>

using namespace platform;
using namespace std::chrono_literals;
using namespace host::system;
using namespace testing_support;

namespace {

using Snapshot = std::shared_ptr<const FolderSnapshot>;

std::vector<std::string> names(const Snapshot& snapshot)
{
    std::vector<std::string> found;
    for (std::size_t i = 0; i < snapshot->count(); ++i)
        found.emplace_back(snapshot->entry(i).name);
    return found;
}

class FolderListerTest : public testing::Test {
protected:
    std::shared_ptr<FolderListing> list(
        const std::string& path, std::vector<FolderSnapshot::ExtraItem> extras = {})
    {
        return lister.list(Url::fileURL(path, PathKind::Directory), std::move(extras), grouping,
            [this](Snapshot snapshot) { updates.push_back(std::move(snapshot)); });
    }
    /// Lists a folder to its end and then destroys the listing.
    Snapshot listOnce(const std::string& path, std::vector<FolderSnapshot::ExtraItem> extras = {})
    {
        const auto listing = list(path, std::move(extras));
        dispatch->runUntilIdle();
        EXPECT_FALSE(updates.empty());
        return updates.empty() ? nullptr : updates.back();
    }
    /// Runs the kernel's notices and the virtual clock until an update has come.
    void waitForUpdate()
    {
        const auto deadline = std::chrono::steady_clock::now() + 30s;
        const auto before = updates.size();
        while (updates.size() == before && std::chrono::steady_clock::now() < deadline) {
            g_main_context_iteration(nullptr, FALSE);
            dispatch->advance(0.01);
        }
        ASSERT_GT(updates.size(), before);
    }

    platform::FolderGrouping grouping = platform::FolderGrouping::FoldersFirst;
    TemporaryDirectory directory;
    std::shared_ptr<VirtualDispatch> dispatch = VirtualDispatch::create();
    std::shared_ptr<MimeTypeRegistry> types = std::make_shared<MimeTypeRegistry>();
    ThreadedFolderLister lister{dispatch, types, "en_US"};
    std::vector<Snapshot> updates;
};

TEST_F(FolderListerTest, ShowsItemsByTheirNamesInNaturalOrder)
{
    for (const char* name :
        {"file 10.txt", "file 2.txt", "File 1.txt", "élan", "eland", "zebra", "_x", ".hidden", "ref.trwref",
            "alias.trwalias", "Notes.rtfd/TXT.rtf", "sub b/x", "sub A/x", "no\xffutf8"})
        directory.write(name, "");
    std::filesystem::create_symlink("zebra", directory.at("link"));
    mkfifo(directory.at("pipe").c_str(), 0600);
    const auto snapshot = listOnce(directory.path());
    ASSERT_EQ(snapshot->stage(), ListingStage::Complete);
    EXPECT_EQ(names(snapshot),
        (std::vector<std::string>{"sub A", "sub b", "_x", "alias.trwalias", "élan", "eland", "File 1.txt",
            "file 2.txt", "file 10.txt", "link", "Notes.rtfd", "no\xffutf8", "pipe", "ref.trwref", "zebra"}));
    const auto kind = [&](std::size_t index) { return snapshot->entry(index).kind; };
    EXPECT_EQ(kind(0), FolderEntryKind::Folder);
    EXPECT_EQ(kind(2), FolderEntryKind::Document);
    EXPECT_EQ(kind(3), FolderEntryKind::Link);
    EXPECT_EQ(kind(9), FolderEntryKind::Link);
    EXPECT_EQ(kind(10), FolderEntryKind::Package);
    EXPECT_EQ(kind(13), FolderEntryKind::Link);
    EXPECT_EQ(snapshot->url(0), Url::fileURL(directory.at("sub A")));
    EXPECT_TRUE(snapshot->url(10).hasDirectoryPath());
}

TEST_F(FolderListerTest, PromisesShowAsWhatTheyPromiseUnlessItIsHere)
{
    for (const char* name :
        {".far.txt.trwpromise", ".both.txt.trwpromise", "both.txt", ".Big.pages.trwpromise", ".trwpromise",
            "..secret.trwpromise", ".folder.trwpromise", "folder/x", "open.trwpromise"})
        directory.write(name, "{}");
    std::filesystem::create_directory(directory.at(".dir.trwpromise"));
    const auto snapshot = listOnce(directory.path());
    EXPECT_EQ(names(snapshot),
        (std::vector<std::string>{"folder", "Big.pages", "both.txt", "far.txt", "open.trwpromise"}));
    EXPECT_TRUE(snapshot->entry(1).isPromise);
    EXPECT_EQ(snapshot->entry(1).kind, FolderEntryKind::Package);
    EXPECT_FALSE(snapshot->entry(2).isPromise);
    EXPECT_TRUE(snapshot->entry(3).isPromise);
    EXPECT_EQ(snapshot->url(3), Url::fileURL(directory.at("far.txt")));
}

TEST_F(FolderListerTest, FollowsThePromisesOfLongNames)
{
    const std::string first(250, 'a'), second(255, 'b');
    const auto promise = [&](const std::string& name) { return promisePath(directory.at(name)); };
    std::ofstream(promise(first)) << R"({"name": ")" + first + R"("})";
    const auto listing = list(directory.path());
    dispatch->runUntilIdle();
    ASSERT_EQ(names(updates.back()), std::vector{first});
    EXPECT_TRUE(updates.back()->entry(0).isPromise);

    const FileDescriptor folder(::open(directory.path().c_str(), O_PATH | O_CLOEXEC));
    ASSERT_FALSE(addPromisedName(folder, std::string(lastName(promise(first))), second));
    std::filesystem::rename(promise(first), promise(second));
    while (names(updates.back()) != std::vector{second} && !HasFailure())
        waitForUpdate();
    std::filesystem::remove(promise(second));
    while (updates.back()->count() > 0 && !HasFailure())
        waitForUpdate();
}

TEST_F(FolderListerTest, ExtraItemsStandAmongTheFolders)
{
    directory.write("Alpha/x", "");
    directory.write("Omega/x", "");
    directory.write("a.txt", "");
    const auto library = Url::fileURL("/elsewhere/Documents");
    const auto snapshot = listOnce(directory.path(),
        {{library, "Mail", FolderEntryKind::Library, "mail-icon"}, {library, "Zebra", {}, {}}});
    EXPECT_EQ(names(snapshot), (std::vector<std::string>{"Alpha", "Mail", "Omega", "a.txt", "Zebra"}));
    ASSERT_TRUE(snapshot->extraItem(1));
    EXPECT_EQ(snapshot->extraItem(1)->iconName, "mail-icon");
    EXPECT_EQ(snapshot->url(1), library);
    EXPECT_EQ(snapshot->extraItem(0), nullptr);

    grouping = platform::FolderGrouping::Mixed;
    EXPECT_EQ(names(listOnce(directory.path(), {{library, "Mail", FolderEntryKind::Library, {}}})),
        (std::vector<std::string>{"a.txt", "Alpha", "Mail", "Omega"}));
}

TEST_F(FolderListerTest, OrderFollowsTheLanguage)
{
    for (const char* name : {"ö", "o", "z"})
        directory.write(name, "");
    EXPECT_EQ(names(listOnce(directory.path())), (std::vector<std::string>{"o", "ö", "z"}));
    ThreadedFolderLister swedish(dispatch, types, "sv_SE");
    const auto listing =
        swedish.list(Url::fileURL(directory.path().string()), {}, platform::FolderGrouping::FoldersFirst,
            [this](Snapshot snapshot) { updates.push_back(std::move(snapshot)); });
    dispatch->runUntilIdle();
    EXPECT_EQ(names(updates.back()), (std::vector<std::string>{"o", "z", "ö"}));
}

TEST_F(FolderListerTest, FoldersThatCannotBeReadFailWithTheReason)
{
    const auto file = directory.write("file", "");
    std::filesystem::create_directory_symlink("/usr", directory.at("link"));
    EXPECT_EQ(listOnce(file)->error()->code(), ENOTDIR);
    EXPECT_EQ(listOnce(directory.at("link"))->stage(), ListingStage::Failed);
}

class LargeFolderTest : public FolderListerTest {
protected:
    /// Makes empty files with names in random order. They are hard links of one file, so that making them is
    /// quick.
    void fill(int count, const std::string& folder = "large")
    {
        const auto first = directory.write(folder + "/name 0", "");
        std::vector<int> numbers(static_cast<std::size_t>(count) - 1);
        std::iota(numbers.begin(), numbers.end(), 1);
        std::ranges::shuffle(numbers, std::mt19937(1));
        for (const int number : numbers)
            std::filesystem::create_hard_link(
                first, directory.at(folder + "/name " + std::to_string(number)));
    }
    void expectNaturalOrder(const Snapshot& snapshot)
    {
        for (std::size_t i = 0; i < snapshot->count(); ++i)
            ASSERT_EQ(snapshot->entry(i).name, "name " + std::to_string(i));
    }
};

TEST_F(LargeFolderTest, FolderThatTurnsUnreadableMidwayFailsWithWhatWasRead)
{
    fill(9000);
    const auto listing = list(directory.at("large"));
    // This runs after the first block was read and before the second one is.
    dispatch->mainQueue()->async([this] { std::filesystem::remove_all(directory.at("large")); });
    dispatch->runUntilIdle();
    ASSERT_EQ(updates.size(), 1U);
    EXPECT_EQ(updates[0]->stage(), ListingStage::Failed);
    EXPECT_TRUE(updates[0]->error()->is(FileErrorCode::NoSuchItem));
    EXPECT_GE(updates[0]->count(), 4096U);
    EXPECT_LT(updates[0]->count(), 9000U);
}

TEST_F(LargeFolderTest, IsReadWholeWhereLooksAtItsNamesWouldCostMore)
{
    const auto readWhole = [this] { return !updates.back()->revision(); };
    directory.write("large/name 0", "");
    const auto listing = list(directory.at("large"));
    dispatch->runUntilIdle();
    fill(6000); // more names at once than are worth a look each
    while (updates.back()->count() < 6000)
        waitForUpdate();
    EXPECT_TRUE(readWhole());
    expectNaturalOrder(updates.back());
    directory.write("large/.hidden", "");
    directory.write("large/name 6000", "");
    waitForUpdate();
    EXPECT_FALSE(readWhole());
    EXPECT_EQ(updates.back()->revision()->inserted, std::vector<std::uint32_t>{6000});
    expectNaturalOrder(updates.back());

    // The names of removed items stay in memory until they take more of it than the others.
    const auto longName = [](int i) { return "x/" + std::string(240, 'n') + std::to_string(i); };
    directory.write("x/a", "");
    const auto other = list(directory.at("x"));
    dispatch->runUntilIdle();
    const auto before = updates.size();
    for (int i = 0; i < 400; ++i) {
        const auto path = directory.write(longName(i), "");
        waitForUpdate();
        std::filesystem::remove(path);
        waitForUpdate();
    }
    while (updates.back()->count() != 1)
        waitForUpdate();
    EXPECT_EQ(names(updates.back()), std::vector<std::string>{"a"});
    const auto wholeLists = std::count_if(updates.begin() + static_cast<std::ptrdiff_t>(before),
        updates.end(), [](const Snapshot& update) { return !update->revision(); });
    EXPECT_GE(wholeLists, 1);
    EXPECT_LE(wholeLists, 3);
}

TEST_F(LargeFolderTest, RealThreadsGiveTheSameList)
{
    fill(20'000);
    updates.clear();
    auto real = std::make_shared<host::system::GLibDispatch>();
    ThreadedFolderLister threaded(real, types, "en_US");
    const auto run = [&](const auto& done) {
        const auto deadline = std::chrono::steady_clock::now() + 60s;
        while (!done() && std::chrono::steady_clock::now() < deadline)
            g_main_context_iteration(nullptr, TRUE);
        ASSERT_TRUE(done());
    };
    const auto url = Url::fileURL(directory.at("large"));
    auto listing = threaded.list(url, {}, platform::FolderGrouping::FoldersFirst, [this](Snapshot snapshot) {
        EXPECT_EQ(snapshot->stage() == ListingStage::FirstRows, snapshot->count() < 20'000);
        expectNaturalOrder(snapshot);
        updates.push_back(std::move(snapshot));
    });
    run([&] { return !updates.empty() && updates.back()->stage() == ListingStage::Complete; });
    // Listings that are destroyed at any moment never call again.
    for (int i = 0; i < 20; ++i) {
        listing = threaded.list(url, {}, platform::FolderGrouping::FoldersFirst,
            [](auto) { ADD_FAILURE() << "called after its end"; });
        listing.reset();
    }
    bool later = false;
    real->after(50ms, real->mainQueue(), [&] { later = true; });
    run([&] { return later; });
}

TEST_F(FolderListerTest, ChangesBringOneNewListAndNoneAfterTheEnd)
{
    directory.write("a", "");
    auto listing = list(directory.path());
    dispatch->runUntilIdle();
    ASSERT_EQ(updates.size(), 1U);
    for (const char* name : {"b", "c", "d"})
        directory.write(name, "");
    std::filesystem::remove(directory.at("a"));
    waitForUpdate();
    EXPECT_EQ(names(updates.back()), (std::vector<std::string>{"b", "c", "d"}));
    EXPECT_EQ(updates.size(), 2U);
    directory.write("e", "");
    listing.reset();
    for (int i = 0; i < 20; ++i)
        g_main_context_iteration(nullptr, FALSE);
    dispatch->advance(1);
    EXPECT_EQ(updates.size(), 2U);
}

TEST_F(FolderListerTest, FolderThatGoesAwayIsReportedAndUpdatesMayEndTheListing)
{
    directory.write("sub/a", "");
    auto listing = list(directory.at("sub"));
    dispatch->runUntilIdle();
    std::filesystem::remove_all(directory.at("sub"));
    do
        waitForUpdate();
    while (updates.back()->stage() != ListingStage::Failed);
    EXPECT_TRUE(updates.back()->error()->is(FileErrorCode::NoSuchItem));
    int calls = 0;
    listing = lister.list(
        Url::fileURL(directory.path().string()), {}, platform::FolderGrouping::FoldersFirst, [&](Snapshot) {
            ++calls;
            listing.reset();
        });
    dispatch->runUntilIdle();
    EXPECT_EQ(calls, 1);
}

} // namespace
