// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "DriveTests.h"

#include <gmock/gmock.h>

namespace e2e {
namespace {

constexpr unsigned returnKey = 0xff0d, escape = 0xff1b;

/// Something happens outside the window while a person has something open in it. A menu that is left behind
/// would keep the keyboard and the pointer, and only killing the program would help.
class InterruptionTests : public DriveTests {
protected:
    struct Menu {
        const char* name;
        std::function<void()> open;
        const char* entry; ///< one of its entries
    };
    std::vector<Menu> menus()
    {
        return {
            {"a row's menu", [this] { program->buttons("To do.txt").back().perform("row.menu"); }, "Rename"},
            {"the menu of the bar",
                [this] {
                    program->pressUntil("Order and Options", [this] { return program->shows("Name"); });
                },
                "Name"}};
    }
    void openDesktop()
    {
        program->pressUntil("Desktop", [this] { return program->shows("To do.txt"); });
        EXPECT_TRUE(program->shows("To do.txt"));
    }
    int open(const std::string& path) const
    {
        return Program::run(
            {getenv("TRW_PROGRAM"), "tarrowdriveapp://" + (top / path).string()}, environment);
    }
    int account(const std::vector<std::string>& arguments) const
    {
        std::vector<std::string> command{getenv("TRW_ACCOUNT")};
        command.insert(command.end(), arguments.begin(), arguments.end());
        return Program::run(command, environment);
    }
};

TEST_F(InterruptionTests, AMenuEndsWhenAUrlComesFromOutside)
{
    start();
    for (const auto& menu : menus()) {
        SCOPED_TRACE(menu.name);
        openDesktop();
        menu.open();
        ASSERT_TRUE(eventually([&] { return program->shows(menu.entry); }));
        EXPECT_EQ(open("Desktop/To%20do.txt"), 0);
        EXPECT_TRUE(eventually([this] { return !program->document().empty(); }));
        EXPECT_FALSE(program->shows(menu.entry));
        // The keyboard still reaches the window: it leads back to the folder and to the top.
        pressKey(escape);
        ASSERT_TRUE(eventually([this] { return program->shows("To do.txt"); }));
        pressKey(escape);
        ASSERT_TRUE(eventually([this] { return program->shows("Photos"); }));
    }
}

TEST_F(InterruptionTests, AMenuEndsWithASignOut)
{
    start();
    for (const auto& menu : menus()) {
        SCOPED_TRACE(menu.name);
        openDesktop();
        menu.open();
        ASSERT_TRUE(eventually([&] { return program->shows(menu.entry); }));
        EXPECT_EQ(account({"sign-out"}), 0);
        EXPECT_TRUE(eventually([this] { return program->says("You are not signed in"); }));
        EXPECT_FALSE(program->shows(menu.entry));
        EXPECT_EQ(account({"sign-in", "Mira Keller"}), 0);
        EXPECT_TRUE(eventually([this] { return program->hasKeyboardAt("Desktop"); }));
        pressKey(returnKey);
        EXPECT_TRUE(eventually([this] { return program->shows("To do.txt"); }));
        pressKey(escape);
        EXPECT_TRUE(eventually([this] { return program->shows("Photos"); }));
    }
}

} // namespace
} // namespace e2e
