// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/app/CommandLine.h"
#include "host/gtk/app/DesktopShortcuts.h"
#include "host/gtk/app/StateFile.h"
#include "platform/Services.h"
#include "tests/support/DriveFixture.h"
#include "tests/support/PlainTexts.h"
#include "tests/support/TemporaryDirectory.h"
#include "tests/support/VirtualDispatch.h"

#include <gmock/gmock.h>
#include <gtk/gtk.h>

namespace {

using host::gtk::CommandLine;
using host::gtk::LaunchRequest;
using host::gtk::OpenRecentDocument;
using host::gtk::OpenSearch;
using host::gtk::OpenUrl;
using Mode = CommandLine::Mode;

struct ArgumentRow {
    std::vector<const char*> arguments;
    Mode mode;
    std::vector<LaunchRequest> requests;
};

TEST(CommandLineTests, ArgumentsAreReadToTheLetter)
{
    platform::ServiceSet set;
    set.localization = std::make_shared<testing_support::PlainTexts>();
    platform::installServices(std::move(set));
    const std::vector<ArgumentRow> rows{
        {{}, Mode::Run, {}},
        {{"tarrowdriveapp:///a%2520b?mode=info&mode=%70review"}, Mode::Run,
            {OpenUrl{"tarrowdriveapp:///a%2520b?mode=info&mode=%70review"}}},
        {{"--search"}, Mode::Run, {OpenSearch{}}},
        {{"--recent"}, Mode::Run, {OpenRecentDocument{}}},
        {{"--search", "two words"}, Mode::Run, {OpenSearch{"two words"}}},
        {{"--", "--search"}, Mode::Run, {OpenUrl{"--search"}}},
        {{"--gapplication-service"}, Mode::Service, {}},
        {{"x:", "--help"}, Mode::Help, {}},
        {{"--version"}, Mode::Version, {}},
        {{"--verbose"}, Mode::Invalid, {}},
    };
    for (const auto& row : rows) {
        std::vector<const char*> argv{"tarrow-drive"};
        argv.insert(argv.end(), row.arguments.begin(), row.arguments.end());
        const auto line = CommandLine::parse(static_cast<int>(argv.size()), argv.data());
        EXPECT_EQ(line.mode, row.mode) << argv.back();
        EXPECT_EQ(line.requests, row.requests) << argv.back();
        EXPECT_EQ(line.complaint.empty(), row.mode != Mode::Invalid);
    }
    platform::installServices({});
}

TEST(StateFileTests, KeepsWhatWasSetAndSurvivesDamage)
{
    const testing_support::TemporaryDirectory folder;
    const auto path = folder.at("state/interface.json");
    const platform::PropertyDictionary size{{"width", 640}, {"title", "a\"b"}};
    {
        host::gtk::StateFile file(path);
        EXPECT_TRUE(file.values().empty());
        file.set("window", size);
        file.set("interface", 1);
        file.set("interface", {});
    }
    const auto kept = host::gtk::StateFile(path).values();
    EXPECT_EQ(kept, (platform::PropertyDictionary{{"window", size}}));
    for (const char* damaged : {"", "{", "[]", "\xff\xfe", "{\"version\":99}"}) {
        folder.write("state/interface.json", damaged);
        EXPECT_TRUE(host::gtk::StateFile(path).values().empty()) << damaged;
    }
}

TEST(StateFileTests, IsWrittenLaterAndAtTheLatestAtTheEnd)
{
    const testing_support::TemporaryDirectory folder;
    const auto path = folder.at("interface.json");
    const auto stored = [&] { return host::gtk::StateFile(path).values(); };
    const auto dispatch = testing_support::VirtualDispatch::create();
    {
        host::gtk::StateFile file(path, dispatch);
        file.set("width", 1);
        file.set("width", 2);
        EXPECT_TRUE(stored().empty()) << "nobody waits for the disk";
        dispatch->runUntilIdle();
        EXPECT_EQ(stored(), (platform::PropertyDictionary{{"width", 2}}));
        file.set("width", 3);
    }
    EXPECT_EQ(stored(), (platform::PropertyDictionary{{"width", 3}}));
}

TEST(DesktopShortcutsTests, KeepsTheRecentDocumentForTheNextRunAndNamesItToTheDesktop)
{
    using platform::ShortcutItem;
    const testing_support::TemporaryDirectory folder;
    const auto dispatch = testing_support::VirtualDispatch::create();
    const auto queue = dispatch->makeSerialQueue("launcher");
    const auto list = folder.at("recently-used.xbel");
    const auto shortcuts = [&] {
        return host::gtk::DesktopShortcuts({folder.at("state/recent-document.json"), list, queue});
    };
    const auto document = platform::Url::fileURL(folder.write("50% über alles.txt", "text"));
    const ShortcutItem shortcut{
        std::string(platform::ShortcutTypeRecentDocument), {{"RecentDocumentDocID", std::uint64_t{77}}}};
    for (const auto& opened : {document, platform::Url::fileURL(folder.at("other.txt"))}) {
        shortcuts().keepRecentDocument(opened, shortcut);
        dispatch->runUntilIdle();
    }
    const auto kept = shortcuts().recentDocument();
    ASSERT_TRUE(kept);
    EXPECT_EQ(kept->type, shortcut.type);
    EXPECT_EQ(kept->userInfo, shortcut.userInfo);
    const std::unique_ptr<GBookmarkFile, decltype(&g_bookmark_file_free)> bookmarks(
        g_bookmark_file_new(), g_bookmark_file_free);
    ASSERT_TRUE(g_bookmark_file_load_from_file(bookmarks.get(), list.c_str(), nullptr));
    EXPECT_EQ(g_bookmark_file_get_size(bookmarks.get()), 2);
    EXPECT_TRUE(g_bookmark_file_has_item(bookmarks.get(), document.absoluteString().c_str()));

    folder.write("recently-used.xbel", "another form");
    auto forgetting = shortcuts();
    forgetting.keepRecentDocument(document, shortcut);
    forgetting.forgetRecentDocument();
    dispatch->runUntilIdle();
    EXPECT_EQ(shortcuts().recentDocument(), std::nullopt);
    EXPECT_EQ(testing_support::contentOf(list), "another form") << "it is another program's";
}

} // namespace
