// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/app/CommandLine.h"
#include "host/gtk/app/DesktopShortcuts.h"
#include "host/gtk/app/StateFile.h"
#include "platform/Services.h"
#include "tests/support/PlainTexts.h"
#include "tests/support/TemporaryDirectory.h"

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

TEST(DesktopShortcutsTests, KeepsTheRecentDocumentForTheNextRunAndNamesItToTheDesktop)
{
    using platform::ShortcutItem;
    const testing_support::TemporaryDirectory folder;
    const auto path = folder.at("state/recent-document.json");
    const auto document = platform::Url::fileURL(folder.write("50% \u00fcber alles.txt", "text"));
    const ShortcutItem shortcut{
        std::string(platform::ShortcutTypeRecentDocument), {{"RecentDocumentDocID", std::uint64_t{77}}}};
    host::gtk::DesktopShortcuts(path).keepRecentDocument(document, shortcut);
    const auto kept = host::gtk::DesktopShortcuts(path).recentDocument();
    ASSERT_TRUE(kept);
    EXPECT_EQ(kept->type, shortcut.type);
    EXPECT_EQ(kept->userInfo, shortcut.userInfo);
    EXPECT_TRUE(
        gtk_recent_manager_has_item(gtk_recent_manager_get_default(), document.absoluteString().c_str()));
    host::gtk::DesktopShortcuts(path).forgetRecentDocument();
    EXPECT_EQ(host::gtk::DesktopShortcuts(path).recentDocument(), std::nullopt);
}

} // namespace
