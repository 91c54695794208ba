// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/ContentCollection.h"
#include "host/drive/changes/DownloadWork.h"
#include "host/drive/changes/ItemTraits.h"
#include "host/drive/changes/LocalCloudStore.h"
#include "host/drive/records/ItemFacts.h"
#include "host/drive/records/SmallFile.h"
#include "tests/support/DriveFixture.h"

#include <fcntl.h>
#include <sys/xattr.h>

#include <cerrno>
#include <cstring>

namespace {

namespace fs = std::filesystem;

using namespace host::drive;
using host::system::FileDescriptor;
using host::system::SystemError;
using namespace platform;
using testing_support::contentOf;

/// The local store, before whose fetches something can happen.
class WindowStore : public LocalCloudStore {
public:
    using LocalCloudStore::LocalCloudStore;
    SystemError fetch(
        const std::string& content, const FileDescriptor& into, const Progress& progress) override
    {
        beforeFetch();
        return LocalCloudStore::fetch(content, into, progress);
    }
    std::function<void()> beforeFetch = [] {};
};

class DownloadTest : public testing::Test, public testing_support::DriveFixture {
protected:
    void SetUp() override { fs::create_directories(layout().cloud()); }
    std::string content(const std::string& name) const { return layout().cloud() + '/' + name; }
    Url promise(const std::string& name, const std::string& text)
    {
        std::ofstream(content("content-" + name)) << text;
        PromiseRecord record;
        record.size = text.size();
        record.modified = platform::Date{1'600'000'000'123'456'789};
        record.tags = {"Red", "Blue"};
        record.documentIdentifier = 42;
        record.role = platform::SharedItemRole::Participant;
        record.content = "content-" + name;
        return writePromise(name, record);
    }
    bool isIntact(const std::string& name, const std::string& text) const
    {
        return !fs::exists(url(name).path()) && fs::exists(PromiseRecord::pathFor(url(name).path()))
            && contentOf(content("content-" + name)) == text && !hasTraces();
    }
    std::unique_ptr<platform::ItemDownload> start(const Url& item)
    {
        return cloud->items().startDownload(item,
            {[this](const DownloadProgress& progress) {
                 heard.push_back(progress);
                 onProgress();
             },
                [this](const std::optional<Error>& error) { ended.push_back(error); }});
    }
    /// Looks through the released contents until that is certain.
    ContentCollection::Outcome collect()
    {
        constexpr int mostTries = 20;
        auto outcome = ContentCollection::Outcome::Later;
        for (int tries = 0; tries < mostTries && outcome == ContentCollection::Outcome::Later; ++tries) {
            fs::remove(layout().collection()); // else the next walk waits for as long as the last was slow
            outcome = ContentCollection(layout()).run().value.value_or(outcome);
        }
        return outcome;
    }
    std::vector<DownloadProgress> heard;
    std::vector<std::optional<Error>> ended;
    std::function<void()> onProgress = [] {};
};

const KeepingOthersOut alone = [](const std::function<void()>& steps) {
    steps();
    return std::optional<Error>();
};
constexpr auto goOn = [](std::uint64_t, std::optional<std::uint64_t>) { return CloudStore::Continue::Yes; };

TEST_F(DownloadTest, PutsTheDocumentWithAllThatIsKnownOfItInThePromisesPlace)
{
    const std::string text(2'500'000, 'x');
    const auto item = promise("a.txt", text);
    const auto download = start(item);
    dispatch->runUntilIdle();
    ASSERT_EQ(ended.size(), 1U);
    EXPECT_FALSE(ended[0]) << ended[0]->debugDescription();
    EXPECT_EQ(contentOf(item.path()), text);
    const auto facts = host::drive::lookAtFile(item.path());
    EXPECT_EQ(facts.modified(), platform::Date{1'600'000'000'123'456'789});
    EXPECT_THAT(facts.marks.tags, testing::ElementsAre("Red", "Blue"));
    EXPECT_EQ(facts.marks.documentIdentifier, 42U);
    EXPECT_EQ(facts.marks.role, platform::SharedItemRole::Participant);
    EXPECT_EQ(facts.marks.status, platform::DownloadingStatus::Current);
    EXPECT_FALSE(fs::exists(PromiseRecord::pathFor(item.path())));
    EXPECT_TRUE(fs::is_empty(layout().cloud()));
    EXPECT_FALSE(hasTraces());
    ASSERT_GE(heard.size(), 2U);
    EXPECT_TRUE(std::ranges::is_sorted(heard, {}, &DownloadProgress::done));
    EXPECT_EQ(heard.back(), (DownloadProgress{text.size(), text.size()}));
    // A document that is already downloaded is no error, and an evicted one can be downloaded again.
    const auto again = start(item);
    dispatch->runUntilIdle();
    EXPECT_FALSE(cloud->fileChanges()->evictItem(item.path()));
    const auto back = start(item);
    dispatch->runUntilIdle();
    EXPECT_EQ(ended, (std::vector<std::optional<Error>>(3)));
    EXPECT_EQ(contentOf(item.path()), text);
}

TEST_F(DownloadTest, IsOneForAllWhoAskForTheDocument)
{
    const std::string text(5'000'000, 'x');
    const auto item = promise("a.txt", text);
    auto& items = cloud->items();
    auto first = start(item);
    items.download(item, [this](const auto& error) { ended.push_back(error); });
    EXPECT_EQ(items.downloadProgress(item), DownloadProgress());
    std::vector<std::optional<DownloadProgress>> told;
    const auto observation =
        notifications->observe(platform::Notification::DownloadsDidChange, [&](const auto& userInfo) {
            EXPECT_EQ(*userInfo.at("url").template get<Url>(), item);
            told.push_back(items.downloadProgress(item));
        });
    onProgress = [&] { first.reset(); }; // the other listener still waits
    dispatch->runUntilIdle();
    EXPECT_EQ(heard.size(), 1U);
    EXPECT_EQ(ended, (std::vector<std::optional<Error>>(1)));
    EXPECT_EQ(contentOf(item.path()), text);
    ASSERT_GE(told.size(), 3U);
    EXPECT_EQ(told.back(), std::nullopt);
    EXPECT_EQ(told[told.size() - 2], (DownloadProgress{text.size(), text.size()}));
}

TEST_F(DownloadTest, EndsForAllWhenItIsCancelledForTheDocument)
{
    const std::string text(5'000'000, 'x');
    const auto item = promise("a.txt", text);
    const auto first = start(item);
    cloud->items().download(item, [this](const auto& error) { ended.push_back(error); });
    cloud->items().cancelDownload(item);
    dispatch->runUntilIdle();
    ASSERT_EQ(ended.size(), 2U);
    for (const auto& error : ended)
        EXPECT_TRUE(error && error->is(FileErrorCode::Cancelled));
    EXPECT_EQ(cloud->items().downloadProgress(item), std::nullopt);
    EXPECT_TRUE(isIntact("a.txt", text));
}

TEST_F(DownloadTest, ACancelledDownloadReportsNothingAndThePromiseStays)
{
    const std::string text(3'000'000, 'x');
    const auto item = promise("a.txt", text);
    start(item); // the handle is not kept
    dispatch->runUntilIdle();
    EXPECT_TRUE(heard.empty() && ended.empty());
    EXPECT_TRUE(isIntact("a.txt", text));

    LocalCloudStore store(layout());
    std::uint64_t last = 0;
    const auto error = host::drive::bringHere(
        layout(), store, item.path(),
        [&](std::uint64_t done, std::optional<std::uint64_t>) {
            last = done;
            return done > 1'000'000 ? CloudStore::Continue::No : CloudStore::Continue::Yes;
        },
        alone);
    ASSERT_TRUE(error);
    EXPECT_EQ(error->code(), ECANCELED);
    EXPECT_LT(last, 2'000'000U);
    EXPECT_TRUE(isIntact("a.txt", text));

    auto download = start(item);
    onProgress = [&] { download->cancel(); };
    dispatch->runUntilIdle();
    EXPECT_EQ(heard.size(), 1U);
    EXPECT_TRUE(ended.empty());
}

TEST_F(DownloadTest, WhatHappensMeanwhileCounts)
{
    WindowStore store(layout());
    const auto item = promise("a.txt", "cloud");
    store.beforeFetch = [&] { writeDocument("a.txt", "saved meanwhile"); };
    auto error = host::drive::bringHere(layout(), store, item.path(), goOn, alone);
    ASSERT_TRUE(error);
    EXPECT_TRUE(error->is(FileErrorCode::ItemExists));
    EXPECT_EQ(contentOf(item.path()), "saved meanwhile");
    EXPECT_EQ(contentOf(content("content-a.txt")), "cloud");

    const auto deleted = promise("deleted", "cloud"), moved = promise("moved", "cloud");
    store.beforeFetch = [&] { fs::remove(PromiseRecord::pathFor(deleted.path())); };
    error = host::drive::bringHere(layout(), store, deleted.path(), goOn, alone);
    ASSERT_TRUE(error);
    EXPECT_TRUE(error->is(FileErrorCode::NoSuchItem));
    EXPECT_FALSE(fs::exists(deleted.path()));
    store.beforeFetch = [&] {
        EXPECT_FALSE(cloud->fileChanges()->moveItem(moved.path(), url("there").path()));
    };
    EXPECT_TRUE(host::drive::bringHere(layout(), store, moved.path(), goOn, alone));
    EXPECT_FALSE(fs::exists(moved.path()));
    store.beforeFetch = [] {};
    EXPECT_FALSE(host::drive::bringHere(layout(), store, url("there").path(), goOn, alone));
    EXPECT_EQ(contentOf(url("there").path()), "cloud");
    EXPECT_FALSE(hasTraces());
}

/// What other processes do at the last moment, when the content has arrived.
TEST_F(DownloadTest, NothingIsInferredFromAPromiseThatIsNoLongerThere)
{
    LocalCloudStore store(layout());
    auto& changes = *cloud->fileChanges();
    const auto item = promise("a.txt", "cloud");
    const auto fetch = [&](const std::function<void()>& meanwhile) {
        return host::drive::bringHere(layout(), store, item.path(), goOn, [&](const auto& steps) {
            meanwhile();
            return alone(steps);
        });
    };
    // Another process fetches it as well, and then evicts it.
    EXPECT_FALSE(fetch([&] { EXPECT_FALSE(bringHere(layout(), store, item.path(), goOn, alone)); }));
    EXPECT_EQ(contentOf(item.path()), "cloud");
    ASSERT_FALSE(changes.evictItem(item.path()));
    int rounds = 0;
    EXPECT_FALSE(fetch([&] {
        if (++rounds > 1)
            return;
        EXPECT_FALSE(bringHere(layout(), store, item.path(), goOn, alone));
        EXPECT_FALSE(changes.evictItem(item.path()));
    }));
    EXPECT_EQ(rounds, 2) << "the promise of the later eviction is fetched";
    EXPECT_EQ(contentOf(item.path()), "cloud");
    // It gets an identifier and tags while it is downloaded.
    ASSERT_FALSE(changes.evictItem(item.path()));
    std::optional<std::uint32_t> given;
    EXPECT_FALSE(fetch([&] { given = cloud->documentIdentifiers().identify(item).value; }));
    EXPECT_EQ(host::drive::lookAtFile(item.path()).marks.documentIdentifier, given);
    // Its promise is moved away with its folder's name staying.
    ASSERT_FALSE(changes.evictItem(item.path()));
    EXPECT_TRUE(fetch([&] { EXPECT_FALSE(changes.moveItem(item.path(), url("moved").path())); }));
    EXPECT_FALSE(fs::exists(item.path()));
    EXPECT_FALSE(bringHere(layout(), store, url("moved").path(), goOn, alone));
    EXPECT_EQ(contentOf(url("moved").path()), "cloud");
    EXPECT_FALSE(hasTraces());
}

TEST_F(DownloadTest, FailuresToFetchAreReported)
{
    PromiseRecord folder, elsewhere;
    folder.kind = PromiseRecord::Kind::Directory;
    elsewhere.content = "../account.json";
    auto otherKind = folder;
    otherKind.content = "content-emptied";
    writeDocument(".damaged.trwpromise", "{");
    const auto emptied = promise("emptied", "a whole text");
    std::ofstream(content("content-emptied"), std::ios::trunc).flush();
    const auto cloudError = [](CloudErrorCode code) {
        return Error(platform::errorDomain::cloud, static_cast<int>(code));
    };
    const std::pair<Url, Error> rows[] = {
        {writePromise("nowhere", {}), cloudError(CloudErrorCode::MissingContent)},
        {writePromise("elsewhere", elsewhere), cloudError(CloudErrorCode::MissingContent)},
        {writePromise("folder", folder), cloudError(CloudErrorCode::MissingContent)},
        {writePromise("other kind", otherKind), Error(platform::errorDomain::system, EOPNOTSUPP)},
        {emptied, Error(platform::errorDomain::system, EIO)},
        {url("damaged"), cloudError(CloudErrorCode::DamagedRecord)},
        {url("gone"), Error(FileErrorCode::NoSuchItem)},
    };
    for (const auto& [item, expected] : rows) {
        ended.clear();
        const auto download = start(item);
        dispatch->runUntilIdle();
        ASSERT_EQ(ended.size(), 1U) << item.path();
        ASSERT_TRUE(ended[0]) << item.path();
        EXPECT_EQ(ended[0]->domain(), expected.domain()) << item.path();
        EXPECT_EQ(ended[0]->code(), expected.code()) << item.path();
        EXPECT_FALSE(fs::exists(item.path()));
    }
    EXPECT_FALSE(hasTraces());
}

TEST_F(DownloadTest, AReleasedContentStaysUntilNoPromiseNamesIt)
{
    LocalCloudStore store(layout());
    EXPECT_FALSE(store.release("../account.json"));
    EXPECT_FALSE(store.release("nothing"));
    EXPECT_TRUE(fs::exists(layout().account()));
    promise("a.txt", "a");
    promise("b.txt", "b");
    for (const auto* name : {"content-a.txt", "content-b.txt"})
        EXPECT_FALSE(store.release(name));
    EXPECT_EQ(store.has("content-a.txt"), true);
    EXPECT_FALSE(host::drive::bringHere(layout(), store, url("a.txt").path(), goOn, alone));
    ASSERT_EQ(collect(), ContentCollection::Outcome::Done);
    EXPECT_EQ(store.has("content-a.txt"), false);
    EXPECT_EQ(contentOf(content("content-b.txt")), "b");
    std::ofstream(content("orphan")) << "o";
    EXPECT_THAT(
        ContentCollection(layout()).orphans().value, testing::Optional(testing::ElementsAre("orphan")));
}

/// A promise that another program copied, put back from a backup or unpacked.
TEST_F(DownloadTest, ACopiedPromiseHasAFateOfItsOwn)
{
    const auto copy = [&](const std::string& name) {
        promise(name, "text of " + name);
        fs::create_directories(url("folder " + name).path());
        const auto other = "folder " + name + "/copy";
        fs::copy_file(PromiseRecord::pathFor(url(name).path()), PromiseRecord::pathFor(url(other).path()));
        return url(other);
    };
    auto& changes = *cloud->fileChanges();
    const std::pair<const char*, std::function<std::optional<Error>(const Url&)>> rows[] = {
        {"deleted", [&](const Url& item) { return changes.removeItem(item.path(), std::nullopt); }},
        {"deleted with its folder",
            [&](const Url& item) {
                return changes.removeItem(item.deletingLastPathComponent().path(), std::nullopt);
            }},
        {"fetched",
            [&](const Url& item) {
                LocalCloudStore store(layout());
                return host::drive::bringHere(layout(), store, item.path(), goOn, alone);
            }},
    };
    for (const auto& [name, deed] : rows) {
        SCOPED_TRACE(name);
        const auto copied = copy(name);
        EXPECT_FALSE(deed(copied));
        ASSERT_EQ(collect(), ContentCollection::Outcome::Done);
        EXPECT_EQ(contentOf(content(std::string("content-") + name)), std::string("text of ") + name);
        LocalCloudStore store(layout());
        EXPECT_FALSE(host::drive::bringHere(layout(), store, url(name).path(), goOn, alone));
        EXPECT_EQ(contentOf(url(name).path()), std::string("text of ") + name);
        ASSERT_EQ(collect(), ContentCollection::Outcome::Done);
        EXPECT_EQ(store.has(std::string("content-") + name), false);
    }
}

TEST_F(DownloadTest, EvictedAndFetchedIsTheSameDocument)
{
    const auto item = writeDocument("a.txt", "text");
    const auto& path = item.path();
    ASSERT_EQ(::chmod(path.c_str(), 0751), 0);
    for (const auto& [name, value] :
        {std::pair("user.foreign", "kept"), {itemMark::documentIdentifier, "77"}, {itemMark::tags, "Red"}})
        ASSERT_EQ(::setxattr(path.c_str(), name, value, std::strlen(value), 0), 0);
    const auto before = host::drive::lookAtFile(path);
    const auto traits = ItemTraits::read(FileDescriptor(::open(path.c_str(), O_RDONLY)));
    ASSERT_FALSE(cloud->fileChanges()->evictItem(path));
    struct stat promise;
    ASSERT_EQ(::stat(PromiseRecord::pathFor(path).c_str(), &promise), 0);
    EXPECT_EQ(promise.st_size, 0); // all of it is in the inode
    // What is set while it is in the cloud comes back with it.
    EXPECT_TRUE(
        cloud->fileChanges()->editTags(path, [](const auto&) { return std::vector<std::string>{"Blue"}; }));
    LocalCloudStore store(layout());
    ASSERT_FALSE(host::drive::bringHere(layout(), store, path, goOn, alone));
    const auto now = ItemTraits::read(FileDescriptor(::open(path.c_str(), O_RDONLY)));
    auto expected = traits->attributes;
    expected[itemMark::tags] = "Blue";
    expected[itemMark::status] = "current";
    expected[itemMark::created] = std::to_string(before.created()->nanoseconds);
    EXPECT_EQ(now->attributes, expected);
    EXPECT_EQ(now->mode, 0751U);
    const auto after = host::drive::lookAtFile(path);
    EXPECT_EQ(after.created(), before.created());
    EXPECT_EQ(after.modified(), before.modified());
}

/// A package of two levels with a link, a picture that may not be written, and a part that is in the cloud.
class PackageTest : public DownloadTest {
protected:
    Url writePackage(const std::string& name)
    {
        promise("part.txt", "a part");
        fs::create_directories(url(name + "/assets/empty").path());
        fs::rename(PromiseRecord::pathFor(url("part.txt").path()),
            PromiseRecord::pathFor(url(name + "/assets/part.txt").path()));
        writeDocument(name + "/text.md", "a text");
        writeDocument(name + "/assets/picture", std::string(3'000'000, 'x'));
        writeLink(name + "/assets/link", "../text.md");
        fs::permissions(url(name + "/assets/picture").path(), fs::perms::owner_read);
        return url(name);
    }
    std::optional<Error> evict(const Url& item) { return cloud->fileChanges()->evictItem(item.path()); }
    std::optional<Error> fetch(const Url& item, const KeepingOthersOut& keeping = alone)
    {
        LocalCloudStore store(layout());
        return host::drive::bringHere(layout(), store, item.path(), goOn, keeping);
    }
    static bool isPromise(const Url& item)
    {
        return !fs::exists(item.path()) && fs::exists(PromiseRecord::pathFor(item.path()));
    }
    std::size_t contents() const
    {
        return static_cast<std::size_t>(std::distance(fs::directory_iterator(layout().cloud()), {}));
    }
};

TEST_F(PackageTest, EvictedAndFetchedIsTheSame)
{
    const auto item = writePackage("a.textbundle");
    const auto copy = folder().at("copy");
    const auto size =
        3'000'006 + fs::file_size(PromiseRecord::pathFor(url("a.textbundle/assets/part.txt").path()));
    ASSERT_EQ(std::system(("cp -a '" + item.path() + "' '" + copy + "'").c_str()), 0);
    ASSERT_EQ(::chmod(item.path().c_str(), 0750), 0);
    mark(item, "user.foreign", "kept");
    mark(item, itemMark::tags, "Red");
    mark(item, itemMark::documentIdentifier, "77");
    const auto before = host::drive::lookAtFile(item.path());
    ASSERT_FALSE(evict(item));
    EXPECT_TRUE(isPromise(item));
    const auto promised = host::drive::lookAtItem(item.path()).promise;
    EXPECT_EQ(promised.kind, PromiseRecord::Kind::Package);
    EXPECT_EQ(promised.size, size);
    EXPECT_EQ(promised.documentIdentifier, 77U);
    // Its attributes are the promise's meanwhile, also those that go.
    EXPECT_TRUE(
        cloud->fileChanges()->editTags(item.path(), [](const auto&) { return std::vector<std::string>(); }));
    const auto download = start(item);
    dispatch->runUntilIdle();
    ASSERT_EQ(ended, std::vector<std::optional<Error>>(1));
    EXPECT_EQ(heard.back(), (DownloadProgress{size, size}));
    EXPECT_GE(heard.size(), 3U);
    EXPECT_EQ(std::system(("diff -r --no-dereference '" + item.path() + "' '" + copy + "'").c_str()), 0);
    struct stat picture;
    ASSERT_EQ(::stat(url("a.textbundle/assets/picture").path().c_str(), &picture), 0);
    EXPECT_EQ(picture.st_mode & 07777, 0400U);
    const auto after = host::drive::lookAtFile(item.path());
    EXPECT_EQ(after.status.stx_mode, before.status.stx_mode);
    EXPECT_EQ(after.modified(), before.modified());
    EXPECT_EQ(after.created(), before.created());
    EXPECT_EQ(after.marks.documentIdentifier, 77U);
    EXPECT_TRUE(after.marks.tags.empty());
    EXPECT_EQ(*AttributeReader(item.path()).value("user.foreign"), "kept");
    EXPECT_FALSE(hasTraces());
    // The part is still in the cloud, and everything else is not.
    ASSERT_EQ(collect(), ContentCollection::Outcome::Done);
    EXPECT_TRUE(fs::is_empty(layout().released()));
    EXPECT_EQ(contents(), 1U);
    EXPECT_FALSE(fetch(url("a.textbundle/assets/part.txt")));
    EXPECT_EQ(contentOf(url("a.textbundle/assets/part.txt")), "a part");
}

TEST_F(PackageTest, GoesWithItsPartsOnceNothingNamesIt)
{
    const auto item = writePackage("a.textbundle");
    writeDocument("outside/precious", "precious");
    fs::create_directory_symlink(url("outside").path(), url("a.textbundle/assets/outside").path());
    ASSERT_FALSE(evict(item));
    EXPECT_TRUE(ContentCollection(layout()).orphans().value->empty()) << "the package names its part";
    ASSERT_FALSE(cloud->fileChanges()->removeItem(item.path(), std::nullopt));
    ASSERT_EQ(collect(), ContentCollection::Outcome::Done);
    EXPECT_TRUE(fs::is_empty(layout().released()));
    EXPECT_EQ(contents(), 0U);
    EXPECT_EQ(contentOf(url("outside/precious")), "precious");
}

TEST_F(PackageTest, OnlyWhatCanComeBackIsEvicted)
{
    const auto item = writePackage("a.textbundle");
    const std::pair<int, std::function<std::string()>> rows[] = {
        {EOPNOTSUPP,
            [&] {
                ::mkfifo((item.path() + "/pipe").c_str(), 0600);
                return "pipe";
            }},
        {EBUSY,
            [&] {
                writeDocument("a.textbundle/assets/.trwtmp-1");
                return "assets/.trwtmp-1";
            }},
        {ELOOP,
            [&] {
                std::string path = item.path() + "/deep";
                for (int level = 0; level < 130; ++level)
                    path += "/d";
                fs::create_directories(path);
                return "deep";
            }},
    };
    for (const auto& [error, hinder] : rows) {
        const auto hindrance = hinder();
        const auto refused = evict(item);
        ASSERT_TRUE(refused) << hindrance;
        EXPECT_EQ(refused->code(), error);
        fs::remove_all(item.path() + '/' + hindrance);
        EXPECT_TRUE(fs::exists(item.path()) && !fs::exists(PromiseRecord::pathFor(item.path())));
        EXPECT_EQ(contents(), 1U);
    }
    EXPECT_TRUE(evict(makeFolder("folder"))->is(FileErrorCode::Unsupported));
    EXPECT_FALSE(evict(item));
}

TEST_F(PackageTest, WhatOthersDoMeanwhileCounts)
{
    const auto item = writePackage("a.textbundle");
    ASSERT_FALSE(evict(item));
    // Another process fetches it as well.
    EXPECT_FALSE(fetch(item, [&](const auto& steps) {
        EXPECT_FALSE(fetch(item));
        return alone(steps);
    }));
    EXPECT_EQ(contentOf(url("a.textbundle/text.md")), "a text");
    EXPECT_FALSE(hasTraces());
    // Another program puts a package, or a file, in its place.
    ASSERT_FALSE(evict(item));
    for (const auto& put : {std::function<void()>([&] { fs::create_directory(item.path()); }),
             std::function<void()>([&] { writeDocument("a.textbundle"); })}) {
        const auto error = fetch(item, [&](const auto& steps) {
            put();
            return alone(steps);
        });
        ASSERT_TRUE(error);
        EXPECT_TRUE(error->is(FileErrorCode::ItemExists));
        EXPECT_EQ(contents(), 2U);
        EXPECT_FALSE(hasTraces());
        fs::remove(item.path());
    }
    // It is cancelled, and its promise is moved away.
    LocalCloudStore store(layout());
    const auto error = host::drive::bringHere(
        layout(), store, item.path(),
        [](auto done, auto) {
            return done > 1'000'000 ? CloudStore::Continue::No : CloudStore::Continue::Yes;
        },
        alone);
    EXPECT_EQ(error->code(), ECANCELED);
    EXPECT_TRUE(isPromise(item));
    EXPECT_FALSE(hasTraces());
    EXPECT_TRUE(fetch(item, [&](const auto& steps) {
        EXPECT_FALSE(cloud->fileChanges()->moveItem(item.path(), url("moved").path()));
        return alone(steps);
    }));
    EXPECT_FALSE(fs::exists(item.path()));
    EXPECT_FALSE(fetch(url("moved")));
    EXPECT_EQ(contentOf(url("moved/text.md")), "a text");
    EXPECT_FALSE(hasTraces());
}

TEST_F(PackageTest, CanBeEnteredAlsoWhenItsPromiseIsOfAnotherProgram)
{
    fs::create_directories(content("far") + "/inner");
    std::ofstream(content("far") + "/inner/a.txt") << "a";
    fs::permissions(content("far") + "/inner", fs::perms::owner_read | fs::perms::owner_exec);
    std::ofstream(PromiseRecord::pathFor(url("far").path()))
        << R"({"version": 1, "kind": "directory", "content": "far"})";
    fs::permissions(PromiseRecord::pathFor(url("far").path()), fs::perms(0644));
    EXPECT_FALSE(fetch(url("far")));
    EXPECT_EQ(fs::status(url("far").path()).permissions(), fs::perms(0755));
    EXPECT_EQ(contentOf(url("far/inner/a.txt")), "a");
}

} // namespace
