// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "../support/FormPdf.h"
#include "DriveTests.h"
#include "TouchScreen.h"

#include <gmock/gmock.h>

#include <fstream>
#include <iterator>

namespace e2e {
namespace {

constexpr double width = 360, height = 720; ///< size of the display

/// Uses the program by touch alone, in a window as small as a phone.
class TouchTests : public DriveTests {
protected:
    void SetUp() override
    {
        DriveTests::SetUp();
        environment["DISPLAY"] = getenv("TRW_TOUCH_DISPLAY");
        ASSERT_TRUE(screen().isConnected());
        start();
        expectShown("Documents");
    }
    void TearDown() override
    {
        screen().liftAll();
        DriveTests::TearDown();
    }

    /// The server takes one connection in its life, so all tests share it.
    static TouchScreen& screen()
    {
        static TouchScreen fingers(getenv("TRW_TOUCH_SOCKET"), width, height);
        return fingers;
    }
    /// Answers the middle of the frontmost button whose name begins so, once it has stopped moving.
    Place placeOf(const std::string& beginning)
    {
        Place place;
        EXPECT_TRUE(eventually([&] {
            const auto found = program->buttons(beginning);
            const auto last = place;
            place = found.empty() ? Place() : found.back().middle();
            return place.x > 0 && place.x < width && place.x == last.x && place.y == last.y;
        })) << beginning;
        return place;
    }
    void tap(const std::string& beginning) { screen().tap(placeOf(beginning)); }
};

TEST_F(TouchTests, AFingerThatMovesOpensNothingAndASwipeGoesBack)
{
    tap("Documents");
    expectShown("Household");
    const auto [x, y] = placeOf("Letters");
    const TouchScreen::Path strays[] = {
        {{x, y}, {x, y - 100}}, {{x, y}, {x, y + 250}}, {{x + 100, y}, {x - 60, y}}};
    for (const auto& path : strays) {
        screen().flick(path);
        screen().drag(path);
    }
    screen().put(0, {x, y});
    screen().put(1, placeOf("Tickets"));
    screen().lift(0);
    screen().lift(1);
    // The swipe is begun and taken back, so the screen stays.
    screen().draw({{{x, y}, {x + 150, y}}});
    screen().move(0, {x, y});
    screen().lift(0);
    expectShown("Household");
    EXPECT_EQ(placeOf("Letters").x, x);
    screen().drag({{x - 100, y}, {x + 150, y}});
    expectShown("Notebook");
    expectGone("Back");
}

TEST_F(TouchTests, AHeldFingerPeeksAndPressesOn)
{
    screen().put(0, placeOf("Notebook"));
    expectShown("Open");
    screen().lift(0);
    expectShown("Open");
    tap("Cancel"); // on a small window the menu of a peek leaves no place beside it
    expectGone("Open");
    expectShown("Documents");
    EXPECT_FALSE(program->shows("Back")) << "the finger that put the peek away opened something";

    screen().put(0, placeOf("Documents"));
    expectShown("Open");
    expectShown("Back");
    screen().lift(0);
    expectShown("Household");
    EXPECT_TRUE(program->dialogs().empty());
}

TEST_F(TouchTests, FingersFillInAFormAndMarkATextThatIsSavedOnLeaving)
{
    const auto form = top / "Form.pdf";
    std::ofstream(form) << testing_support::formPdf();
    tap("Form.pdf");
    tap("Edit document");
    tap("Next field");
    const auto isWritingIn = [this](const char* name) {
        const auto entries = program->entries();
        return !entries.empty() && entries.back().name() == name && entries.back().isFocused();
    };
    ASSERT_TRUE(eventually([&] { return isWritingIn("Your name"); }));
    EXPECT_TRUE(program->entries().back().enter("Ada"));
    tap("Next field");
    tap("agree: Off");
    expectShown("agree: On");
    tap("Previous field");
    program->press("Done");
    tap("Edit document");

    const auto canHighlight = [this] {
        const auto found = program->buttons("Highlight");
        return !found.empty() && found.back().isSensitive();
    };
    expectShown("Highlight");
    EXPECT_FALSE(canHighlight());
    // This is the height of the line of text in a page as wide as the window. A finger that rests there
    // selects text.
    const double line = 482;
    screen().put(0, {80, line});
    ASSERT_TRUE(eventually(canHighlight));
    screen().move(0, {150, line});
    screen().move(0, {240, line});
    screen().lift(0);
    tap("Highlight");
    EXPECT_TRUE(eventually([&] { return !canHighlight(); }));
    tap("Add a note");
    screen().tap({width / 2, 340});
    ASSERT_TRUE(eventually([&] { return isWritingIn("Note"); }));
    EXPECT_TRUE(program->entries().back().enter("Ask Ada\nabout it"));
    tap("Done");
    EXPECT_TRUE(eventually([this] { return program->dialogs().empty(); }));
    tap("Back");
    const auto holds = [&](const std::string& text) {
        std::ifstream file(form, std::ios::binary);
        const std::string bytes{std::istreambuf_iterator<char>(file), {}};
        return bytes.find(text) != std::string::npos;
    };
    EXPECT_TRUE(eventually([&] { return holds("(Ada)") && holds("/Highlight") && holds("/Subtype /Text"); }));
}

TEST_F(TouchTests, AFingerAlongTheMarksSelectsARange)
{
    tap("Documents");
    placeOf("Household");
    tap("Select");
    expectShown("Cancel");
    const double mark = 25;
    screen().drag({{mark, placeOf("Household").y}, {mark, placeOf("Letters").y}});
    EXPECT_TRUE(eventually([this] { return program->says("3 Items Selected"); }));
    screen().drag({{mark, placeOf("Household").y}, {mark, placeOf("Ideas for later").y}});
    EXPECT_TRUE(eventually([this] { return program->says("1 Item Selected"); }));
    tap("Letters");
    EXPECT_TRUE(eventually([this] { return program->says("Select Items"); }));
}

TEST_F(TouchTests, ATapBesideClosesWhatLiesOverTheScreen)
{
    const Place outside{8, height / 2}; // a menu leaves the edge of the window free
    tap("Order and Options");
    expectShown("Name");
    screen().tap(outside);
    expectGone("Name");
    EXPECT_FALSE(program->shows("Back"));
}

TEST_F(TouchTests, TwoFingersZoomAPicture)
{
    tap("Photos");
    tap("Biscuit the cat.png");
    const auto canZoomOut = [this] {
        const auto buttons = program->buttons("Smaller");
        return !buttons.empty() && buttons.back().isSensitive();
    };
    expectShown("Smaller");
    const Place middle{width / 2, height / 2};
    EXPECT_FALSE(canZoomOut());
    screen().draw({{{middle.x - 30, middle.y}, {middle.x - 120, middle.y}},
        {{middle.x + 30, middle.y}, {middle.x + 120, middle.y}}});
    screen().liftAll();
    EXPECT_TRUE(eventually(canZoomOut));
    screen().tap(middle);
    screen().tap(middle);
    EXPECT_TRUE(eventually([&] { return !canZoomOut(); }));
}

TEST_F(TouchTests, AListMayChangeUnderAFinger)
{
    tap("Desktop");
    const auto place = placeOf("Packing list.md");
    screen().put(0, place);
    std::ofstream(top / "Desktop/A first one.txt") << "new";
    EXPECT_TRUE(eventually([&] { return placeOf("Packing list.md").y > place.y; }));
    screen().lift(0);
    // The document under the finger's first place opens, wherever the finger is now.
    EXPECT_TRUE(eventually([this] { return program->document().find("sweater") != std::string::npos; }));
}

} // namespace
} // namespace e2e
