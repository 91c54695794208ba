// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/HeldItem.h"
#include "host/drive/changes/LocalCloudStore.h"
#include "host/drive/changes/LocalItemChanges.h"
#include "host/drive/changes/Recovery.h"
#include "host/drive/records/ItemFacts.h"
#include "tests/support/DriveFixture.h"

#include <fcntl.h>
#include <sched.h>
#include <sys/mount.h>
#include <sys/stat.h>
#include <sys/wait.h>

#include <cerrno>

namespace {

namespace fs = std::filesystem;

using namespace host::drive;
using namespace platform;
using testing_support::contentOf;

class ItemChangesTest : public testing::Test, public testing_support::DriveFixture {
protected:
    LocalItemChanges changes() const
    {
        return {layout(), std::make_shared<host::drive::LocalCloudStore>(layout())};
    }
    void recover() const
    {
        host::drive::LocalCloudStore store(layout());
        host::drive::Recovery(layout(), store).run();
    }
    std::optional<HeldItem> take(const Url& item) const
    {
        const auto entry = DriveEntry::open(layout(), item.path());
        auto held = HeldItem::take(layout(), *entry, entry->name);
        EXPECT_FALSE(held.error);
        return std::move(held.value);
    }
    /// Runs the body in a process of its own that may mount; the test is skipped where that is not allowed.
    /// The body answers the number of the check that failed, 0 for none.
    static void withMounts(const std::function<int()>& body)
    {
        constexpr int notAllowed = 99;
        const auto child = ::fork();
        if (child == 0) {
            const bool isAlone = ::unshare(::geteuid() == 0 ? CLONE_NEWNS : CLONE_NEWNS | CLONE_NEWUSER) == 0
                && ::mount("none", "/", nullptr, MS_REC | MS_PRIVATE, nullptr) == 0;
            ::_exit(isAlone ? body() : notAllowed);
        }
        int status = 0;
        ::waitpid(child, &status, 0);
        if (WIFEXITED(status) && WEXITSTATUS(status) == notAllowed)
            GTEST_SKIP() << "nothing can be mounted here";
        EXPECT_EQ(status, 0);
    }
};

TEST_F(ItemChangesTest, RemovesFoldersHoweverDeepTheyLie)
{
    const auto url = makeFolder("deep");
    int folder = ::open(url.path().c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    for (int level = 0; level < 3000; ++level) {
        ASSERT_EQ(::mkdirat(folder, "level", 0755), 0);
        ::close(::openat(folder, "file", O_CREAT | O_WRONLY | O_CLOEXEC, 0644));
        const int next = ::openat(folder, "level", O_RDONLY | O_DIRECTORY | O_CLOEXEC);
        ::close(folder);
        folder = next;
    }
    ::close(folder);
    EXPECT_FALSE(changes().removeItem(url.path(), std::nullopt));
    EXPECT_FALSE(fs::exists(url.path()));
    EXPECT_FALSE(hasTraces());
}

TEST_F(ItemChangesTest, AHeldItemComesBackUnlessANewerOneTookItsPlace)
{
    const auto url = writeDocument("a.txt", "old");
    {
        const auto held = take(url);
        EXPECT_FALSE(fs::exists(url.path()));
        recover();
        EXPECT_FALSE(fs::exists(url.path())) << "it is still being worked on";
    }
    EXPECT_EQ(contentOf(url.path()), "old");
    EXPECT_FALSE(hasTraces());
    {
        const auto held = take(url);
        writeDocument("a.txt", "new");
    }
    EXPECT_EQ(contentOf(url.path()), "new");
    fs::remove(url.path());
    recover();
    EXPECT_EQ(contentOf(url.path()), "old") << "both were kept";
}

TEST_F(ItemChangesTest, MovesToAnotherFileSystemAndBack)
{
    const auto small = makeFolder("small"), target = small.appendingPathComponent("tree");
    const auto file = writeDocument("tree/sub/a.txt", std::string(100'000, 'x'));
    writeLink("tree/link", "sub/a.txt");
    const auto tree = url("tree");
    withMounts([&] {
        if (::mount("tmpfs", small.path().c_str(), "tmpfs", 0, "") != 0)
            return 99;
        ::chmod(file.path().c_str(), 0640);
        const auto date = fs::last_write_time(file.path());
        if (changes().moveItem(tree.path(), target.path()) || fs::exists(tree.path()))
            return 1;
        const auto moved = target.path() + "/sub/a.txt";
        if (contentOf(moved).size() != 100'000 || fs::last_write_time(moved) != date
            || fs::status(moved).permissions() != fs::perms(0640)
            || fs::read_symlink(target.path() + "/link") != "sub/a.txt")
            return 2;
        ::mkfifo((target.path() + "/sub/pipe").c_str(), 0600);
        const auto refused = changes().moveItem(target.path(), tree.path());
        if (!refused || refused->code() != EOPNOTSUPP || !fs::exists(moved) || fs::exists(tree.path()))
            return 3;
        fs::remove(target.path() + "/sub/pipe");
        if (changes().moveItem(target.path(), tree.path()))
            return 4;
        return fs::is_empty(small.path()) && !hasTraces() ? 0 : 5;
    });
}

TEST_F(ItemChangesTest, ReplacesAContentAndKeepsWhatBelongsToTheDocument)
{
    const auto item = writeDocument("plan.pdf", "old");
    mark(item, host::drive::itemMark::tags, "Work,Urgent");
    mark(item, host::drive::itemMark::documentIdentifier, "77");
    ::chmod(item.path().c_str(), 0640);
    const auto before = changes().contentToReplace(item.path(), 100);
    ASSERT_TRUE(before);
    EXPECT_EQ(*before->bytes, "old");
    // Another tag and another copy of the same bytes do not change the content.
    mark(item, host::drive::itemMark::tags, "Work");
    const auto after = changes().replaceContent(item.path(), *before, "new and longer");
    ASSERT_TRUE(after);
    EXPECT_EQ(contentOf(item.path()), "new and longer");
    EXPECT_EQ(changes().versionOfItem(item.path()), *after.value);
    EXPECT_THAT(lookAtFile(item.path()).marks.tags, testing::ElementsAre("Work"));
    EXPECT_EQ(documentIdentifierAt(item.path()), 77U);
    EXPECT_EQ(fs::status(item.path()).permissions(), fs::perms(0640));

    const auto copy = url("plan 2.pdf");
    EXPECT_FALSE(changes().addDocument(copy.path(), item.path(), "copy"));
    EXPECT_EQ(contentOf(copy.path()), "copy");
    EXPECT_THAT(lookAtFile(copy.path()).marks.tags, testing::ElementsAre("Work"));
    EXPECT_EQ(documentIdentifierAt(copy.path()), 0U);
    const auto taken = changes().addDocument(copy.path(), item.path(), "other");
    EXPECT_TRUE(taken && taken->is(FileErrorCode::ItemExists));
    EXPECT_EQ(contentOf(copy.path()), "copy");
    EXPECT_FALSE(hasTraces());
}

TEST_F(ItemChangesTest, RefusesToReplaceWhatIsNotTheContentThatWasRead)
{
    const auto item = writeDocument("plan.pdf", "old");
    const auto before = changes().contentToReplace(item.path(), 100);
    ASSERT_TRUE(before);
    const auto refusal = [&] { return changes().replaceContent(item.path(), *before, "ours").error; };
    writeDocument("plan.pdf", "its");
    EXPECT_TRUE(refusal()->is(FileErrorCode::Cancelled)) << "of the same length";
    EXPECT_EQ(contentOf(item.path()), "its");
    fs::remove(item.path());
    EXPECT_TRUE(refusal()->is(FileErrorCode::NoSuchItem));
    EXPECT_FALSE(fs::exists(item.path()));
    writeLink("plan.pdf", folder().write("outside.pdf", "old"));
    EXPECT_TRUE(refusal());
    EXPECT_EQ(contentOf(folder().at("outside.pdf")), "old");
    fs::remove(item.path());
    writeDocument("plan.pdf", "old");
    EXPECT_FALSE(refusal()) << "the very same content came back";

    EXPECT_EQ(changes().contentToReplace(item.path(), 3).error->code(), EFBIG);
    ::chmod(item.path().c_str(), 0444);
    EXPECT_EQ(changes().contentToReplace(item.path(), 100).error->code(), EACCES);
    EXPECT_FALSE(hasTraces());
}

TEST_F(ItemChangesTest, APromiseBesideADocumentGoesOnlyWhenItAddsNothing)
{
    fs::create_directories(layout().cloud());
    const auto makeTwins = [&](const std::string& name, const char* behind) {
        host::drive::PromiseRecord promise;
        promise.content = behind ? std::string("content of ") + behind : "content";
        if (behind)
            std::ofstream(layout().cloud() + '/' + promise.content) << behind;
        writePromise(name, promise);
        return writeDocument(name, "document");
    };
    const auto hasPromise = [](const Url& item) {
        return fs::exists(host::drive::PromiseRecord::pathFor(item.path()));
    };
    for (const char* redundant : {static_cast<const char*>(nullptr), "document"}) {
        const auto item = makeTwins("a.txt", redundant);
        EXPECT_FALSE(changes().removeItem(item.path(), std::nullopt));
        EXPECT_FALSE(fs::exists(item.path()) || hasPromise(item));
        EXPECT_TRUE(fs::is_empty(layout().cloud()));
    }
    const auto item = makeTwins("a.txt", "unseen");
    const auto refused = changes().evictItem(item.path());
    ASSERT_TRUE(refused);
    EXPECT_TRUE(refused->is(FileErrorCode::ItemExists));
    EXPECT_EQ(contentOf(item.path()), "document");
    EXPECT_FALSE(changes().moveItem(item.path(), url("moved.txt").path()));
    EXPECT_TRUE(hasPromise(item) && !hasPromise(url("moved.txt")));
    writeDocument("a.txt", "document");
    EXPECT_FALSE(changes().removeItem(item.path(), std::nullopt));
    EXPECT_TRUE(hasPromise(item));
    EXPECT_EQ(contentOf(layout().cloud() + "/content of unseen"), "unseen");
    EXPECT_FALSE(changes().removeItem(item.path(), std::nullopt)) << "the promise shows, and can be removed";
    EXPECT_TRUE(fs::is_empty(layout().cloud()));
}

TEST_F(ItemChangesTest, WhatCannotBePutBackGoesToTheTrash)
{
    const auto folder = makeFolder("folder");
    for (const auto& name : {"folder/a.txt", "b.txt"}) {
        const auto item = writeDocument(name, "old");
        const auto child = ::fork();
        if (child == 0) {
            const auto held = take(item);
            ::kill(::getpid(), SIGKILL);
        }
        ::waitpid(child, nullptr, 0);
    }
    fs::remove_all(folder.path());
    writeDocument("b.txt", "new");
    std::ofstream(layout().trash() + "/b.txt") << "older";
    recover();
    EXPECT_FALSE(hasTraces());
    EXPECT_EQ(contentOf(url("b.txt").path()), "new");
    EXPECT_EQ(contentOf(layout().trash() + "/a.txt"), "old");
    EXPECT_EQ(contentOf(layout().trash() + "/b.txt"), "older");
    EXPECT_EQ(contentOf(layout().trash() + "/b.txt 2"), "old");
}

TEST_F(ItemChangesTest, NothingGetsANameThatTheDriveNeedsForItself)
{
    const auto item = writeDocument("a.txt");
    makeFolder("folder");
    for (const auto* name : {".b.txt.trwpromise", ".trwtmp-1", ".trwheld-1", "folder/.trwgone-1"}) {
        SCOPED_TRACE(name);
        const auto taken = url(name).path();
        const std::optional<Error> answers[] = {changes().createFolder(taken),
            changes().createFolder(taken + "/below"), changes().moveItem(item.path(), taken),
            changes().addDocument(taken, item.path(), "text")};
        for (const auto& answer : answers)
            EXPECT_TRUE(answer && answer->is(FileErrorCode::InvalidName));
        EXPECT_FALSE(fs::exists(taken));
    }
    EXPECT_FALSE(hasTraces());
}

/// The local store, in which something can happen just before a document is moved into it.
class EvictionStore : public LocalCloudStore {
public:
    using LocalCloudStore::LocalCloudStore;
    host::system::SystemError store(
        const DriveEntry& document, const TreeVersions& versions, const std::string& content) override
    {
        beforeStore();
        return LocalCloudStore::store(document, versions, content);
    }
    std::function<void()> beforeStore;
};

TEST_F(ItemChangesTest, AnEvictionThatFindsNoDocumentLeavesNoPromise)
{
    const auto store = std::make_shared<EvictionStore>(layout());
    LocalItemChanges evicting(layout(), store, [](const auto&) { return true; });
    auto item = writeDocument("a.txt", "text");
    const auto away = url("away.txt");
    const auto evict = [&](const std::function<void()>& meanwhile) {
        store->beforeStore = meanwhile;
        EXPECT_TRUE(evicting.evictItem(item.path()));
        EXPECT_FALSE(fs::exists(PromiseRecord::pathFor(item.path())));
        EXPECT_FALSE(hasTraces());
    };
    evict([&] { fs::rename(item.path(), away.path()); });
    EXPECT_EQ(contentOf(away.path()), "text");
    fs::rename(away.path(), item.path());
    evict([&] { writeDocument("a.txt", "saved meanwhile"); });
    EXPECT_EQ(contentOf(item.path()), "saved meanwhile");
    evict([&] { fs::remove(item.path()); });
    // A package whose size is another one by now.
    item =
        writeDocument("package/inner/a.txt", "text").deletingLastPathComponent().deletingLastPathComponent();
    evict([&] { writeDocument("package/inner/a.txt", "t"); });
    EXPECT_EQ(contentOf(url("package/inner/a.txt")), "t");
}

TEST_F(ItemChangesTest, WhatBelongsToAPlaceThatCannotBeOpenedWaitsForIt)
{
    const auto folder = makeFolder("folder");
    const auto item = writeDocument("folder/a.txt", "text");
    const auto child = ::fork();
    if (child == 0) {
        const auto held = take(item);
        ::_exit(0); // as when it is killed
    }
    ::waitpid(child, nullptr, 0);
    fs::rename(folder.path(), url("elsewhere").path());
    fs::create_directory_symlink("elsewhere", folder.path());
    recover();
    EXPECT_TRUE(fs::is_empty(layout().trash())) << "a link in its way does not mean that the folder is gone";
    fs::remove(folder.path());
    fs::rename(url("elsewhere").path(), folder.path());
    recover();
    EXPECT_EQ(contentOf(item.path()), "text");
}

TEST_F(ItemChangesTest, StraysWithoutARecordAreFoundAmongTheItems)
{
    const auto stray = [&](const std::string& name) { return writeDocument("folder/" + name, name).path(); };
    const auto copy = stray(".trwtmp-1"), held = stray(".trwheld-1"), gone = stray(".trwgone-1");
    LocalCloudStore store(layout());
    EXPECT_FALSE(Recovery(layout(), store).settleStraysAmongItems());
    EXPECT_TRUE(fs::exists(copy) && fs::exists(held) && fs::exists(gone))
        << "a program may still work on them";
    EXPECT_FALSE(Recovery(layout(), store, std::chrono::nanoseconds(0)).settleStraysAmongItems());
    EXPECT_FALSE(fs::exists(copy) || fs::exists(held) || fs::exists(gone));
    EXPECT_EQ(contentOf(layout().trash() + "/Recovered item"), ".trwheld-1");
}

TEST_F(ItemChangesTest, AMountIsNotEnteredAndDoesNotHideAMoveOfAFolderIntoItself)
{
    const auto outside = folder().write("outside/kept.txt", "precious");
    const auto tree = makeFolder("tree"), sub = makeFolder("tree/sub"), mounted = makeFolder("tree/mounted");
    const auto other = makeFolder("other"), file = writeDocument("tree/a.txt", "a");
    withMounts([&] {
        const auto bind = [](const std::string& from, const std::string& to) {
            return ::mount(from.c_str(), to.c_str(), nullptr, MS_BIND, nullptr) == 0;
        };
        if (!bind(sub.path(), other.path()))
            return 99;
        const auto intoItself = changes().moveItem(tree.path(), other.path() + "/tree");
        if (!intoItself || intoItself->code() != EINVAL || !fs::is_empty(sub.path()))
            return 1;
        if (!bind(folder().at("outside"), mounted.path()))
            return 99;
        const auto removed = changes().removeItem(tree.path(), std::nullopt);
        if (!removed || removed->code() != EBUSY || contentOf(outside) != "precious")
            return 2;
        return contentOf(file.path()) == "a" && !hasTraces() ? 0 : 3;
    });
}

TEST_F(ItemChangesTest, NothingChangesOnAReadOnlyDrive)
{
    const auto file = writeDocument("a.txt", "a");
    const auto home = layout().home();
    withMounts([&] {
        if (::mount(home.c_str(), home.c_str(), nullptr, MS_BIND, nullptr) != 0
            || ::mount(nullptr, home.c_str(), nullptr, MS_BIND | MS_REMOUNT | MS_RDONLY, nullptr) != 0)
            return 99;
        const auto removed = changes().removeItem(file.path(), std::nullopt);
        bool isWritten = false, isRead = false;
        const auto refused = fileCoordinator->coordinateWriting(
            file, platform::WritingOptions::None, [&](const Url&) { isWritten = true; });
        fileCoordinator->coordinateReading(
            file, platform::ReadingOptions::None, [&](const Url&) { isRead = true; });
        for (const auto& error : {removed, refused}) {
            if (!error || error->code() != EROFS)
                return 1;
        }
        return !isWritten && isRead && contentOf(file.path()) == "a" ? 0 : 2;
    });
}

} // namespace
