// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "DriveTests.h"

#include <gmock/gmock.h>

namespace e2e {
namespace {

constexpr unsigned returnKey = 0xff0d, escape = 0xff1b, deleteKey = 0xffff, f2 = 0xffbf, menuKey = 0xff67,
                   down = 0xff54, up = 0xff52, space = ' ', tab = 0xff09;

/// Uses the program by the keyboard alone, as a user without a pointer does.
class KeyboardTests : public DriveTests {
protected:
    void expectKeyboardAt(const std::string& beginning)
    {
        EXPECT_TRUE(eventually([&] { return program->hasKeyboardAt(beginning); })) << beginning;
    }
    void expectDialog(bool isShown)
    {
        EXPECT_TRUE(eventually([&] { return program->dialogs().empty() != isShown; }));
    }
    /// Starts the program and goes to a document on the desktop.
    void goTo(const std::string& letters, const std::string& name)
    {
        start();
        expectKeyboardAt("Desktop");
        pressKey(returnKey);
        expectKeyboardAt("🎉 Birthdays");
        type(letters);
        expectKeyboardAt(name);
    }
    void expectKeyboardInEntry()
    {
        EXPECT_TRUE(eventually([this] {
            const auto entries = program->entries();
            return !entries.empty() && entries.back().isFocused();
        }));
    }
    /// Replaces the text in the entry.
    void replaceText(const std::string& text)
    {
        expectKeyboardInEntry();
        pressKey('a', Modifier::Control);
        type(text);
        EXPECT_TRUE(eventually([&] {
            const auto entries = program->entries();
            return !entries.empty() && entries.back().text() == text;
        }));
    }
};

TEST_F(KeyboardTests, LeadsThroughTheFolders)
{
    start();
    expectKeyboardAt("Desktop");
    pressKey(down);
    expectKeyboardAt("Documents");
    pressKey(returnKey);
    expectKeyboardAt("Household");
    // Assistive technology sees only the screen that is shown.
    EXPECT_FALSE(program->shows("Notebook"));
    EXPECT_EQ(program->buttons("Back").size(), 1);
    type("read");
    expectKeyboardAt("Reading notes");
    // Tab leaves the list, however many rows it has, and Shift+Tab returns to the row.
    pressKey(tab);
    expectKeyboardAt("Back");
    pressKey(tab, Modifier::Shift);
    expectKeyboardAt("Reading notes");
    pressKey(returnKey);
    EXPECT_TRUE(eventually([this] { return program->document().find("Dispossessed") != std::string::npos; }));
    pressKey(escape);
    expectKeyboardAt("Reading notes");
    pressKey(escape);
    expectKeyboardAt("Documents");
}

/// The keys come quicker than the screens appear, as from a user who knows the program by heart.
TEST_F(KeyboardTests, KeysThatComeAtOnceArriveWhereTheyWereMeant)
{
    goTo("to", "To do.txt");
    for (const auto dialog : {deleteKey, f2, f2}) {
        pressKey(dialog, dialog == deleteKey ? Modifier::Shift : Modifier::None);
        pressKey(escape);
        pressKey(f2);
        pressKey('a', Modifier::Control);
        type("chores");
        EXPECT_TRUE(eventually([this] {
            const auto entries = program->entries();
            return !entries.empty() && entries.back().text() == "chores";
        })) << (program->entries().empty() ? "" : program->entries().back().text());
        pressKey(escape);
        expectDialog(false);
        expectKeyboardAt("To do.txt");
    }
    pressKey('n', Modifier::ControlAndShift);
    type("Errands");
    pressKey(returnKey);
    expectShown("Errands");
    expectKeyboardAt("Errands");
    EXPECT_TRUE(std::filesystem::is_directory(top / "Desktop/Errands"));
    pressKey('f', Modifier::Control);
    type("house");
    pressKey(down);
    pressKey(returnKey);
    EXPECT_TRUE(eventually([this] { return program->shows("Receipts") && program->entries().empty(); }));
}

TEST_F(KeyboardTests, ADocumentIsRenamedOnceItsNameIsAccepted)
{
    std::ofstream(top / "Desktop/Errands.txt") << "Buy flour";
    goTo("to", "To do.txt");
    pressKey(f2);
    expectDialog(true);
    EXPECT_EQ(program->dialogs().front().name(), "Rename Item");
    replaceText("a/b");
    EXPECT_TRUE(eventually([this] { return program->says("Character not allowed in filename"); }));
    pressKey(returnKey);
    replaceText("Errands.txt");
    pressKey(returnKey);
    EXPECT_TRUE(eventually([this] { return program->says("Name is already taken"); }));
    replaceText("Chores.txt");
    pressKey(returnKey);
    expectDialog(false);
    expectShown("Chores.txt");
    EXPECT_FALSE(program->shows("To do.txt"));
    EXPECT_TRUE(std::filesystem::exists(top / "Desktop/Chores.txt"));
}

TEST_F(KeyboardTests, ADocumentIsSeenAndDeleted)
{
    goTo("pack", "Packing list.md");
    pressKey(menuKey);
    expectKeyboardAt("Info");
    pressKey(escape);
    expectGone("Info");
    expectKeyboardAt("Packing list.md");
    pressKey(space);
    expectDialog(true);
    EXPECT_TRUE(eventually([this] { return !program->document().empty(); }));
    pressKey(escape);
    expectDialog(false);
    expectKeyboardAt("Packing list.md");

    pressKey(deleteKey, Modifier::Shift);
    expectKeyboardAt("Cancel");
    pressKey(escape);
    expectDialog(false);
    EXPECT_TRUE(std::filesystem::exists(top / "Desktop/Packing list.md"));
    expectKeyboardAt("Packing list.md");
    pressKey(deleteKey, Modifier::Shift);
    expectKeyboardAt("Cancel");
    pressKey(up);
    expectKeyboardAt("Delete from Tarrow Drive");
    pressKey(returnKey);
    expectGone("Packing list.md");
    EXPECT_FALSE(std::filesystem::exists(top / "Desktop/Packing list.md"));
    expectKeyboardAt("Recipes");
}

TEST_F(KeyboardTests, ADocumentGoesToTheTrashAndComesBack)
{
    const auto document = top / "Desktop/Packing list.md";
    goTo("pack", "Packing list.md");
    pressKey(deleteKey);
    expectGone("Packing list.md");
    EXPECT_FALSE(std::filesystem::exists(document));
    EXPECT_TRUE(eventually([this] { return program->says("“Packing list.md” was moved to the trash"); }));
    pressKey('z', Modifier::Control);
    expectShown("Packing list.md");
    type("pack");
    expectKeyboardAt("Packing list.md");
    pressKey(deleteKey);
    expectGone("Packing list.md");
    // The first press takes the message away.
    pressKey(escape);
    if (!eventually([this] { return program->shows("1 in Trash"); }))
        pressKey(escape);
    program->pressUntil("1 in Trash", [this] { return program->shows("Empty Trash"); });
    expectKeyboardAt("Packing list.md");
    pressKey(returnKey);
    expectKeyboardAt("Restore");
    pressKey(returnKey);
    EXPECT_TRUE(eventually([this] { return program->says("The trash is empty"); }));
    EXPECT_TRUE(std::filesystem::exists(document));
    pressKey(escape);
    expectGone("Empty Trash");
    expectKeyboardAt("Desktop");
}

TEST_F(KeyboardTests, ReachesTheRowsFromTheSelectButton)
{
    const auto focused = [this] {
        std::string names;
        for (const auto& place : program->all([](const Accessible& node) { return node.isFocused(); }))
            names += place.roleName() + place.name();
        return names;
    };
    const auto tabTo = [&](const std::string& beginning) {
        for (int presses = 0; presses < 8 && !program->hasKeyboardAt(beginning); ++presses) {
            const auto before = focused();
            pressKey(tab);
            EXPECT_TRUE(eventually([&] { return focused() != before; }))
                << "the keyboard stays at " << before;
        }
        expectKeyboardAt(beginning);
    };
    start();
    expectKeyboardAt("Desktop");
    tabTo("Select");
    pressKey(returnKey);
    expectKeyboardAt("Cancel");
    tabTo("Desktop");
    pressKey(space);
    EXPECT_TRUE(eventually([this] { return program->says("1 Item Selected"); }));
}

} // namespace
} // namespace e2e
