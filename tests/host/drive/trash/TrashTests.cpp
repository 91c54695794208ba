// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/LocalCloudStore.h"
#include "host/drive/changes/Recovery.h"
#include "host/drive/records/ItemFacts.h"
#include "platform/FileChanges.h"
#include "tests/support/DriveFixture.h"

#include <sys/file.h>
#include <sys/xattr.h>

#include <chrono>

namespace {

namespace fs = std::filesystem;

using namespace host::drive;
using namespace platform;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;
using testing_support::contentOf;
using Reason = TrashedItem::Reason;

PromiseRecord promiseOf(const std::string& content)
{
    PromiseRecord record;
    record.content = content;
    record.size = 4;
    record.modified = Date{1'600'000'000'000'000'000};
    return record;
}

class TrashTest : public testing::Test, public testing_support::DriveFixture {
protected:
    Trash& trash() const { return services().trash(); }
    std::vector<TrashedItem> items() const
    {
        return trash().items().value.value_or(std::vector<TrashedItem>());
    }
    TrashedItem moved(const Url& item) const
    {
        const auto result = trash().moveToTrash(item.path(), std::nullopt);
        EXPECT_FALSE(result.error);
        return result.value.value_or(TrashedItem());
    }
    std::optional<Error> restored(const TrashedItem& item) const
    {
        return trash().restore(item.identifier, std::nullopt).error;
    }
    void writeContent(const std::string& name) const
    {
        testing_support::writeFile(layout().cloud() + '/' + name, "data");
    }
    bool isCloudEmpty() const { return !fs::exists(layout().cloud()) || fs::is_empty(layout().cloud()); }
    bool isTrashClean() const { return fs::is_empty(layout().trash()); }
    /// The paths of everything below the drive's top level.
    std::vector<std::string> seen() const
    {
        std::vector<std::string> paths;
        for (const auto& entry : fs::recursive_directory_iterator(layout().defaultContainer()))
            paths.push_back(entry.path().string().substr(layout().defaultContainer().size() + 1));
        std::ranges::sort(paths);
        return paths;
    }
};

TEST_F(TrashTest, KeepsEveryKindOfItemAndGivesItBackAsItWas)
{
    writeContent("one");
    writeContent("two");
    const std::string longName(251, 'n');
    writeDocument("folder/sub/a.txt", "a");
    writePromise("folder/p.pdf", promiseOf("one"));
    const struct {
        Url url;
        FileType type;
        bool isPromise;
        std::optional<std::uint64_t> size;
    } rows[] = {
        {writeDocument("Documents/a.txt", "12345"), FileType::Regular, false, 5},
        {writeDocument("Documents/" + longName + ".txt", ""), FileType::Regular, false, 0},
        {writeDocument("Documents/\xff\xfe.txt", "x"), FileType::Regular, false, 1},
        {writePromise("Documents/p.pdf", promiseOf("two")), FileType::Regular, true, 4},
        {writeLink("Documents/link", "../folder"), FileType::SymbolicLink, false, std::nullopt},
        {url("folder"), FileType::Directory, false, std::nullopt},
    };
    const auto before = seen();
    for (const auto& row : rows) {
        const auto item = moved(row.url);
        EXPECT_EQ(item.name, row.url.lastPathComponent());
        EXPECT_EQ(item.origin, row.url.path());
        EXPECT_EQ(item.type, row.type) << item.name;
        EXPECT_EQ(item.isPromise, row.isPromise) << item.name;
        EXPECT_EQ(item.size, row.size) << item.name;
        EXPECT_EQ(item.reason, Reason::Trashed);
        EXPECT_FALSE(services().fileChanges().versionOfItem(row.url.path()));
        EXPECT_THAT(items(), testing::Contains(item));
    }
    const auto all = items();
    EXPECT_THAT(all, SizeIs(6));
    EXPECT_TRUE(std::ranges::is_sorted(all, std::greater(), &TrashedItem::trashed)) << "the newest is first";
    EXPECT_THAT(seen(), ElementsAre("Desktop", "Documents"));
    for (const auto& item : all)
        EXPECT_FALSE(restored(item)) << item.name;
    EXPECT_EQ(seen(), before);
    EXPECT_EQ(contentOf(rows[0].url), "12345");
    EXPECT_TRUE(isTrashClean());
    EXPECT_FALSE(isCloudEmpty());
}

TEST_F(TrashTest, RemovesForGoodWithTheContentsBehindPromises)
{
    writeContent("one");
    writeContent("two");
    writePromise("folder/p.pdf", promiseOf("one"));
    const auto folder = moved(url("folder")), promise = moved(writePromise("q.pdf", promiseOf("two")));
    EXPECT_FALSE(trash().remove(promise.identifier));
    EXPECT_FALSE(fs::exists(layout().cloud() + "/two"));
    EXPECT_TRUE(fs::exists(layout().cloud() + "/one"));
    EXPECT_FALSE(trash().remove(folder.identifier));
    EXPECT_TRUE(isCloudEmpty() && isTrashClean());
    EXPECT_THAT(items(), IsEmpty());
    for (const auto& gone :
        {folder.identifier, std::string(), std::string("../documents"), std::string("..")}) {
        const auto error = trash().remove(gone);
        EXPECT_TRUE(error && error->is(FileErrorCode::NoSuchItem)) << gone;
        EXPECT_TRUE(trash().restore(gone, std::nullopt).error->is(FileErrorCode::NoSuchItem)) << gone;
    }
}

TEST_F(TrashTest, RefusesWhatIsNoItemOfAFolderAndWhatHasChanged)
{
    const auto library = makeContainer("org.example.draw");
    const auto outside = testing_support::writeFile(folder().at("outside.txt"), "x");
    const struct {
        std::string path;
        std::string_view domain;
        int code;
    } rows[] = {
        {layout().defaultContainer(), errorDomain::file, static_cast<int>(FileErrorCode::Unsupported)},
        {library.path(), errorDomain::file, static_cast<int>(FileErrorCode::Unsupported)},
        {layout().container("org.example.draw"), errorDomain::file,
            static_cast<int>(FileErrorCode::Unsupported)},
        {writeDocument(".trwplace").path(), errorDomain::file, static_cast<int>(FileErrorCode::Unsupported)},
        {url("nothing").path(), errorDomain::file, static_cast<int>(FileErrorCode::NoSuchItem)},
        {outside.path(), errorDomain::system, EXDEV},
        {layout().trash(), errorDomain::system, EXDEV},
    };
    for (const auto& row : rows) {
        const auto error = trash().moveToTrash(row.path, std::nullopt).error;
        ASSERT_TRUE(error) << row.path;
        EXPECT_EQ(error->domain(), row.domain) << row.path;
        EXPECT_EQ(error->code(), row.code) << row.path;
    }
    const auto item = writeDocument("a.txt", "old");
    const auto version = services().fileChanges().versionOfItem(item.path());
    writeDocument("a.txt", "newer");
    EXPECT_TRUE(trash().moveToTrash(item.path(), version).error->is(FileErrorCode::Cancelled));
    EXPECT_EQ(contentOf(item), "newer");
    EXPECT_TRUE(isTrashClean());
}

TEST_F(TrashTest, NothingIsReplacedByWhatComesBack)
{
    const auto place = writeDocument("inner/a.txt", "old");
    const auto item = moved(place);
    writeDocument("inner/a.txt", "new");
    EXPECT_TRUE(restored(item)->is(FileErrorCode::ItemExists));
    fs::remove(place.path());
    writePromise("inner/a.txt", promiseOf("none"));
    EXPECT_TRUE(restored(item)->is(FileErrorCode::ItemExists)) << "a promise has the name";
    EXPECT_TRUE(trash().restore(item.identifier, url("inner/a 2.txt").path()));
    EXPECT_EQ(contentOf(url("inner/a 2.txt")), "old");
    // The folders on the way are made again, but not through a document or a link.
    const auto again = moved(writeDocument("one/two/b.txt", "b"));
    fs::remove_all(url("one").path());
    writeLink("one", "Documents");
    EXPECT_TRUE(restored(again));
    EXPECT_FALSE(fs::exists(url("Documents/two").path()));
    fs::remove(url("one").path());
    EXPECT_FALSE(restored(again));
    EXPECT_EQ(contentOf(url("one/two/b.txt")), "b");
    EXPECT_TRUE(isTrashClean());
}

TEST_F(TrashTest, OfADocumentAndItsPromiseTheDocumentGoes)
{
    writeContent("other");
    testing_support::writeFile(layout().cloud() + "/same", "same");
    writePromise("twin.txt", promiseOf("other"));
    writePromise("same.txt", promiseOf("same"));
    const auto twin = moved(writeDocument("twin.txt", "seen")),
               same = moved(writeDocument("same.txt", "same"));
    EXPECT_FALSE(twin.isPromise);
    EXPECT_TRUE(services().fileChanges().versionOfItem(url("twin.txt").path()))
        << "nobody has seen the other";
    EXPECT_FALSE(services().fileChanges().versionOfItem(url("same.txt").path()));
    EXPECT_FALSE(restored(same));
    EXPECT_EQ(contentOf(url("same.txt")), "same");
}

/// Is asked between the look at a document with a promise and its move, and lets another program work then.
class WindowStore : public LocalCloudStore {
public:
    using LocalCloudStore::LocalCloudStore;
    bool holdsOtherThan(const std::string&, const host::system::FileDescriptor&) override
    {
        inTheWindow();
        return true;
    }
    std::function<void()> inTheWindow;
};

TEST_F(TrashTest, AVersionThatNobodyHadSeenKeepsItsName)
{
    const auto store = std::make_shared<WindowStore>(layout());
    LocalTrash own(layout(), std::make_shared<LocalItemChanges>(layout(), store), store);
    const auto item = writeDocument("a.txt", "seen");
    writePromise("a.txt", promiseOf("one"));
    const std::function<void()> rows[] = {
        [&] { writeDocument("a.txt", "saved"); },
        [&] { fs::rename(writeDocument("b.txt", "saved").path(), item.path()); },
    };
    for (const auto& save : rows) {
        store->inTheWindow = save;
        writeDocument("a.txt", "seen");
        EXPECT_TRUE(own.moveToTrash(item.path(), std::nullopt).error->is(FileErrorCode::Cancelled));
        EXPECT_EQ(contentOf(item), "saved");
        EXPECT_TRUE(isTrashClean());
    }
}

TEST_F(TrashTest, AnItemOutlivesAKillBetweenAnyTwoSteps)
{
    // A record without an item, and a copy that is not whole.
    const auto item = moved(writeDocument("a.txt", "a"));
    const auto place = layout().trash() + '/' + item.identifier;
    fs::rename(place + "/a.txt", url("a.txt").path());
    testing_support::writeFile(place + "/.trwtmp-1", "half");
    {
        // Another process may be about to bring the item.
        const host::system::FileDescriptor busy(::open(layout().trash().c_str(), O_RDONLY | O_CLOEXEC));
        ASSERT_EQ(::flock(busy.get(), LOCK_SH), 0);
        EXPECT_THAT(items(), IsEmpty());
        EXPECT_TRUE(fs::exists(place));
    }
    EXPECT_THAT(items(), IsEmpty());
    EXPECT_TRUE(isTrashClean());
    // An item whose record is missing or damaged is listed and comes back to the top level.
    for (const auto* record : {"", "documents", "../../outside\0001\0trashed\0"}) {
        const auto lost = moved(writeDocument("inner/b.txt", "b"));
        testing_support::writeFile(layout().trash() + '/' + lost.identifier + "/.trwplace", record);
        ASSERT_THAT(items(), SizeIs(1));
        EXPECT_EQ(items()[0].reason, Reason::NotPutBack);
        EXPECT_EQ(items()[0].origin, "");
        EXPECT_FALSE(trash().removeOlderThan(Date{items()[0].trashed->nanoseconds + 1}));
        EXPECT_FALSE(restored(items()[0]));
        EXPECT_EQ(contentOf(url("b.txt")), "b");
        fs::remove(url("b.txt").path());
    }
    EXPECT_TRUE(isTrashClean());
}

TEST_F(TrashTest, WhatAStartCouldNotPutBackIsListedAndComesBack)
{
    // Their names were taken when these came out of a process that had been killed.
    const auto hold = [&](const std::string& name, const std::string& origin) {
        const auto held = layout().held() + '/' + name;
        testing_support::writeFile(held + ".place", "");
        std::ofstream(held + ".place") << origin << '\0' << held << '\0' << '\0';
        return held;
    };
    writeDocument("a.txt", "new");
    const auto document = hold(".trwheld-fffffff-1", url("a.txt").path());
    testing_support::writeFile(document, "old");
    ::setxattr(document.c_str(), "user.note", "kept", 4, 0);
    writePromise("p.pdf", promiseOf("one"));
    const auto promise = hold(".trwheld-fffffff-2.trwpromise", PromiseRecord::pathFor(url("p.pdf").path()));
    testing_support::writeFile(promise, promiseOf("two").toJson());
    LocalCloudStore store(layout());
    Recovery(layout(), store).run();

    auto all = items();
    std::ranges::sort(all, {}, &TrashedItem::name);
    ASSERT_THAT(all, SizeIs(2));
    for (const auto& item : all) {
        EXPECT_EQ(item.reason, Reason::NotPutBack);
        EXPECT_EQ(item.origin, url(item.name).path());
        EXPECT_TRUE(restored(item)->is(FileErrorCode::ItemExists));
    }
    EXPECT_TRUE(all[1].isPromise);
    EXPECT_FALSE(trash().removeOlderThan(Date{all[0].trashed->nanoseconds + 1}));
    ASSERT_TRUE(trash().restore(all[0].identifier, url("a 2.txt").path()));
    EXPECT_EQ(contentOf(url("a 2.txt")), "old");
    EXPECT_EQ(::getxattr(url("a 2.txt").path().c_str(), itemMark::origin, nullptr, 0), -1);
    EXPECT_FALSE(trash().remove(all[1].identifier));
    EXPECT_TRUE(isTrashClean());
}

TEST_F(TrashTest, RemovesWhatIsOldByItsRecordAlone)
{
    const auto write = [&](const TrashedItem& item, std::int64_t nanoseconds, const std::string& reason) {
        const auto record =
            "BrindleDefault/" + item.name + '\0' + std::to_string(nanoseconds) + '\0' + reason + '\0';
        testing_support::writeFile(layout().trash() + '/' + item.identifier + "/.trwplace", record);
    };
    constexpr std::int64_t day = std::int64_t{24} * 3600 * 1'000'000'000;
    const auto now = Date::fromTimePoint(std::chrono::system_clock::now()).nanoseconds;
    write(moved(writeDocument("old")), now - 31 * day, "trashed");
    write(moved(writeDocument("young")), now - 29 * day, "trashed");
    write(moved(writeDocument("kept copy")), now - 31 * day, "kept-copy");
    write(moved(writeDocument("wrong clock")), now - 20 * 365 * day, "trashed");
    write(moved(writeDocument("no date")), 0, "trashed");
    write(moved(writeDocument("future")), now + 400 * day, "trashed");
    EXPECT_FALSE(trash().removeOlderThan(Date{now - 30 * day}));
    std::vector<std::string> names;
    for (const auto& item : items())
        names.push_back(item.name);
    EXPECT_THAT(
        names, testing::UnorderedElementsAre("young", "kept copy", "wrong clock", "no date", "future"));
}

TEST_F(TrashTest, AThousandItemsOfOneNameAreToldOfTogether)
{
    int notices = 0;
    const auto observation =
        notifications->observe(Notification::TrashDidChange, [&](const auto&) { ++notices; });
    constexpr int many = 1000;
    for (int i = 0; i < many; ++i)
        moved(writeDocument("same.txt", std::to_string(i)));
    EXPECT_THAT(items(), SizeIs(many));
    settle();
    dispatch->advance(1);
    EXPECT_GE(notices, 1);
    EXPECT_LE(notices, 3);
    notices = 0;
    fs::remove_all(layout().trash() + '/' + items()[0].identifier); // by another program
    settle();
    dispatch->advance(1);
    EXPECT_EQ(notices, 1);
}

TEST_F(TrashTest, ADocumentIsFoundByItsIdentifierAgain)
{
    const auto item = writeDocument("inner/a.txt");
    auto& identifiers = cloud->documentIdentifiers();
    const auto identifier = identifiers.identify(item);
    ASSERT_TRUE(identifier);
    const auto away = moved(item);
    EXPECT_FALSE(identifiers.resolve(*identifier));
    settle();
    ASSERT_TRUE(trash().restore(away.identifier, url("elsewhere/b.txt").path()));
    const auto file = identifiers.resolve(*identifier);
    ASSERT_TRUE(file);
    EXPECT_EQ(file->place, "documents/BrindleDefault/elsewhere/b.txt");
}

TEST_F(TrashTest, AContentThatNothingStandsForIsListedAndComesBack)
{
    const auto document = writeDocument("a.txt", "text");
    mark(document, "user.note", "kept");
    writePromise("named.txt", promiseOf("of a promise"));
    for (const auto* content : {"of a promise", "second"})
        writeContent(content);
    ASSERT_FALSE(services().fileChanges().evictItem(document.path()));
    fs::remove(PromiseRecord::pathFor(document.path()));
    const auto all = items();
    ASSERT_THAT(all, SizeIs(2));
    for (const auto& item : all) {
        EXPECT_EQ(item.reason, Reason::ContentWithoutPromise);
        EXPECT_EQ(item.size, 4U);
        EXPECT_TRUE(item.isPromise && item.origin.empty());
    }
    const auto& dropped = all[0].identifier.ends_with("second") ? all[0] : all[1];
    const auto& kept = all[0].identifier.ends_with("second") ? all[1] : all[0];
    writeDocument("taken.txt", "other");
    EXPECT_TRUE(
        trash().restore(kept.identifier, url("taken.txt").path()).error->is(FileErrorCode::ItemExists));
    const auto place = trash().restore(kept.identifier, std::nullopt);
    EXPECT_EQ(place.value, url("Documents/Recovered document").path());
    EXPECT_FALSE(trash().remove(dropped.identifier));
    EXPECT_THAT(items(), IsEmpty());
    EXPECT_TRUE(trash().remove(dropped.identifier)->is(FileErrorCode::NoSuchItem));
    EXPECT_TRUE(
        trash().restore(dropped.identifier, url("gone.txt").path()).error->is(FileErrorCode::NoSuchItem));

    cloud->items().download(Url::fileURL(*place), nullptr);
    settle();
    EXPECT_EQ(contentOf(*place), "text");
    EXPECT_EQ(*AttributeReader(*place).value("user.note"), "kept");
    EXPECT_TRUE(fs::exists(layout().cloud() + "/of a promise"));
    EXPECT_FALSE(hasTraces());
}

TEST_F(TrashTest, APackageThatNothingStandsForComesBackOrGoes)
{
    for (const char* name : {"a.textbundle", "b.textbundle"}) {
        const auto package = url(name);
        writeDocument(std::string(name) + "/assets/picture", "12345");
        ASSERT_FALSE(services().fileChanges().evictItem(package.path()));
        fs::remove(PromiseRecord::pathFor(package.path()));
    }
    const auto all = items();
    ASSERT_THAT(all, SizeIs(2));
    EXPECT_EQ(all[0].type, platform::FileType::Directory);
    EXPECT_EQ(all[0].size, 5U);
    const auto place = trash().restore(all[0].identifier, std::nullopt);
    ASSERT_TRUE(place);
    EXPECT_FALSE(trash().remove(all[1].identifier));
    EXPECT_THAT(items(), IsEmpty());
    cloud->items().download(Url::fileURL(*place), nullptr);
    settle();
    EXPECT_EQ(contentOf(*place.value + "/assets/picture"), "12345");
    EXPECT_FALSE(hasTraces());
}

TEST_F(TrashTest, ARemovedContentStaysWhenAPromiseNamesItAfterAll)
{
    writeContent("one");
    const auto all = items();
    ASSERT_THAT(all, SizeIs(1));
    writePromise("back.txt", promiseOf("one"));
    EXPECT_FALSE(trash().remove(all[0].identifier));
    cloud->items().download(url("back.txt"), nullptr);
    settle();
    EXPECT_EQ(contentOf(url("back.txt")), "data");
}

} // namespace
