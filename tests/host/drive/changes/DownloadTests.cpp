// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/ContentCollection.h"
#include "host/drive/changes/DownloadWork.h"
#include "host/drive/changes/ItemTraits.h"
#include "host/drive/changes/LocalCloudStore.h"
#include "host/drive/records/ItemFacts.h"
#include "host/drive/records/SmallFile.h"
#include "tests/support/DownloadFixture.h"

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
using testing_support::alone;
using testing_support::contentOf;
using testing_support::DownloadTest;
using testing_support::goOn;

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

} // namespace
