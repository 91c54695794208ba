// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "DriveTests.h"

#include <gmock/gmock.h>

namespace e2e {
namespace {

constexpr unsigned escape = 0xff1b;

/// Every way into the program from outside: a start, a second start, the launcher, another window.
class EntryTests : public DriveTests {
protected:
    void SetUp() override
    {
        DriveTests::SetUp();
        std::ofstream(top / "Desktop/Errands.txt") << "Buy flour";
    }
    std::string errands() const { return "tarrowdriveapp://" + (top / "Desktop/Errands.txt").string(); }
    /// Waits until the preview shows a text.
    testing::AssertionResult reads(const std::string& text) const
    {
        return eventually([&] { return program->document().find(text) != std::string::npos; });
    }
    testing::AssertionResult searchesFor(const std::string& query) const
    {
        return eventually([&] {
            const auto entries = program->entries();
            return !entries.empty() && entries.back().text() == query;
        });
    }
    int startBeside(const std::vector<std::string>& arguments) const
    {
        std::vector<std::string> command{getenv("TRW_PROGRAM")};
        command.insert(command.end(), arguments.begin(), arguments.end());
        return Program::run(command, environment);
    }
    /// Calls an action as the launcher does.
    int callAction(const std::string& name) const
    {
        return Program::run(
            {"gdbus", "call", "--session", "--dest", "app.tarrow.Drive", "--object-path", "/app/tarrow/Drive",
                "--method", "org.freedesktop.Application.ActivateAction", name, "[]", "{}"},
            environment);
    }
};

TEST_F(EntryTests, AStartShowsWhatItIsAskedForAndElseWhatWasShownLast)
{
    start({errands()});
    EXPECT_TRUE(reads("Buy flour"));
    startAgain();
    EXPECT_TRUE(reads("Buy flour")) << "the preview of the last run";
    startAgain({"--search"});
    EXPECT_TRUE(searchesFor("")) << "the preview of the last run covers it";
    EXPECT_TRUE(program->document().empty());

    startAgain({"--recent"});
    EXPECT_TRUE(reads("Buy flour")) << "the document that was opened last";
    startAgain();
    EXPECT_TRUE(reads("Buy flour"));
    program->pressUntil("Back", [this] { return program->document().empty(); });
    EXPECT_TRUE(eventually([this] { return program->shows("Errands.txt"); })) << "its folder";

    startAgain({"--search", "tusc"});
    EXPECT_TRUE(searchesFor("tusc"));
    EXPECT_TRUE(eventually([this] { return program->shows("Tuscany.md"); }));
}

TEST_F(EntryTests, TheLauncherAndASecondStartReachTheRunningProgram)
{
    start();
    EXPECT_EQ(callAction("recent-document"), 0);
    EXPECT_TRUE(eventually([this] { return program->says("There is no recent document."); }));
    EXPECT_EQ(startBeside({errands()}), 0);
    EXPECT_TRUE(reads("Buy flour"));
    EXPECT_EQ(callAction("search"), 0);
    EXPECT_TRUE(searchesFor(""));
    EXPECT_EQ(startBeside({"--search", "tusc"}), 0);
    EXPECT_TRUE(searchesFor("tusc"));
    ASSERT_EQ(files({"move", "Desktop/Errands.txt", "Documents/Chores.txt"}), 0);
    EXPECT_EQ(callAction("recent-document"), 0);
    EXPECT_TRUE(eventually([this] { return program->says("Chores.txt"); })) << "found where it is now";
    EXPECT_TRUE(reads("Buy flour"));
}

TEST_F(EntryTests, AWindowThatGetsTheKeyboardBackShowsWhatChangedMeanwhile)
{
    start({errands()});
    EXPECT_TRUE(reads("Buy flour"));
    {
        auto elsewhere = environment;
        elsewhere["XDG_STATE_HOME"] = home / "other-state";
        elsewhere["DBUS_SESSION_BUS_ADDRESS"] = getenv("TRW_OTHER_BUS");
        const Program another(elsewhere); // its window takes the keyboard
        EXPECT_TRUE(eventually([&] { return another.hasKeyboardAt("Desktop"); }));
        std::ofstream(top / "Desktop/Errands.txt") << "Buy flour and eggs";
    }
    EXPECT_EQ(startBeside({}), 0); // brings the window to the front
    EXPECT_TRUE(reads("flour and eggs"));
    pressKey(escape);
    EXPECT_TRUE(eventually([this] { return program->shows("Errands.txt"); }));
}

} // namespace
} // namespace e2e
