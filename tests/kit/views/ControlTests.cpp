// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/values/KeyboardNotice.h"
#include "kit/values/TextMeasurer.h"
#include "kit/views/Button.h"
#include "kit/views/LongPressRecognizer.h"
#include "kit/views/ScrollView.h"
#include "kit/views/TapRecognizer.h"
#include "kit/views/TextField.h"

#include <gtest/gtest.h>

namespace kit {

namespace {

class FieldDelegate : public TextFieldDelegate {
public:
    bool textFieldShouldBeginEditing(TextField&) override { return mayBegin; }
    bool textFieldShouldEndEditing(TextField&) override { return mayEnd; }
    void textFieldDidEndEditing(TextField&) override { ++ends; }
    bool textFieldShouldReturn(TextField&) override
    {
        ++returns;
        return false;
    }
    bool textFieldShouldChangeCharactersInRangeReplacementString(
        TextField&, const TextRange& range, const std::string& replacement) override
    {
        edits.emplace_back(range, replacement);
        return replacement != "\n";
    }

    bool mayBegin = true, mayEnd = true;
    int ends = 0, returns = 0;
    std::vector<std::pair<TextRange, std::string>> edits;
};

class Recorder : public ViewObserver {
public:
    void viewDidChange(View&, ViewChanges changes) override { seen |= changes; }
    void viewWantsFocus(View&, bool focus) override { focusRequests.push_back(focus); }
    std::optional<Size> nativeSize(const View&, double) override { return size; }

    ViewChanges seen;
    std::vector<bool> focusRequests;
    std::optional<Size> size;
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

TEST(TextField, RefusedEditsAndEndsAreToldToThePeer)
{
    const auto field = std::make_shared<TextField>("name");
    const auto delegate = std::make_shared<FieldDelegate>();
    const auto peer = std::make_shared<Recorder>();
    field->setDelegate(delegate);
    field->setObserver(peer);

    delegate->mayBegin = false;
    EXPECT_FALSE(field->userFocused());
    delegate->mayBegin = true;
    EXPECT_TRUE(field->userFocused());
    peer->seen = {};
    EXPECT_FALSE(field->userEdited("na\nme", {3, 0}));
    EXPECT_EQ(field->text(), "name");
    EXPECT_TRUE(peer->seen.contains(ViewChange::Content));

    delegate->mayEnd = false;
    EXPECT_FALSE(field->userLeft());
    EXPECT_TRUE(field->isEditing());
    delegate->mayEnd = true;
    EXPECT_TRUE(field->resignFirstResponder());
    EXPECT_TRUE(field->userLeft());
    EXPECT_EQ(delegate->ends, 1);
    EXPECT_EQ(peer->focusRequests, (std::vector{false, true, true, false}));
}

TEST(TextField, TheReturnKeyMayNeedText)
{
    const auto field = std::make_shared<TextField>();
    const auto delegate = std::make_shared<FieldDelegate>();
    field->setDelegate(delegate);
    TextInputTraits traits;
    traits.returnKeyNeedsText = true;
    field->setInputTraits(traits);
    field->userPressedReturn();
    EXPECT_EQ(delegate->returns, 0);
    field->setText("x");
    field->userPressedReturn();
    EXPECT_EQ(delegate->returns, 1);
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
    const auto peer = std::make_shared<Recorder>();
    peer->size = {62, 34};
    button->setObserver(peer);
    button->sizeToFit();
    EXPECT_EQ(button->frame().size(), (Size{62, 34}));
    EXPECT_EQ(button->titleLabel()->frame(), (Rect{21, 11, 20, 12}));
}

TEST(ScrollView, ScrollsAsLittleAsNeeded)
{
    const auto view = std::make_shared<ScrollView>(Rect{0, 0, 100, 100});
    view->setContentSize({100, 1000});
    view->setContentInsets({10, 0, 20, 0});
    for (const auto& [y, expected] : {std::pair{50.0, 0.0}, {500.0, 440.0}, {480.0, 440.0}, {300.0, 290.0}}) {
        view->scrollRectToVisible({0, y, 100, 20}, false);
        EXPECT_EQ(view->contentOffset().y, expected) << y;
    }
    const auto inner = std::make_shared<View>(Rect{0, 300, 10, 10});
    view->addSubview(inner);
    EXPECT_EQ(inner->convertPoint({1, 1}, *view), (Point{1, 301}));
}

TEST(Gestures, TellATapFromALongPressAndADrag)
{
    using namespace std::chrono_literals;
    int taps = 0, presses = 0;
    TapRecognizer tap([&](Point) { ++taps; });
    LongPressRecognizer hold([&](Point) { ++presses; });
    const auto touch = [&](Point end, GestureRecognizer::Time duration) {
        for (GestureRecognizer* recognizer : std::initializer_list<GestureRecognizer*>{&tap, &hold}) {
            recognizer->pressed({5, 5}, 0ms);
            recognizer->moved(end, duration / 2);
            recognizer->released(end, duration);
        }
        return std::pair(std::exchange(taps, 0), std::exchange(presses, 0));
    };
    EXPECT_EQ(touch({6, 6}, 100ms), std::pair(1, 0));
    EXPECT_EQ(touch({40, 5}, 100ms), std::pair(0, 0));
    EXPECT_EQ(touch({6, 6}, 2000ms), std::pair(0, 1));
    EXPECT_EQ(touch({40, 5}, 2000ms), std::pair(0, 0));
    hold.pressed({}, 0ms);
    hold.held(499ms);
    hold.held(500ms);
    hold.held(900ms);
    EXPECT_EQ(presses, 1);
    tap.setEnabled(false);
    EXPECT_EQ(touch({6, 6}, 100ms), std::pair(0, 1));
}

TEST(Text, IsMeasuredInLinesOfWords)
{
    const auto& measurer = TextMeasurer::current();
    const Font font = Font::preferred(TextStyle::Body, 10);
    EXPECT_EQ(measurer.measure("Größe\nab", font, {}), (Size{25, 24}));
    EXPECT_EQ(measurer.measure("aaaa bbbb cc", font, {45, 0}), (Size{45, 24}));
    EXPECT_EQ(measurer.measure("aaaaaaaaaa", font, {20, 2}), (Size{20, 24}));
    AttributedText styled;
    styled.append(Image::fromPixels(8, 8, 1, std::vector<std::uint32_t>(64)));
    styled.append("ab", {font, {}, 0});
    EXPECT_EQ(measurer.measure(styled, Font::preferred(TextStyle::Body, 5), {}), (Size{18, 12}));
}

TEST(KeyboardNotice, SurvivesTheWayThroughUserInformation)
{
    const KeyboardNotice notice{{0, 640, 360, 250}, {0, 390, 360, 250}, 0.4, 2};
    EXPECT_EQ(KeyboardNotice::fromUserInfo(notice.toUserInfo()), notice);
    EXPECT_EQ(KeyboardNotice::fromUserInfo({{"height", 250}}).beginFrame.height, 250);
}

} // namespace kit
