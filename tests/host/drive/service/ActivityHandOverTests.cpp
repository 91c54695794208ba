// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/identity/Bookmark.h"
#include "host/drive/records/ActivityRecord.h"
#include "host/drive/records/DeviceIdentity.h"
#include "host/drive/service/LocalActivityHandOver.h"
#include "tests/support/DriveFixture.h"

namespace {

using namespace host::drive;
using platform::UserActivity;
using testing_support::DriveFixture;
using Activity = std::shared_ptr<const UserActivity>;

constexpr double longestSilence = std::chrono::duration<double>(ActivityPublication::longestSilence).count();

Activity viewing(const std::string& bookmark, bool isEligible = true)
{
    auto activity = std::make_shared<UserActivity>();
    activity->type = "BrindleDocsID.viewing";
    activity->isEligibleForHandOff = isEligible;
    activity->userInfo.emplace(platform::activityKey::documentURL, bookmark);
    return activity;
}

/// This device, and another device of the account with a state folder of its own.
class HandOver : public testing::Test {
protected:
    HandOver()
    {
        for (const auto* name : {"Documents/a.txt", "Documents/b.txt"})
            drive.writeDocument(name);
        drive.settle();
        changes = drive.notifications->observe(
            platform::Notification::ActivityOffersDidChange, [this](const auto&) { ++changeCount; });
    }
    /// Lets one device write its file, and then the other devices read it.
    void settle() const
    {
        drive.settle();
        drive.settle();
    }
    std::shared_ptr<LocalActivityHandOver> makeDevice(const std::string& state)
    {
        return LocalActivityHandOver::create(DriveLayout::at(drive.layout().home(), drive.folder().at(state)),
            {drive.dispatch, drive.notifications, nullptr, nullptr, nullptr}, drive.cloud);
    }
    static std::string bookmark(const std::string& path)
    {
        return Bookmark{"account-1", "BrindleDefault", path, 0}.encoded();
    }
    std::string write(ActivityRecord record)
    {
        std::filesystem::create_directories(drive.layout().activities());
        const auto path = drive.layout().activities() + '/' + ActivityRecord::fileName(record.device);
        std::ofstream(path) << record.toJson();
        settle();
        return path;
    }
    ActivityRecord record(const std::string& device, double age = 0) const
    {
        const auto seconds = static_cast<std::int64_t>(drive.dispatch->now().seconds() - age);
        return {device, "Laptop", "account-1", *viewing(bookmark("Documents/a.txt")),
            platform::Date{seconds * 1'000'000'000}};
    }
    /// Answers the names of the documents that are offered to this device.
    std::vector<std::string> offered() const
    {
        std::vector<std::string> names;
        for (const auto& offer : drive.handOver->offers())
            names.push_back(offer.document.lastPathComponent());
        return names;
    }
    std::ptrdiff_t fileCount() const
    {
        using Files = std::filesystem::directory_iterator;
        return std::distance(Files(drive.layout().activities()), Files());
    }

    DriveFixture drive;
    platform::Observation changes;
    int changeCount = 0;
};

using Names = std::vector<std::string>;

TEST_F(HandOver, offersToOtherDevicesWhatIsCurrentAndTakesItBack)
{
    const auto other = makeDevice("other");
    const auto first = viewing(bookmark("Documents/a.txt"));
    other->becomeCurrent(first);
    EXPECT_EQ(fileCount(), 0) << "the caller is not made to wait for the disk";
    settle();
    ASSERT_EQ(offered(), Names{"a.txt"});
    const auto offer = drive.handOver->offers().front();
    EXPECT_EQ(offer.activity, *first);
    EXPECT_EQ(
        offer.deviceIdentifier, host::drive::DeviceIdentity::identifierAt(drive.folder().at("other/device")));
    EXPECT_FALSE(offer.deviceName.empty());
    EXPECT_TRUE(other->offers().empty()) << "a device offers itself nothing";
    EXPECT_EQ(changeCount, 1);

    const auto second = viewing(bookmark("Documents/b.txt"));
    other->becomeCurrent(second);
    other->resignCurrent(first);
    settle();
    EXPECT_EQ(offered(), Names{"b.txt"}) << "what is no longer current can be taken back without effect";
    other->resignCurrent(second);
    settle();
    EXPECT_EQ(offered(), Names());
    EXPECT_EQ(fileCount(), 0);
    EXPECT_EQ(changeCount, 3);
}

TEST_F(HandOver, offersNoDocumentThatIsShownHereAlready)
{
    const auto other = makeDevice("other");
    const auto here = viewing(bookmark("Documents/a.txt"));
    other->becomeCurrent(viewing(bookmark("Documents/a.txt")));
    drive.handOver->becomeCurrent(here);
    settle();
    EXPECT_EQ(offered(), Names());
    EXPECT_TRUE(other->offers().empty());
    drive.handOver->resignCurrent(here);
    settle();
    EXPECT_EQ(offered(), Names{"a.txt"});
}

TEST_F(HandOver, publishesNothingThatOthersMayNotContinueAndOffersNothingToNobody)
{
    write(record("device"));
    const auto other = makeDevice("other");
    other->becomeCurrent(viewing(bookmark("Documents/a.txt"), false));
    settle();
    EXPECT_EQ(fileCount(), 1);
    ASSERT_EQ(offered().size(), 1U);
    drive.signOut();
    other->becomeCurrent(viewing(bookmark("Documents/a.txt")));
    settle();
    EXPECT_EQ(fileCount(), 1);
    EXPECT_TRUE(offered().empty());
}

TEST_F(HandOver, endsWithItsDevice)
{
    auto other = makeDevice("other");
    const auto third = makeDevice("third");
    other->becomeCurrent(viewing(bookmark("Documents/a.txt")));
    settle();
    drive.dispatch->advance(1);
    third->becomeCurrent(viewing(bookmark("Documents/b.txt")));
    settle();
    EXPECT_EQ(offered(), (Names{"b.txt", "a.txt"})) << "the latest first";
    other = nullptr;
    settle();
    EXPECT_EQ(offered(), Names{"b.txt"});
}

TEST_F(HandOver, isRenewedWhileItIsCurrentAndForgottenWhenItsDeviceIsSilent)
{
    const auto other = makeDevice("other");
    const auto activity = viewing(bookmark("Documents/a.txt"));
    other->becomeCurrent(activity);
    write(record("crashed"));
    EXPECT_EQ(offered().size(), 2U);
    for (int i = 0; i < 12; ++i) {
        drive.dispatch->advance(longestSilence / 6);
        settle();
    }
    ASSERT_EQ(offered(), Names{"a.txt"});
    EXPECT_NE(drive.handOver->offers().front().deviceIdentifier, "crashed");
}

TEST_F(HandOver, tellsTheSameDeviceByItsFile)
{
    const auto file = drive.folder().at("other/device");
    const auto first = host::drive::DeviceIdentity::atFile(file);
    EXPECT_TRUE(ActivityRecord::isDevice(first.identifier));
    EXPECT_EQ(host::drive::DeviceIdentity::atFile(file).identifier, first.identifier);
    std::ofstream(file) << "../../evil";
    const auto second = host::drive::DeviceIdentity::atFile(file);
    EXPECT_TRUE(ActivityRecord::isDevice(second.identifier));
    EXPECT_NE(second.identifier, first.identifier);
}

TEST_F(HandOver, offersOnlyWhatIsRecentAndOfThisAccountAndCanBeOpenedHere)
{
    struct Row {
        const char* what;
        std::function<void(ActivityRecord&)> change;
        bool isOffered;
    };
    const auto setBookmark = [](std::string text) {
        return [text = std::move(text)](
                   ActivityRecord& changed) { changed.activity.userInfo.begin()->second = text; };
    };
    const Row rows[] = {
        {"as it is", [](auto&) {}, true},
        {"old", [&](auto& changed) { changed = record("device", longestSilence + 1); }, false},
        {"a clock that is a little ahead", [&](auto& changed) { changed = record("device", -100); }, true},
        {"a clock that is far ahead", [&](auto& changed) { changed = record("device", -1e6); }, false},
        {"another account", [](auto& changed) { changed.account = "account-2"; }, false},
        {"no type", [](auto& changed) { changed.activity.type.clear(); }, false},
        {"no bookmark", [](auto& changed) { changed.activity.userInfo.clear(); }, false},
        {"a record that is too large", setBookmark(std::string(ActivityRecord::maximumFileSize, 'A')), false},
        {"a document that is not here", setBookmark(bookmark("Documents/gone.txt")), false},
    };
    for (const auto& row : rows) {
        auto changed = record("device");
        row.change(changed);
        const auto path = write(changed);
        EXPECT_EQ(!offered().empty(), row.isOffered) << row.what;
        std::filesystem::remove(path);
        settle();
        EXPECT_TRUE(offered().empty()) << row.what;
    }
}

TEST_F(HandOver, passesOverFilesThatAreNoRecords)
{
    const auto folder = drive.layout().activities();
    const auto text = record("device").toJson();
    write(record("good"));
    std::ofstream(folder + "/empty.json") << "";
    std::ofstream(folder + "/damaged.json") << text.substr(0, text.size() / 2);
    std::ofstream(folder + "/renamed.json") << text;
    std::filesystem::create_symlink(folder + "/good.json", folder + "/device.json");
    std::filesystem::create_directory(folder + "/folder.json");
    settle();
    EXPECT_EQ(offered().size(), 1U);
    // The folder may disappear, for instance when another program tidies up.
    std::filesystem::remove_all(folder);
    settle();
    drive.dispatch->advance(5);
    settle();
    EXPECT_TRUE(offered().empty());
    write(record("good"));
    EXPECT_EQ(offered().size(), 1U);
}

} // namespace
