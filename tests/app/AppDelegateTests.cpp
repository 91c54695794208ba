// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "app/AppDelegate.h"
#include "app/SchemeEntry.h"
#include "host/drive/identity/Bookmark.h"
#include "host/drive/identity/DocumentIndex.h"
#include "host/drive/records/ItemFacts.h"
#include "items/FileUtils.h"
#include "items/Settings.h"
#include "kit/controllers/SearchPresentation.h"
#include "kit/controllers/Window.h"
#include "preview/PreviewItemManager.h"
#include "screens/list/DocumentListController.h"
#include "tests/browser/support/BrowserFixture.h"

namespace tarrow {
namespace {

using namespace testing_support;
using namespace platform;
using namespace testing;

constexpr auto top = "BrindleDefault";

struct NoLoop : platform::Application {
    int run(int, char**, const DelegateFactory&) override { return 0; }
};

class AppDelegateTest : public BrowserFixture {
protected:
    /// Launches the application and answers the delegate's answer.
    bool launchApplication(const LaunchOptions& options = {})
    {
        app = std::make_shared<AppDelegate>();
        const bool answer = app->applicationWillFinishLaunchingWithOptions(application, options);
        browser = std::dynamic_pointer_cast<NavController>(app->rootWindow()->rootViewController());
        settle();
        return answer;
    }
    bool open(const std::string& text)
    {
        const bool opened = app->applicationOpenURLOptions(application, text, {});
        settle();
        return opened;
    }
    std::string schemeURL(const std::string& pathAsWritten) const
    {
        return "tarrowdriveapp://" + url("").path() + '/' + pathAsWritten;
    }
    void choose(std::string_view type, PropertyDictionary information = {})
    {
        app->applicationPerformActionForShortcutItemCompletionHandler(application,
            {std::string(type), std::move(information)}, [](bool) { FAIL() << "not for us to call"; });
        settle();
    }
    bool goOn(std::string_view type, PropertyDictionary information = {})
    {
        const bool accepted = app->applicationContinueUserActivityRestorationHandler(
            application, {std::string(type), std::move(information)}, [] { FAIL() << "not for us to call"; });
        settle();
        return accepted;
    }
    /// Gives a document an identifier.
    void identify(const std::string& relativePath, const std::string& identifier) const
    {
        drive.mark(url(relativePath), host::drive::itemMark::documentIdentifier, identifier);
        host::drive::DocumentIndex(drive.layout().index())
            .note(static_cast<std::uint32_t>(std::stoul(identifier)),
                {"documents/BrindleDefault/" + relativePath});
    }
    static PropertyValue archived(const PropertyValue& value)
    {
        return platform::services().keyedArchiver().archive(value);
    }
    std::shared_ptr<kit::SearchPresentation> searchAfterDelay()
    {
        dispatch->advance(0.8);
        return std::dynamic_pointer_cast<kit::SearchPresentation>(browser->presentedViewController());
    }

    NoLoop application;
    std::shared_ptr<AppDelegate> app;
};

TEST_F(AppDelegateTest, TheLaunchShowsTheBrowser)
{
    EXPECT_TRUE(launchApplication());
    ASSERT_NE(browser, nullptr);
    EXPECT_TRUE(app->rootWindow()->isVisible());
    EXPECT_EQ(browser->restorationIdentifier(), "Root");
    EXPECT_THAT(stack(), ElementsAre(top));
}

TEST_F(AppDelegateTest, StateIsKeptOnlyWhileSignedIn)
{
    platform::StateCoder coder;
    app = std::make_shared<AppDelegate>();
    EXPECT_FALSE(app->applicationShouldSaveApplicationState(application, coder)) << "before the launch";
    launchApplication();
    for (const bool signedIn : {true, false}) {
        cloud->token = signedIn ? std::optional(PropertyValue("account-1")) : std::nullopt;
        EXPECT_EQ(app->applicationShouldSaveApplicationState(application, coder), signedIn);
        EXPECT_EQ(app->applicationShouldRestoreApplicationState(application, coder), signedIn);
    }
}

TEST_F(AppDelegateTest, ALaunchWithAShortcutHandlesItOnce)
{
    LaunchOptions options;
    options.shortcutItem = ShortcutItem{std::string(platform::ShortcutTypeSearch), {}};
    EXPECT_FALSE(launchApplication(options)) << "it must not be delivered again";
    EXPECT_NE(searchAfterDelay(), nullptr);
    EXPECT_EQ(log->count("INFO Launched with shortcut: app.tarrow.Drive.search"), 1);
    EXPECT_EQ(log->count("INFO Shortcut action: app.tarrow.Drive.search"), 1);
}

TEST_F(AppDelegateTest, PathsAndQueriesAreDecodedTwiceAndTheLastModeWins)
{
    const auto* const expectedPath = "/path/to/My Doc.txt";
    struct Row {
        const char* text;
        const char* path; ///< empty: no target
        int mode;
    };
    for (const Row row : {
             Row{"tarrowdriveapp:///path/to/My%20Doc.txt", expectedPath, PreviewModeQuick},
             {"tarrowdriveapp:///path/to/My%2520Doc.txt", expectedPath, PreviewModeQuick},
             {"tarrowdriveapp:///path%2Fto%252F.%2FMy%20Doc.txt", expectedPath, PreviewModeQuick},
             {"tarrowdriveapp:/path/to/My%2520Doc.txt", expectedPath, PreviewModeQuick},
             {"tarrowdriveapp://any:1@host:80/path/to/My%20Doc.txt?mode=details#part", expectedPath,
                 PreviewModeDetails},
             {"tarrowdriveapp:///a?mode=info&mode=preview", "/a", PreviewModeQuick},
             {"tarrowdriveapp:///a?mode=info&mode=other&page=2", "/a", PreviewModeDetails},
             {"tarrowdriveapp:///a?mode=Details", "/a", PreviewModeQuick},
             {"tarrowdriveapp:///a?mo%2564e=detail%2573", "/a", PreviewModeDetails},
             {"tarrowdriveapp:///a?mode=%25zz", "/a", PreviewModeQuick},
             {"tarrowdriveapp:///100%2525.txt", "/100%.txt", PreviewModeQuick},
             {"tarrowdriveapp:///100%25.txt", "", PreviewModeQuick},
             {"tarrowdriveapp:///a%2500b", "", PreviewModeQuick},
             {"tarrowdriveapp://", "", PreviewModeQuick},
         }) {
        SCOPED_TRACE(row.text);
        const auto entry = SchemeEntry::parse(row.text);
        ASSERT_TRUE(entry);
        EXPECT_EQ(entry->previewMode, row.mode);
        EXPECT_EQ(entry->target ? entry->target->path() : "", row.path);
    }
}

TEST_F(AppDelegateTest, BadURLsAreRefusedAndNothingMoves)
{
    write("Folder/note.txt");
    drive.makeFolder("../../documents-evil/Folder");
    launchApplication();
    const auto inside = schemeURL("Folder/note.txt");
    const auto drivePath = url("").path();
    const std::string rows[] = {// No URL of ours.
        "", "no URL", "file://" + drivePath + "/Folder", "javascript:alert(1)",
        "TarrowDriveApp://" + drivePath + "/Folder", "tarrowdriveapp", "--option", "-h", inside + "\nmore",
        inside + " ", "tarrowdriveapp:///a%zz", "tarrowdriveapp:///a%4", "tarrowdriveapp:///a%",
        "tarrowdriveapp:///a%00b", "tarrowdriveapp:///%ff", "tarrowdriveapp:///%c0%ae",
        // These are URLs of our own scheme, but none names an item of the drive.
        "tarrowdriveapp:", "tarrowdriveapp:///", "tarrowdriveapp:///etc/passwd", schemeURL("../../../drive"),
        schemeURL("Folder/%2e%2e/%2E./%252e%252e/account.json"), schemeURL("Folder/a/../../../.."),
        schemeURL("Folder/note.txt/.."), schemeURL("gone/../Folder"),
        schemeURL("../../documents-evil/Folder"), schemeURL("Folder/gone.txt"),
        schemeURL("Folder/note.txt%2500"), schemeURL("Folder/%25ff"), schemeURL("Folder\\note.txt"),
        schemeURL(std::string(256, 'a')), schemeURL("Folder/" + std::string(5000, 'a')),
        "tarrowdriveapp:///" + std::string(1'000'000, 'a'), [] {
            std::string deep = "tarrowdriveapp://";
            for (int i = 0; i < 10'000; ++i)
                deep += "/a";
            return deep;
        }()};
    watch(*app->rootWindow());
    for (const auto& row : rows) {
        SCOPED_TRACE(row.substr(0, 200));
        EXPECT_FALSE(open(row));
        EXPECT_THAT(stack(), ElementsAre(top));
        EXPECT_EQ(takeNotices().size(), 1);
    }
    open(schemeURL("Folder/gone.txt"));
    open("tarrowdriveapp:///etc/passwd");
    open("javascript:alert(1)");
    EXPECT_THAT(takeNotices(),
        ElementsAre("“gone.txt” is no longer there.", "“passwd” lies outside the drive.",
            "This address cannot be opened."));
    cloud->token = std::nullopt;
    open(schemeURL("Folder/gone.txt"));
    EXPECT_THAT(takeNotices(), testing::IsEmpty()) << "the screen says enough";
}

TEST_F(AppDelegateTest, URLsOpenItemsOfTheDrive)
{
    write("My Folder/100%.txt");
    launchApplication();
    EXPECT_TRUE(open(schemeURL("My%20Folder/100%2525.txt?mode=details")));
    EXPECT_THAT(stack(), ElementsAre(top, "My Folder", "i"));
    EXPECT_EQ(browser->itemManager()->mode(), PreviewModeDetails);
    EXPECT_THAT(log->activities(), testing::Contains("AppDelegate: openURL"));
    EXPECT_TRUE(open(schemeURL("My%2520Folder")));
    EXPECT_THAT(stack(), ElementsAre(top, "My Folder"));
    write("My Folder/deep/b.txt");
    drive.writeLink("link", "My Folder/deep");
    EXPECT_TRUE(open(schemeURL("link%2F..%2F100%2525.txt")));
    EXPECT_EQ(browser->itemManager()->item()->url(), url("My Folder/100%.txt"));
}

TEST_F(AppDelegateTest, ARecentDocumentIsLookedForInThreeWaysInTurn)
{
    write("alias.txt");
    write("numbered.txt");
    write("plain.txt");
    const std::uint64_t identifier = 77;
    identify("numbered.txt", "77");
    const std::string aliasKey(platform::RecentDocumentAliasURLKey);
    const std::string numberKey(platform::RecentDocumentDocIDKey), plainKey(platform::RecentDocumentURLKey);
    const auto alias = archived(url("alias.txt")), plain = archived(url("plain.txt"));
    const auto damaged = PropertyValue(platform::Data(7, std::byte{1}));
    const auto number = PropertyValue(identifier);
    struct Row {
        const char* name;
        PropertyDictionary information;
        const char* expected; ///< empty: nothing is opened
    };
    const Row rows[] = {
        {"alias first", {{aliasKey, alias}, {numberKey, number}, {plainKey, plain}}, "alias.txt"},
        {"number when the alias is damaged", {{aliasKey, damaged}, {numberKey, number}, {plainKey, plain}},
            "numbered.txt"},
        {"an unknown number is final", {{numberKey, identifier + 1}, {plainKey, plain}}, ""},
        {"so is one that cannot be", {{numberKey, std::int64_t{-1}}, {plainKey, plain}}, ""},
        {"and one too large", {{numberKey, (std::uint64_t{1} << 32) + identifier}, {plainKey, plain}}, ""},
        {"the plain one when there is no number",
            {{aliasKey, damaged}, {numberKey, std::to_string(identifier)}, {plainKey, plain}}, "plain.txt"},
        {"nothing", {}, ""},
        {"a URL that is not archived", {{plainKey, url("plain.txt")}}, ""},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.name);
        launchApplication();
        watch(*app->rootWindow());
        choose(platform::ShortcutTypeRecentDocument, row.information);
        if (*row.expected) {
            EXPECT_THAT(stack(), ElementsAre(top, "*"));
            ASSERT_NE(browser->itemManager(), nullptr);
            EXPECT_EQ(browser->itemManager()->item()->url(), url(row.expected));
        } else {
            EXPECT_THAT(stack(), ElementsAre(top));
            EXPECT_THAT(takeNotices(), ElementsAre("There is no recent document."));
        }
    }
}

TEST_F(AppDelegateTest, TheRecentDocumentIsTheOneThatWasOpenedLast)
{
    write("first.txt");
    write("Folder/second.txt");
    launchApplication();
    post(platform::Notification::ApplicationDidBecomeActive);
    EXPECT_TRUE(open(schemeURL("first.txt")) && open(schemeURL("Folder/second.txt")));
    EXPECT_FALSE(FileUtils::moveTo(url("Folder/second.txt"), url("moved.txt")));
    settle();
    const LaunchOptions options{shortcuts->recentDocument()};
    launchApplication(options);
    EXPECT_THAT(stack(), ElementsAre(top, "*"));
    EXPECT_EQ(browser->itemManager()->item()->url(), url("moved.txt"));

    EXPECT_FALSE(FileUtils::remove(url("moved.txt")));
    launchApplication();
    watch(*app->rootWindow());
    choose(options.shortcutItem->type, options.shortcutItem->userInfo);
    EXPECT_THAT(takeNotices(), ElementsAre("There is no recent document."));
}

TEST_F(AppDelegateTest, OtherShortcutsDoNothing)
{
    launchApplication();
    choose("another.shortcut");
    EXPECT_THAT(stack(), ElementsAre(top));
    EXPECT_EQ(searchAfterDelay(), nullptr);
}

TEST_F(AppDelegateTest, ASearchGoesOnWithItsQuery)
{
    const auto key = std::string(platform::activityKey::searchQuery);
    for (const auto& [information, expected] :
        {std::pair<PropertyDictionary, std::optional<std::string>>{{{key, "note"}}, "note"},
            {{{key, ""}}, ""}, {{}, std::nullopt}, {{{key, 5}}, std::nullopt}}) {
        launchApplication();
        EXPECT_TRUE(goOn(platform::activityType::queryContinuation, information));
        const auto search = searchAfterDelay();
        EXPECT_EQ(search ? std::optional(search->query()) : std::nullopt, expected);
    }
    EXPECT_EQ(log->count("INFO CoreGlimmer Search Continuation: \"note\""), 1);
}

TEST_F(AppDelegateTest, ASearchResultIsFoundByItsNumber)
{
    write("Folder/note.txt");
    const std::string identifier = "4711", unknown = "4712";
    identify("Folder/note.txt", identifier);
    const auto key = std::string(platform::activityKey::searchableItemIdentifier);
    launchApplication();
    for (const std::string& bad : {unknown, std::string(), std::string("no number"), "-" + identifier,
             std::string("4294967296"), std::string("99999999999999999999999")}) {
        EXPECT_TRUE(goOn(platform::activityType::searchableItem, {{key, bad}}));
        EXPECT_THAT(stack(), ElementsAre(top));
        EXPECT_EQ(log->count("ERROR Can't get URL for DocumentID: " + bad), 1) << bad;
    }
    EXPECT_TRUE(goOn(platform::activityType::searchableItem));

    const UserActivity found{std::string(platform::activityType::searchableItem), {{key, identifier}}};
    EXPECT_TRUE(app->applicationContinueUserActivityRestorationHandler(application, found, {}));
    EXPECT_THAT(stack(), ElementsAre(top)) << "the browser is only led there on the main queue's next turn";
    settle();
    EXPECT_THAT(stack(), ElementsAre(top, "Folder", "*"));
}

TEST_F(AppDelegateTest, AHandedOverDocumentIsDecodedAndShown)
{
    write("Folder/note.txt");
    launchApplication();
    const auto key = std::string(platform::activityKey::documentURL);
    const auto type = Settings::batonneTarrowActivityType();
    for (const auto& bad :
        {PropertyDictionary{}, PropertyDictionary{{key, "no bookmark"}}, PropertyDictionary{{key, 1}}}) {
        log->clear();
        EXPECT_TRUE(goOn(type, bad));
        EXPECT_THAT(stack(), ElementsAre(top));
        EXPECT_THAT(log->lines(), testing::Contains(HasSubstr("ERROR Batonne failed to decode bookmark: ")));
    }
    const auto container = drive.cloud->containers().defaultContainerIdentifier();
    const PropertyValue bookmark = host::drive::Bookmark{"account-1", container, "Folder/note.txt"}.encoded();
    EXPECT_TRUE(goOn(type, {{key, bookmark}}));
    EXPECT_THAT(stack(), ElementsAre(top, "Folder", "*"));
}

TEST_F(AppDelegateTest, AnUnknownActivityIsRefused)
{
    launchApplication();
    EXPECT_FALSE(goOn("another.activity"));
    EXPECT_EQ(log->count("ERROR Invalid user activity type another.activity"), 1);
}

TEST_F(AppDelegateTest, WithoutTheBrowserNothingIsLedAnywhere)
{
    write("note.txt");
    launchApplication();
    app->rootWindow()->setRootViewController(std::make_shared<kit::ViewController>());
    EXPECT_FALSE(open(schemeURL("note.txt")));
    choose(platform::ShortcutTypeSearch);
    EXPECT_TRUE(goOn(platform::activityType::queryContinuation,
        {{std::string(platform::activityKey::searchQuery), "note"}}));
    dispatch->advance(1);
    EXPECT_THAT(stack(), ElementsAre(top));
    EXPECT_EQ(app->rootWindow()->rootViewController()->presentedViewController(), nullptr);
}

} // namespace
} // namespace tarrow
