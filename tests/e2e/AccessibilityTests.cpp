// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "DriveTests.h"

#include <gmock/gmock.h>

#include <regex>

namespace e2e {
namespace {

/// The rows that lead to documents of the sample drive, and a button in each one's preview.
const struct {
    std::vector<std::string> rows;
    std::string control;
} previews[] = {
    {{"To do.txt"}, "Search in document"},
    {{"Photos", "Biscuit the cat.png"}, "Smaller"},
    {{"Sunrise.avi"}, "Play"},
    {{"Documents", "Tickets", "Night train"}, "Search in document"},
};

/// Checks what a user of a screen reader hears.
class AccessibilityTests : public DriveTests {
protected:
    /// Checks that every widget that can take the keyboard focus has a name.
    void expectNames(const std::string& state) const
    {
        // The toolkit names a widget without a name after its class.
        static const std::regex className("((Gtk|Adw|Trw)[A-Z][A-Za-z]*)?");
        const auto isUnnamed = [](const Accessible& node) {
            return node.isFocusable() && std::regex_match(node.name(), className);
        };
        for (const auto& node : program->all(isUnnamed))
            ADD_FAILURE() << state << ": a " << node.roleName() << " is called \"" << node.name() << '"';
    }
    void expectNamesOnce(const std::string& shown)
    {
        expectShown(shown);
        expectNames(shown);
    }
    void expectNamesInMenuEntry(const std::string& row, const std::string& entry, const std::string& shown)
    {
        EXPECT_TRUE(program->buttons(row).back().perform("row.menu"));
        program->press(entry);
        expectNamesOnce(shown);
        program->pressUntil("Cancel", [&] { return !program->shows(shown); });
    }
};

TEST_F(AccessibilityTests, EveryPlaceOfTheKeyboardHasAName)
{
    start();
    expectNamesOnce("Desktop");
    program->press("Desktop");
    expectNamesOnce("To do.txt");
    for (const auto& [entry, shown] : {std::pair{"Share", "Copy Path"}, std::pair{"Rename", "Done"},
             std::pair{"Move", "Move Here"}, std::pair{"Delete", "Delete from Tarrow Drive"}})
        expectNamesInMenuEntry("To do.txt", entry, shown);
    EXPECT_TRUE(program->buttons("To do.txt").back().perform("row.peek"));
    expectNamesOnce("Open");
    program->pressUntil("Cancel", [&] { return !program->shows("Open"); });
    program->pressUntil("Select", [&] { return program->shows("New Folder"); });
    expectNames("edit mode");
    program->pressUntil("Cancel", [&] { return program->shows("Select"); });
    program->pressUntil("Search", [this] { return !program->entries().empty(); });
    expectNames("search");
    EXPECT_TRUE(program->entries().back().enter("pattern"));
    expectNamesOnce("Pattern");
    program->pressUntil("Cancel", [this] { return program->entries().empty(); });
    for (const auto& [rows, control] : previews) {
        program->pressUntil("Back", [&] { return program->shows(rows.front()); });
        for (const auto& row : rows)
            program->press(row);
        expectNamesOnce(control);
    }
}

} // namespace
} // namespace e2e
