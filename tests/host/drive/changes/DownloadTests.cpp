// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/DownloadWork.h"
#include "host/drive/changes/LocalCloudStore.h"
#include "host/drive/records/ItemFacts.h"
#include "host/drive/records/SmallFile.h"
#include "tests/support/DriveFixture.h"

#include <cerrno>

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
    std::vector<DownloadProgress> heard;
    std::vector<std::optional<Error>> ended;
    std::function<void()> onProgress = [] {};
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
        layout(), store, item.path(), [&](std::uint64_t done, std::optional<std::uint64_t>) {
            last = done;
            return done > 1'000'000 ? CloudStore::Continue::No : CloudStore::Continue::Yes;
        });
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
    auto error = host::drive::bringHere(layout(), store, item.path(), goOn);
    ASSERT_TRUE(error);
    EXPECT_TRUE(error->is(FileErrorCode::ItemExists));
    EXPECT_EQ(contentOf(item.path()), "saved meanwhile");
    EXPECT_EQ(contentOf(content("content-a.txt")), "cloud");

    const auto deleted = promise("deleted", "cloud"), moved = promise("moved", "cloud");
    store.beforeFetch = [&] { fs::remove(PromiseRecord::pathFor(deleted.path())); };
    error = host::drive::bringHere(layout(), store, deleted.path(), goOn);
    ASSERT_TRUE(error);
    EXPECT_TRUE(error->is(FileErrorCode::NoSuchItem));
    EXPECT_FALSE(fs::exists(deleted.path()));
    store.beforeFetch = [&] {
        EXPECT_FALSE(cloud->fileChanges()->moveItem(moved.path(), url("there").path()));
    };
    EXPECT_TRUE(host::drive::bringHere(layout(), store, moved.path(), goOn));
    EXPECT_FALSE(fs::exists(moved.path()));
    store.beforeFetch = [] {};
    EXPECT_FALSE(host::drive::bringHere(layout(), store, url("there").path(), goOn));
    EXPECT_EQ(contentOf(url("there").path()), "cloud");
    EXPECT_FALSE(hasTraces());
}

TEST_F(DownloadTest, FailuresToFetchAreReported)
{
    PromiseRecord folder, elsewhere;
    folder.kind = PromiseRecord::Kind::Directory;
    elsewhere.content = "../account.json";
    writeDocument(".damaged.trwpromise", "{");
    const auto emptied = promise("emptied", "a whole text");
    std::ofstream(content("content-emptied"), std::ios::trunc).flush();
    const auto cloudError = [](CloudErrorCode code) {
        return Error(platform::errorDomain::cloud, static_cast<int>(code));
    };
    const std::pair<Url, Error> rows[] = {
        {writePromise("nowhere", {}), cloudError(CloudErrorCode::MissingContent)},
        {writePromise("elsewhere", elsewhere), cloudError(CloudErrorCode::MissingContent)},
        {writePromise("folder", folder), Error(FileErrorCode::Unsupported)},
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

TEST_F(DownloadTest, TheStoreKeepsItsContentsApart)
{
    LocalCloudStore store(layout());
    const auto list = [&](std::int64_t since) {
        return store.listChanges(platform::Date{since}).value.value_or(std::vector<std::string>{"failed"});
    };
    std::ofstream(content("a")) << "a";
    std::ofstream(content("b")) << "b";
    EXPECT_THAT(list(0), testing::UnorderedElementsAre("a", "b"));
    EXPECT_THAT(list(INT64_MAX), testing::IsEmpty());
    EXPECT_TRUE(store.move("a", "b").is(EEXIST));
    EXPECT_TRUE(store.move("a", "../a").is(ENOENT));
    EXPECT_FALSE(store.move("a", "c"));
    EXPECT_EQ(contentOf(content("c")), "a");
    EXPECT_FALSE(store.remove("../account.json"));
    EXPECT_FALSE(store.remove("b"));
    EXPECT_THAT(list(0), testing::ElementsAre("c"));
    EXPECT_TRUE(fs::exists(layout().account()));
}

} // namespace
