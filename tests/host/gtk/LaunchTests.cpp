// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/app/CommandLine.h"
#include "host/gtk/app/StateFile.h"
#include "platform/Services.h"
#include "tests/support/PlainTexts.h"
#include "tests/support/TemporaryDirectory.h"

#include <gmock/gmock.h>

namespace {

using host::gtk::CommandLine;
using host::gtk::LaunchRequest;
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

} // namespace
