// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/views/Button.h"
#include "kit/views/TapRecognizer.h"
#include "kit/views/TextField.h"

#include <gtest/gtest.h>

namespace kit {

namespace {

struct FieldDelegate : TextFieldDelegate {
    bool textFieldShouldChangeCharactersInRangeReplacementString(
        TextField&, const TextRange& range, const std::string& replacement) override
    {
        edits.emplace_back(range, replacement);
        return true;
    }
    std::vector<std::pair<TextRange, std::string>> edits;
};

struct NativeButton : ViewObserver {
    void viewDidChange(View&, ViewChanges) override { }
    std::optional<Size> nativeSize(const View&, double) override { return Size{62, 34}; }
};

} // namespace

TEST(TextField, AnEditReachesTheDelegateAsOneRangeInCharacters)
{
    const struct {
        const char *before, *after;
        TextRange range;
        std::string replacement;
    } rows[] = {{"", "a", {0, 0}, "a"}, {"abc", "abXc", {2, 0}, "X"}, {"abc", "ac", {1, 1}, ""},
        {"aaa", "aaaa", {3, 0}, "a"}, {"abc", "", {0, 3}, ""}, {"Größe", "Gröse", {3, 1}, "s"},
        {"é", "è", {0, 1}, "è"}};
    for (const auto& row : rows) {
        SCOPED_TRACE(row.after);
        const auto field = std::make_shared<TextField>(row.before);
        const auto delegate = std::make_shared<FieldDelegate>();
        field->setDelegate(delegate);
        int told = 0;
        field->setOnEditingChanged([&] { ++told; });
        EXPECT_TRUE(field->userEdited(row.after, {99, 99}));
        ASSERT_EQ(delegate->edits.size(), 1);
        EXPECT_EQ(delegate->edits.front(), std::pair(row.range, row.replacement));
        EXPECT_EQ(field->selectedRange(), (TextRange{field->length(), 0}));
        EXPECT_EQ(told, 1);
    }
}

TEST(TextField, SelectionsAreCutToTheText)
{
    const auto field = std::make_shared<TextField>("Größe");
    EXPECT_EQ(field->selectedRange(), (TextRange{5, 0}));
    field->setSelectedRange({3, 9});
    EXPECT_EQ(field->selectedRange(), (TextRange{3, 2}));
    field->setSelectedRange({9, 1});
    EXPECT_EQ(field->selectedRange(), (TextRange{5, 0}));
    field->setText("ab");
    EXPECT_EQ(field->selectedRange(), (TextRange{2, 0}));
}

TEST(Button, PressesOnlyWhatCanBePressed)
{
    int presses = 0;
    auto button = std::make_shared<Button>("Move");
    button->setAction([&] {
        ++presses;
        button.reset();
    });
    const std::weak_ptr<Button> weak = button;
    button->setEnabled(false);
    EXPECT_FALSE(button->press());
    button->setEnabled(true);
    button->setHidden(true);
    EXPECT_FALSE(button->press());
    button->setHidden(false);
    EXPECT_TRUE(button->press());
    EXPECT_EQ(presses, 1);
    EXPECT_TRUE(weak.expired());
}

TEST(Button, PrefersTheSizeOfItsNativeWidget)
{
    const auto button = std::make_shared<Button>("Move");
    button->setTitleFont(Font::preferred(TextStyle::Body, 10));
    button->sizeToFit();
    EXPECT_EQ(button->frame().size(), (Size{20 + 16, 12 + 12}));
    EXPECT_EQ(button->titleLabel()->frame(), (Rect{8, 6, 20, 12}));
    const auto peer = std::make_shared<NativeButton>();
    button->setObserver(peer);
    button->sizeToFit();
    EXPECT_EQ(button->frame().size(), (Size{62, 34}));
    EXPECT_EQ(button->titleLabel()->frame(), (Rect{21, 11, 20, 12}));
}

TEST(Gestures, ATapIsShortAndStaysInItsPlace)
{
    using namespace std::chrono_literals;
    int taps = 0;
    TapRecognizer tap([&](Point) { ++taps; });
    const auto tapsOf = [&](Point end, GestureRecognizer::Time duration) {
        tap.pressed({5, 5}, 0ms);
        tap.moved(end, duration / 2);
        tap.released(end, duration);
        return std::exchange(taps, 0);
    };
    EXPECT_EQ(tapsOf({6, 6}, 100ms), 1);
    EXPECT_EQ(tapsOf({40, 5}, 100ms), 0);
    EXPECT_EQ(tapsOf({6, 6}, 2000ms), 0);
    tap.setEnabled(false);
    EXPECT_EQ(tapsOf({6, 6}, 100ms), 0);
}

} // namespace kit
