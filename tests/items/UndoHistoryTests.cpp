// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/ItemFacts.h"
#include "items/ItemMoves.h"
#include "platform/FileSystem.h"
#include "tests/support/DriveFixture.h"

#include <gmock/gmock.h>

namespace tarrow {
namespace {

using namespace testing_support;
using testing::ElementsAre;
using testing::IsEmpty;

class UndoHistoryTest : public testing::Test {
protected:
    /// Begins a change that moves items into a folder, as one entry.
    void move(std::vector<Url> items, const Url& folder)
    {
        ItemChange::begin(
            asked, std::move(items),
            [folder](ItemChange& change) { return undoOfMoves(moveItems(change, folder).moved); },
            [expected = UndoHistory::expect(history, asked)](const std::optional<UndoEntry>& undo) {
                if (undo)
                    expected->add(*undo);
            });
    }
    /// Makes a folder as one entry, and moves an item into it when there is one.
    void makeFolder(const Url& folder, std::vector<Url> items)
    {
        const auto expected = UndoHistory::expect(history, asked);
        EXPECT_FALSE(FileUtils::mkdir(folder));
        ItemChange change(asked, std::move(items));
        const auto moved = moveItems(change, folder).moved;
        expected->add(undoOfNewFolder(madeFolder(folder), moved));
    }
    /// Undoes the latest change and answers the sentences of the items that stayed.
    std::vector<std::string> undo()
    {
        refusals.clear();
        history->undoLatest();
        drive.settle();
        return refusals;
    }
    bool isThere(std::string_view path) const { return FileUtils::exists(drive.url(path)); }

    DriveFixture drive;
    AccountSession asked;
    std::vector<std::string> refusals;
    std::size_t undone = 0;
    std::shared_ptr<UndoHistory> history = std::make_shared<UndoHistory>(UndoHistory::Handlers{
        .added = [](auto, const auto&) {},
        .begun = [](const auto&) {},
        .ended =
            [this](const auto&, const UndoOutcome& outcome) {
                ++undone;
                for (const auto& error : outcome.errors)
                    refusals.push_back(error.text(platform::errorKey::localizedDescription).value_or("?"));
            },
    });
};

TEST_F(UndoHistoryTest, ManyItemsGoBackAtOnceAndThoseThatCannotAreNamed)
{
    const auto trip = drive.makeFolder("Trip");
    const auto a = drive.writeDocument("a.txt", "a"), b = drive.writeDocument("b.txt", "b"),
               c = drive.writeDocument("c.txt", "c"), d = drive.writeDocument("Old/d.txt", "d"),
               e = drive.writeDocument("e.txt", "e");
    const auto promised = drive.writePromise("far.txt", {});
    move({a, b, c, d, e, promised}, trip);
    drive.settle();
    ASSERT_TRUE(isThere("Trip/d.txt"));

    drive.writeDocument("b.txt", "another b");
    std::filesystem::rename(drive.writeDocument("new c", "another c").path(), drive.url("Trip/c.txt").path());
    std::filesystem::remove(drive.url("Old").path());
    std::filesystem::remove(drive.url("Trip/e.txt").path());
    EXPECT_THAT(undo(),
        ElementsAre("“b.txt” wasn’t put back, because its old place is taken.",
            "“c.txt” wasn’t put back, because another program has changed it.",
            "“d.txt” wasn’t put back, because the folder “Old” is no longer there.",
            "“e.txt” is no longer there."));
    EXPECT_EQ(contentOf(a), "a");
    EXPECT_EQ(contentOf(b), "another b");
    EXPECT_EQ(contentOf(drive.url("Trip/b.txt")), "b");
    EXPECT_EQ(contentOf(drive.url("Trip/c.txt")), "another c");
    EXPECT_EQ(contentOf(drive.url("Trip/d.txt")), "d");
    EXPECT_TRUE(platform::services().fileChanges().versionOfItem(promised.path()));
    EXPECT_EQ(history->count(), 0U);
    EXPECT_FALSE(history->undoLatest());
}

TEST_F(UndoHistoryTest, ADocumentThatWasSavedSinceGoesBack)
{
    const auto trip = drive.makeFolder("Trip");
    const auto a = drive.writeDocument("a.txt", "a");
    drive.mark(a, host::drive::itemMark::documentIdentifier, "17");
    move({a}, trip);
    drive.settle();
    const auto saved = drive.writeDocument("saving", "saved");
    drive.mark(saved, host::drive::itemMark::documentIdentifier, "17");
    std::filesystem::rename(saved.path(), drive.url("Trip/a.txt").path());
    EXPECT_THAT(undo(), IsEmpty());
    EXPECT_EQ(contentOf(a), "saved");
}

TEST_F(UndoHistoryTest, ANewFolderGoesOnlyWhileNobodyUsesIt)
{
    const auto folder = drive.url("Trip");
    struct Row {
        const char* what;
        std::function<void()> meanwhile;
        const char* refusal; ///< null: the folder goes
    };
    const Row rows[] = {
        {"untouched", [] {}, nullptr},
        {"filled", [&] { drive.writeDocument("Trip/new.txt"); },
            "The folder “Trip” was kept, because another program has changed it."},
        {"replaced",
            [&] {
                std::filesystem::rename(folder.path(), drive.url("Elsewhere").path());
                drive.makeFolder("Trip");
            },
            "The folder “Trip” was kept, because another program has changed it."},
        {"gone", [&] { std::filesystem::remove(folder.path()); }, "“Trip” is no longer there."},
    };
    for (const auto& row : rows) {
        std::filesystem::remove_all(folder.path());
        makeFolder(folder, {});
        row.meanwhile();
        const auto said = undo();
        EXPECT_EQ(said, row.refusal ? std::vector<std::string>{row.refusal} : std::vector<std::string>())
            << row.what;
        EXPECT_EQ(isThere("Trip"), row.refusal && FileUtils::exists(folder)) << row.what;
    }
    const auto a = drive.writeDocument("a.txt", "a");
    std::filesystem::remove_all(folder.path());
    makeFolder(folder, {a});
    EXPECT_THAT(undo(), IsEmpty());
    EXPECT_EQ(contentOf(a), "a");
    EXPECT_FALSE(isThere("Trip"));
}

/// Lets another program put a document into the folder between the two looks of its removal.
class FillingFileSystem : public platform::FileSystem {
public:
    FillingFileSystem(std::shared_ptr<FileSystem> files, std::function<void()> onFirstLook)
        : real(std::move(files))
        , looked(std::move(onFirstLook))
    {
    }
    Result<platform::FileAttributes> attributesOfItem(const std::string& path) const override
    {
        return real->attributesOfItem(path);
    }
    Result<std::string> destinationOfSymbolicLink(const std::string& path) const override
    {
        return real->destinationOfSymbolicLink(path);
    }
    std::optional<platform::FileType> typeOfItem(const std::string& path) const override
    {
        return real->typeOfItem(path);
    }
    std::optional<Url> userDocumentsFolder() const override { return real->userDocumentsFolder(); }
    void enumerateDeeply(const Url& folder,
        const std::function<Continue(const Url&, platform::FileType)>& entry,
        const std::function<Continue(const Url&, const Error&)>& error) const override
    {
        real->enumerateDeeply(folder, entry, error);
    }
    void enumerateShallowly(const Url& folder,
        const std::function<Continue(const Url&, platform::FileType)>& entry,
        const std::function<Continue(const Url&, const Error&)>& error) const override
    {
        real->enumerateShallowly(folder, entry, error);
        std::exchange(looked, [] {})();
    }

private:
    std::shared_ptr<FileSystem> real;
    mutable std::function<void()> looked;
};

TEST_F(UndoHistoryTest, WhatIsPutIntoAFolderWhileItIsUndoneStays)
{
    makeFolder(drive.url("Trip"), {});
    auto set = drive.installed;
    set.fileSystem = std::make_shared<FillingFileSystem>(
        set.fileSystem, [this] { drive.writeDocument("Trip/new.txt", "new"); });
    platform::installServices(std::move(set));
    EXPECT_THAT(undo(), ElementsAre("The folder “Trip” was kept, because it isn’t empty."));
    EXPECT_EQ(contentOf(drive.url("Trip/new.txt")), "new");
}

TEST_F(UndoHistoryTest, TheChangeThatWasBegunLastIsUndoneAlsoBeforeItHasEnded)
{
    const auto trip = drive.makeFolder("Trip");
    const auto a = drive.writeDocument("a.txt"), b = drive.writeDocument("b.txt"),
               c = drive.writeDocument("c.txt");
    for (const auto& item : {a, b, c})
        move({item}, trip);
    history->undoLatest();
    drive.settle();
    EXPECT_TRUE(isThere("c.txt"));
    EXPECT_EQ(history->count(), 2U);
    move({drive.url("gone.txt")}, trip);
    history->undoLatest();
    drive.settle();
    EXPECT_EQ(undone, 1U) << "what has failed is not undone, and nothing else in its place";
    EXPECT_THAT(undo(), IsEmpty());
    EXPECT_TRUE(isThere("b.txt") && !isThere("a.txt"));
}

TEST_F(UndoHistoryTest, OldEntriesAreForgottenAndAllWhenTheHistoryEnds)
{
    for (std::size_t i = 0; i < UndoHistory::depth + 1; ++i)
        UndoHistory::expect(history, asked)->add({});
    EXPECT_EQ(history->count(), UndoHistory::depth);
    history->undo(1);
    EXPECT_EQ(history->count(), UndoHistory::depth) << "the first one is not there any more";
    const auto running = UndoHistory::expect(history, asked);
    history->forget();
    running->add({});
    EXPECT_EQ(history->count(), 0U);
}

} // namespace
} // namespace tarrow
