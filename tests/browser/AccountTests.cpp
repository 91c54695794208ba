// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "browser/NavController.h"
#include "platform/UserDefaults.h"
#include "preview/PreviewItemManager.h"
#include "screens/UnavailableScreen.h"
#include "screens/list/DocumentListController.h"
#include "tests/browser/support/BrowserFixture.h"

namespace tarrow {
namespace {

using namespace testing_support;
using namespace platform;
using namespace screens;
using namespace testing;

constexpr auto tokenKey = "TarrowDriveAppID.UbiquityIdentityToken";

class AccountTest : public BrowserFixture {
protected:
    void store(const char* token)
    {
        defaults().setData(tokenKey, platform::services().keyedArchiver().archive(PropertyValue(token)));
    }
    std::optional<PropertyValue> stored()
    {
        const auto data = defaults().data(tokenKey);
        return data ? platform::services().keyedArchiver().unarchive(*data) : std::nullopt;
    }
    bool isUnavailable() const
    {
        const auto& stack = browser->viewControllers();
        return stack.size() == 1 && std::dynamic_pointer_cast<UnavailableScreen>(stack[0]);
    }
    bool showsRootOnly() const
    {
        const auto& stack = browser->viewControllers();
        return stack.size() == 1 && std::dynamic_pointer_cast<DocumentListController>(stack[0]);
    }
};

TEST_F(AccountTest, SignedOutAtLaunchAndSignedInLater)
{
    cloud->token = std::nullopt;
    launch();
    EXPECT_TRUE(isUnavailable());
    EXPECT_TRUE(browser->isToolbarHidden());
    EXPECT_FALSE(browser->checkTarrowState());
    EXPECT_EQ(browser->quotaFetcher(), nullptr);
    EXPECT_EQ(browser->quotaBytes(), 0);
    EXPECT_EQ(log->count("WARNING Tarrow is not enabled"), 1);
    offers->offer = SimulatedOffers::make(1, true);
    post(Notification::StorageOfferDidChange);
    dispatch->advance(30);
    EXPECT_EQ(cloud->requests, 0) << "nobody is there to fetch the quota for";
    cloud->token = PropertyValue("account-1");
    post(Notification::CloudIdentityDidChange);
    EXPECT_TRUE(showsRootOnly());
    EXPECT_FALSE(browser->isToolbarHidden());
    EXPECT_EQ(cloud->requests, 1) << "the fetcher began at once";
    EXPECT_EQ(log->count("INFO Tarrow account availability changed"), 1);
    EXPECT_EQ(stored(), PropertyValue("account-1"));
}

TEST_F(AccountTest, TheStoredTokenDecidesWhetherTheBrowserIsSetUpAgain)
{
    struct Row {
        const char* name;
        const char* stored; ///< "": absent; "damaged": no archive
        const char* current; ///< "": signed out
        const char* expected; ///< "": matches; else what the log says of the change
    };
    for (const Row row : {Row{"both absent", "", "", ""}, {"the same", "a", "a", ""},
             {"another", "a", "b", "YES"}, {"signed out", "a", "", "NO"}, {"first run", "", "a", "YES"},
             {"unreadable", "damaged", "a", "YES"}, {"unreadable and signed out", "damaged", "", ""}}) {
        SCOPED_TRACE(row.name);
        defaults().remove(tokenKey);
        if (row.stored == std::string("damaged"))
            defaults().setData(tokenKey, platform::Data(5, std::byte{0x7b}));
        else if (*row.stored)
            store(row.stored);
        cloud->token = *row.current ? std::optional(PropertyValue(row.current)) : std::nullopt;
        launch();
        const auto shownAtLaunch = browser->topViewController();
        log->clear();

        post(Notification::ApplicationDidBecomeActive);
        const bool isChange = *row.expected;
        EXPECT_EQ(log->count("INFO Got HostDidActivateEvent (nav)"), 1);
        EXPECT_EQ(log->count("DEBUG Tarrow Token Matches"), isChange ? 0 : 1);
        EXPECT_EQ(log->count(std::string("INFO Tarrow Token Changed, enabled=") + row.expected
                      + ", reinitializing view"),
            isChange ? 1 : 0);
        EXPECT_EQ(browser->topViewController() != shownAtLaunch, isChange);
        if (isChange) {
            EXPECT_EQ(stored(), cloud->token);
        }

        log->clear();
        post(Notification::ApplicationDidBecomeActive);
        EXPECT_EQ(log->count("DEBUG Tarrow Token Matches"), 1) << "the second time nothing has changed";
    }
}

TEST_F(AccountTest, SigningOutTakesEverythingAway)
{
    write("Folder/note.txt", "text");
    launch();
    post(Notification::ApplicationDidBecomeActive);
    EXPECT_TRUE(warp("Folder/note.txt"));
    ASSERT_NE(browser->itemManager(), nullptr);
    EXPECT_GT(browser->viewControllers().size(), 2);
    EXPECT_EQ(browser->quotaBytes(), 1000);

    cloud->token = std::nullopt;
    post(Notification::CloudIdentityDidChange);
    EXPECT_TRUE(isUnavailable());
    EXPECT_EQ(browser->itemManager(), nullptr);
    EXPECT_EQ(browser->quotaBytes(), 0);
    EXPECT_FALSE(defaults().data(tokenKey).has_value());
    dispatch->advance(900);
    EXPECT_EQ(cloud->requests, 2) << "one for each set-up, and none after signing out";
}

TEST_F(AccountTest, SavedStateBringsThePreviewBack)
{
    write("Folder/note.txt", "text");
    launch();
    const auto state = [this] {
        platform::StateCoder coder;
        browser->encodeRestorableStateWithCoder(coder);
        return coder;
    };
    EXPECT_TRUE(state().values().empty()) << "no preview, nothing to keep";
    warp("Folder/note.txt", PreviewModeDetails);
    const auto saved = state();
    ASSERT_NE(saved.decode("url"), nullptr);
    EXPECT_EQ(saved.decode("PreviewMode")->asInteger(), PreviewModeDetails);

    launch();
    browser->decodeRestorableStateWithCoder(saved);
    settle();
    ASSERT_NE(browser->itemManager(), nullptr);
    EXPECT_EQ(browser->itemManager()->mode(), PreviewModeDetails);
    EXPECT_EQ(browser->itemManager()->item()->url(), url("Folder/note.txt"));
    EXPECT_THAT(stack(), ElementsAre("BrindleDefault", "Folder", "i"));
    browser->popViewController(false);
    settle();
    EXPECT_EQ(topList()->containedItemCount(), 1U) << "the way back leads to the document's folder";
}

TEST_F(AccountTest, StateThatNoLongerFitsIsNotRestored)
{
    write("Folder/note.txt", "text");
    const PropertyValue rows[] = {url("Folder"), url("Folder/gone.txt"), "no URL", {}, std::int64_t{5}};
    for (const auto& saved : rows) {
        launch();
        platform::StateCoder coder;
        coder.encode("url", saved);
        coder.encode("PreviewMode", PropertyValue("no number"));
        browser->decodeRestorableStateWithCoder(coder);
        settle();
        EXPECT_EQ(browser->itemManager(), nullptr);
        EXPECT_TRUE(showsRootOnly());
    }
}

} // namespace
} // namespace tarrow
