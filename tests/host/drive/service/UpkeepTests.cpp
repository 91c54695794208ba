// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/LocalCloudStore.h"
#include "host/drive/changes/WorkRecord.h"
#include "host/drive/service/DriveUpkeep.h"
#include "tests/support/DriveFixture.h"

#include <gmock/gmock.h>

namespace {

using namespace host::drive;

/// A store that takes its time to release a content.
class SlowStore : public LocalCloudStore {
public:
    using LocalCloudStore::LocalCloudStore;
    std::function<void()> meanwhile;

    host::system::SystemError release(const std::string& content) override
    {
        meanwhile();
        return LocalCloudStore::release(content);
    }
};

class UpkeepTest : public testing::Test, public testing_support::DriveFixture {
protected:
    /// Leaves the removal of a folder as a killed program does.
    void interruptARemoval() const
    {
        PromiseRecord promise;
        promise.content = "content";
        promise.modified = platform::Date{1};
        writePromise("folder/a.txt", promise);
        auto record = WorkRecord::write(layout(), {url("folder").path(), url(".trwheld-1").path()});
        record->keep();
        std::filesystem::rename(url("folder").path(), url(".trwgone-1").path());
    }

    /// Answers what was told, when the store takes so many seconds.
    std::vector<bool> toldDuring(double seconds) const
    {
        interruptARemoval();
        const auto store = std::make_shared<SlowStore>(layout());
        const auto upkeep = std::make_shared<DriveUpkeep>(layout(), store, dispatch);
        std::vector<bool> told;
        store->meanwhile = [&] { dispatch->advance(seconds); };
        upkeep->onPuttingRight([&] { told.push_back(upkeep->isPuttingRight()); });
        upkeep->putRightBeside();
        settle();
        EXPECT_FALSE(std::filesystem::exists(url(".trwgone-1").path()));
        return told;
    }
};

TEST_F(UpkeepTest, LongWorkIsToldWhileItGoesOn)
{
    EXPECT_THAT(toldDuring(0.4), testing::IsEmpty());
    EXPECT_THAT(toldDuring(0.6), testing::ElementsAre(true, false));
}

} // namespace
