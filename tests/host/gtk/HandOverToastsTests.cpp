// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/screens/HandOverToasts.h"

#include "WindowFixture.h"
#include "host/drive/identity/Bookmark.h"
#include "host/drive/service/LocalActivityHandOver.h"
#include "tests/support/DriveFixture.h"

#include <filesystem>

namespace {

using host::drive::LocalActivityHandOver;
using host::gtk::HandOverToasts;
using platform::UserActivity;
using Activity = std::shared_ptr<const UserActivity>;

/// A window of this device, and another device of the account on the same drive.
class HandOverToastsTest : public testing_support::WindowFixture {
protected:
    void SetUp() override
    {
        WindowFixture::show(testing_support::makeScreen("Root"));
        toasts = HandOverToasts::make(
            peer().toasts(), [this](const UserActivity& activity) { continued.push_back(activity); },
            [this](const UserActivity&, const platform::Error& error) { failures.push_back(error); });
        other = LocalActivityHandOver::create(
            host::drive::DriveLayout::at(drive.layout().home(), drive.folder().at("other")),
            {drive.dispatch, drive.notifications, nullptr, nullptr, nullptr}, drive.cloud);
    }
    void TearDown() override
    {
        toasts = nullptr;
        other = nullptr;
        WindowFixture::TearDown();
    }
    void rest() const
    {
        for (int turn = 0; turn < 3; ++turn)
            drive.settle();
    }
    Activity show(const std::string& name)
    {
        drive.writeDocument("Documents/" + name);
        auto activity = std::make_shared<UserActivity>();
        activity->type = "BrindleDocsID.viewing";
        activity->isEligibleForHandOff = true;
        activity->userInfo.emplace(platform::activityKey::documentURL,
            host::drive::Bookmark{"account-1", "BrindleDefault", "Documents/" + name, 0}.encoded());
        other->becomeCurrent(activity);
        rest();
        return activity;
    }
    std::string title() const
    {
        auto* label = toasts->toast() ? adw_toast_get_custom_title(toasts->toast()) : nullptr;
        return label ? gtk_label_get_label(GTK_LABEL(label)) : "";
    }
    void press()
    {
        auto* button = findButton("Continue");
        ASSERT_NE(button, nullptr);
        g_signal_emit_by_name(button, "clicked");
        rest();
    }

    testing_support::DriveFixture drive;
    std::shared_ptr<HandOverToasts> toasts;
    std::shared_ptr<LocalActivityHandOver> other;
    std::vector<UserActivity> continued;
    std::vector<platform::Error> failures;
};

TEST_F(HandOverToastsTest, ContinuesWithWhatTheOtherDeviceShows)
{
    EXPECT_EQ(toasts->toast(), nullptr);
    const auto activity = show("a <b> & c.txt");
    EXPECT_TRUE(title().starts_with("“a <b> & c.txt” on ")) << title();
    press();
    EXPECT_EQ(continued, std::vector{*activity});
    EXPECT_EQ(toasts->toast(), nullptr);
    drive.dispatch->advance(600);
    rest();
    EXPECT_EQ(toasts->toast(), nullptr) << "what was taken does not come back with each renewal";
}

TEST_F(HandOverToastsTest, IsDismissedForAsLongAsTheDocumentIsShown)
{
    show("first.txt");
    adw_toast_dismiss(toasts->toast());
    drive.dispatch->advance(600);
    rest();
    EXPECT_EQ(toasts->toast(), nullptr);
    show("second.txt");
    EXPECT_TRUE(title().starts_with("“second.txt”"));
}

TEST_F(HandOverToastsTest, SaysThatTheDocumentHasGone)
{
    show("first.txt");
    std::filesystem::remove(drive.url("Documents/first.txt").path());
    press();
    EXPECT_TRUE(continued.empty());
    ASSERT_EQ(failures.size(), 1U);
    EXPECT_FALSE(failures.front().text(platform::errorKey::localizedDescription).value_or("").empty());
}

} // namespace
