// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/Services.h"
#include "prompts/QuotaFetcher.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/SimulatedCloud.h"
#include "tests/support/VirtualDispatch.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace tarrow {
namespace {

using namespace testing_support;
using namespace platform;
using namespace testing;

struct RecordingDelegate : QuotaFetcherDelegate {
    std::vector<std::uint64_t> values;
    void quotaFetcherDidUpdateValue(QuotaFetcher&, std::uint64_t bytes) override { values.push_back(bytes); }
};

class QuotaFetcherTest : public testing::Test {
protected:
    QuotaFetcherTest()
    {
        platform::ServiceSet set;
        set.dispatch = dispatch;
        set.cloudDocumentService = cloud;
        set.notificationCenter = center;
        platform::installServices(std::move(set));
        fetcher = QuotaFetcher::init();
        fetcher->setDelegate(delegate);
    }
    ~QuotaFetcherTest() override
    {
        fetcher = nullptr;
        platform::installServices({});
        platform::installLogSink(nullptr);
    }

    void fetchNow() const
    {
        fetcher->fetchNow();
        dispatch->runUntilIdle();
    }

    std::shared_ptr<RecordingLog> log = RecordingLog::install();
    std::shared_ptr<VirtualDispatch> dispatch = VirtualDispatch::create();
    std::shared_ptr<SimulatedCloud> cloud = std::make_shared<SimulatedCloud>();
    std::shared_ptr<platform::NotificationCenter> center = std::make_shared<platform::NotificationCenter>();
    std::shared_ptr<RecordingDelegate> delegate = std::make_shared<RecordingDelegate>();
    std::shared_ptr<QuotaFetcher> fetcher;
};

TEST_F(QuotaFetcherTest, FetchesAtOnceAndThenOnSchedule)
{
    fetcher->runWithInterval(300.0);
    dispatch->runUntilIdle();
    EXPECT_THAT(delegate->values, ElementsAre(1000));
    cloud->quota = std::int64_t{2000};
    dispatch->advance(299);
    EXPECT_EQ(cloud->requests, 1);
    dispatch->advance(2);
    EXPECT_THAT(delegate->values, ElementsAre(1000, 2000));
    dispatch->advance(600);
    EXPECT_THAT(delegate->values, ElementsAre(1000, 2000, 2000, 2000)) << "an unchanged value counts too";

    const Error offline(platform::errorDomain::cloud, 7);
    cloud->quota = offline;
    fetchNow();
    EXPECT_EQ(delegate->values.size(), 4U);
    EXPECT_EQ(fetcher->freeBytes(), 2000) << "a failed fetch keeps the old value";
    EXPECT_EQ(log->count("WARNING can't update quota: " + offline.debugDescription()), 1);
    cloud->quota = std::int64_t{3000};
    delegate = nullptr;
    fetchNow();
    EXPECT_EQ(fetcher->freeBytes(), 3000);
}

TEST_F(QuotaFetcherTest, WaitsWhileTheApplicationIsInactive)
{
    center->post(Notification::ApplicationWillResignActive);
    fetcher->runWithInterval(300.0);
    dispatch->advance(301);
    EXPECT_EQ(cloud->requests, 0);
    EXPECT_EQ(log->count("DEBUG Not fetching quota: backgrounded."), 2);
    center->post(Notification::ApplicationDidBecomeActive);
    dispatch->runUntilIdle();
    EXPECT_EQ(cloud->requests, 0) << "becoming active does not itself fetch";
    dispatch->advance(300);
    EXPECT_EQ(cloud->requests, 1);
    EXPECT_EQ(log->count("INFO HostWillDeactivateEvent (quota)"), 1);
    EXPECT_EQ(log->count("INFO HostDidActivateEvent (quota)"), 1);
}

TEST_F(QuotaFetcherTest, WithoutAnAccountNobodyIsAsked)
{
    cloud->token = std::nullopt;
    fetchNow();
    EXPECT_EQ(cloud->requests, 0);
    EXPECT_THAT(delegate->values, IsEmpty());
    EXPECT_EQ(log->count("INFO Not fetching quota. Ubiquity is not enabled"), 1);
}

TEST_F(QuotaFetcherTest, AnAccountAboveItsLimitHasNothingFree)
{
    for (const auto& answer : {platform::Result<std::int64_t>(), {std::int64_t{-5}}}) {
        cloud->quota = answer;
        fetchNow();
    }
    EXPECT_THAT(delegate->values, ElementsAre(0, 0));
}

TEST_F(QuotaFetcherTest, AnAnswerMayComeAfterTheFetcherHasGone)
{
    cloud->beforeAnswer = [this] { fetcher = nullptr; };
    fetchNow();
    EXPECT_EQ(cloud->requests, 1);
    EXPECT_THAT(delegate->values, IsEmpty());
}

TEST_F(QuotaFetcherTest, WorkUnderWayDoesNotKeepAFetcherAlive)
{
    fetcher->runWithInterval(300.0);
    fetcher->fetchNow();
    const std::weak_ptr<QuotaFetcher> weak = fetcher;
    fetcher = nullptr;
    EXPECT_TRUE(weak.expired());
    dispatch->advance(1000);
    center->post(Notification::ApplicationDidBecomeActive);
    EXPECT_EQ(cloud->requests, 0);
    EXPECT_EQ(dispatch->pendingCount(), 0) << "the timer was cancelled";
    EXPECT_THAT(log->lines(), IsEmpty());
}

} // namespace
} // namespace tarrow
