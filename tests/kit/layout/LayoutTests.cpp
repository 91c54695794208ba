// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/layout/LayoutConstraint.h"
#include "kit/layout/VisualFormat.h"
#include "kit/values/Screen.h"
#include "kit/views/Button.h"
#include "kit/views/Label.h"
#include "kit/views/StackView.h"
#include "tests/support/RecordingLog.h"

#include <gtest/gtest.h>

#include <ostream>

namespace platform {

void PrintTo(const Size& size, std::ostream* out)
{
    *out << size.width << " x " << size.height;
}

void PrintTo(const Rect& rect, std::ostream* out)
{
    *out << "{" << rect.x << ", " << rect.y << ", " << rect.width << ", " << rect.height << "}";
}

} // namespace platform

namespace kit {

namespace {

using testing::Test;

std::shared_ptr<View> constrained(View& parent)
{
    auto view = std::make_shared<View>();
    view->setPlacedByFrame(false);
    parent.addSubview(view);
    return view;
}

std::shared_ptr<Label> label(View& parent, const std::string& text)
{
    auto made = std::make_shared<Label>(text);
    made->setPlacedByFrame(false);
    made->setFont(Font::preferred(TextStyle::Body, 10)); // characters of 5 points, lines of 12
    parent.addSubview(made);
    return made;
}

class Layout : public Test {
protected:
    void TearDown() override
    {
        TraitCollection::setApplication({});
        Screen::setMain(std::nullopt);
        installLogSink(nullptr);
    }

    void format(
        const std::string& text, std::map<std::string, std::shared_ptr<LayoutItem>, std::less<>> views)
    {
        const auto result = VisualFormat::parse(text, {std::move(views), {{"gap", 12}}});
        ASSERT_FALSE(result.error) << result.error->message;
        LayoutConstraint::activate(result.constraints);
    }

    std::shared_ptr<View> root = std::make_shared<View>(Rect{0, 0, 360, 640});
};

} // namespace

TEST_F(Layout, FollowsTheRootAndChangedConstants)
{
    const auto a = constrained(*root), b = constrained(*root);
    format("H:|-16-[a]-gap-[b(==a)]-|", {{"a", a}, {"b", b}});
    format("V:|[a(44)]", {{"a", a}});
    const auto top = b->topAnchor().equalTo(a->bottomAnchor(), 8);
    LayoutConstraint::activate({top, b->bottomAnchor().equalTo(root->bottomAnchor())});
    root->layoutIfNeeded();
    EXPECT_EQ(a->frame(), (Rect{16, 0, 156, 44}));
    EXPECT_EQ(b->frame(), (Rect{184, 52, 156, 588}));

    root->setFrame({0, 0, 640, 360});
    top->setConstant(-4);
    root->layoutIfNeeded();
    EXPECT_EQ(a->frame(), (Rect{16, 0, 296, 44}));
    EXPECT_EQ(b->frame(), (Rect{324, 40, 296, 320}));
}

TEST_F(Layout, MirrorsReadingDirectionOnly)
{
    const auto a = constrained(*root), b = constrained(*root), fixed = constrained(*root);
    format("H:|-16-[a(50)]-(>=8)-[b(30)]", {{"a", a}, {"b", b}});
    LayoutConstraint::activate({b->trailingAnchor().equalTo(root->trailingAnchor(), -20),
        fixed->leftAnchor().equalTo(root->leftAnchor(), 5), fixed->widthAnchor().equalToConstant(10)});
    root->layoutIfNeeded();
    EXPECT_EQ(a->frame().x, 16);
    EXPECT_EQ(b->frame().x, 310);

    TraitCollection rightToLeft;
    rightToLeft.layoutDirection = LayoutDirection::RightToLeft;
    root->overrideTraits(rightToLeft);
    root->layoutIfNeeded();
    EXPECT_EQ(a->frame().x, 360 - 16 - 50);
    EXPECT_EQ(b->frame().x, 20);
    EXPECT_EQ(fixed->frame().x, 5);
}

TEST_F(Layout, ReachesAcrossLevelsWithFramesAndConstraintsMixed)
{
    const auto placed = std::make_shared<View>(Rect{30, 40, 200, 100});
    root->addSubview(placed);
    const auto inner = constrained(*placed), outer = constrained(*root);
    LayoutConstraint::activate({inner->leftAnchor().equalTo(placed->leftAnchor(), 5),
        inner->widthAnchor().equalTo(placed->widthAnchor(), -20, 0.5),
        outer->leftAnchor().equalTo(inner->rightAnchor(), 7),
        outer->topAnchor().equalTo(inner->bottomAnchor()),
        inner->bottomAnchor().equalTo(placed->bottomAnchor())});
    root->layoutIfNeeded();
    EXPECT_EQ(inner->frame().width, 80);
    EXPECT_EQ(outer->frame().x, 30 + 5 + 80 + 7);
    EXPECT_EQ(outer->frame().y, 140);

    placed->setFrame({50, 0, 100, 100});
    root->layoutIfNeeded();
    EXPECT_EQ(outer->frame().x, 50 + 5 + 30 + 7);
}

TEST_F(Layout, HuggingAndResistanceDecideWhoYields)
{
    const auto name = label(*root, "Name"), value = label(*root, std::string(100, 'x'));
    name->setHugging(251, Axis::Horizontal);
    value->setCompressionResistance(250, Axis::Horizontal);
    format("H:|[name]-10-[value]|", {{"name", name}, {"value", value}});
    root->layoutIfNeeded();
    EXPECT_EQ(name->frame().width, 20);
    EXPECT_EQ(value->frame().width, 330);

    value->setText("short");
    root->layoutIfNeeded();
    EXPECT_EQ(name->frame().width, 20);

    name->setHugging(249, Axis::Horizontal);
    root->layoutIfNeeded();
    EXPECT_EQ(value->frame().width, 25);
    EXPECT_EQ(name->frame().width, 325);
}

TEST_F(Layout, WrappedTextTakesTheHeightForItsWidth)
{
    const auto text = label(*root, "aaaa bbbb cccc dddd");
    text->setMaxLines(0);
    const auto width = text->widthAnchor().equalToConstant(50);
    width->setActive(true);
    const auto below = constrained(*root);
    format("V:|[text][below(1)]", {{"text", text}, {"below", below}});
    root->layoutIfNeeded();
    EXPECT_EQ(below->frame().y, 24);
    width->setConstant(20);
    root->layoutIfNeeded();
    EXPECT_EQ(below->frame().y, 48);
}

TEST_F(Layout, AContradictionIsLoggedDroppedAndTriedAgain)
{
    const auto log = testing_support::RecordingLog::install();
    const auto a = constrained(*root);
    a->setDebugName("a");
    const auto first = a->widthAnchor().equalToConstant(100);
    const auto second = a->widthAnchor().equalToConstant(200);
    LayoutConstraint::activate({first, second});
    root->layoutIfNeeded();
    EXPECT_EQ(a->frame().width, 100);
    EXPECT_EQ(
        log->count("WARNING Ignored, as it contradicts other required constraints: a.width = 200 @1000"), 1);
    first->setActive(false);
    root->layoutIfNeeded();
    EXPECT_EQ(a->frame().width, 200);
}

TEST_F(Layout, AWindowWithoutASizeBreaksNothing)
{
    root->setFrame({});
    const auto a = constrained(*root);
    format("H:|-16-[a]-16-|", {{"a", a}});
    root->layoutIfNeeded();
    EXPECT_EQ(a->frame().width, 0);
    root->setFrame({0, 0, 360, 640});
    root->layoutIfNeeded();
    EXPECT_EQ(a->frame(), (Rect{16, 0, 328, 0}));
}

TEST_F(Layout, TakingAViewOutEndsItsTiesToTheRest)
{
    const auto a = constrained(*root), inner = constrained(*a);
    const auto tie = root->bottomAnchor().equalTo(a->bottomAnchor());
    const auto inside = inner->widthAnchor().equalTo(a->widthAnchor());
    LayoutConstraint::activate({tie, inside, a->widthAnchor().equalTo(root->widthAnchor())});
    root->layoutIfNeeded();
    EXPECT_EQ(inner->frame().width, 360);
    a->removeFromSuperview();
    EXPECT_FALSE(tie->isActive());
    EXPECT_TRUE(inside->isActive());
    root->setFrame({0, 0, 100, 100});
    root->layoutIfNeeded();
    EXPECT_EQ(inner->frame().width, 360);
}

TEST_F(Layout, ATreeThatWasLaidOutEndsWithItsOwner)
{
    auto view = std::make_shared<View>(Rect{0, 0, 100, 100});
    view->addSubview(std::make_shared<View>());
    view->layoutIfNeeded();
    const std::weak_ptr<View> outer = view, inside = view->subviews().front();
    view = nullptr;
    EXPECT_TRUE(outer.expired());
    EXPECT_TRUE(inside.expired());
}

TEST_F(Layout, FramesLieOnDevicePixels)
{
    Screen screen;
    screen.scale = 2;
    Screen::setMain(screen);
    const auto a = constrained(*root), b = constrained(*root), line = constrained(*root);
    root->setFrame({0, 0, 101.25, 100});
    format("H:|[a][b(==a)]|", {{"a", a}, {"b", b}});
    format("V:|-10.3-[line(0.5)]", {{"line", line}});
    root->layoutIfNeeded();
    EXPECT_EQ(a->frame().maxX(), 50.5);
    EXPECT_EQ(b->frame().x, 50.5);
    EXPECT_EQ(line->frame().height, 0.5);
}

namespace {

/// Asks for another size at every layout.
class Restless : public View {
public:
    void layoutSubviews() override
    {
        ++layouts;
        invalidateIntrinsicContentSize();
    }
    Size intrinsicContentSize(double) const override { return {10.0 + layouts % 7, 10}; }
    int layouts = 0;
};

} // namespace

TEST_F(Layout, EndsThoughAViewNeverSettles)
{
    const auto log = testing_support::RecordingLog::install();
    root->setDebugName("root");
    const auto view = std::make_shared<Restless>();
    view->setPlacedByFrame(false);
    root->addSubview(view);
    root->layoutIfNeeded();
    EXPECT_EQ(log->count("WARNING The layout of root does not settle"), 1);
    EXPECT_LT(view->layouts, 50);
}

/// A stack of 200 by 100 with a spacing of 10 holds views that want 40 by 12 and 20 by 12.
TEST_F(Layout, AStackArrangesItsViewsAndLeavesHiddenOnesOut)
{
    const struct {
        const char* name;
        Axis axis;
        StackAlignment alignment;
        StackDistribution distribution;
        Rect first, second;
    } rows[] = {
        {"row, fill", Axis::Horizontal, StackAlignment::Fill, StackDistribution::Fill, {0, 0, 40, 100},
            {50, 0, 150, 100}},
        {"row, centre", Axis::Horizontal, StackAlignment::Center, StackDistribution::FillEqually,
            {0, 44, 95, 12}, {105, 44, 95, 12}},
        {"row, trailing", Axis::Horizontal, StackAlignment::Trailing, StackDistribution::Fill,
            {0, 88, 40, 12}, {50, 88, 150, 12}},
        {"column, leading", Axis::Vertical, StackAlignment::Leading, StackDistribution::Fill, {0, 0, 40, 12},
            {0, 22, 20, 78}},
        {"column, centre", Axis::Vertical, StackAlignment::Center, StackDistribution::FillEqually,
            {80, 0, 40, 45}, {90, 55, 20, 45}},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.name);
        const auto stack = std::make_shared<StackView>(row.axis);
        stack->setFrame({0, 0, 200, 100});
        stack->setSpacing(10);
        stack->setStackAlignment(row.alignment);
        stack->setDistribution(row.distribution);
        const auto first = label(*stack, "12345678"), hidden = label(*stack, "hidden"),
                   second = label(*stack, "1234");
        second->setHugging(249, Axis::Horizontal);
        second->setHugging(249, Axis::Vertical);
        for (const auto& view : {first, hidden, second})
            stack->addArrangedSubview(view);
        stack->layoutIfNeeded();
        hidden->setHidden(true);
        stack->layoutIfNeeded();
        EXPECT_EQ(first->frame(), row.first);
        EXPECT_EQ(second->frame(), row.second);

        second->removeFromSuperview();
        stack->layoutIfNeeded();
        const bool isRow = row.axis == Axis::Horizontal;
        EXPECT_EQ(isRow ? first->frame().width : first->frame().height, isRow ? 200 : 100);
    }
}

TEST_F(Layout, AStackIsAsSmallAsItsContent)
{
    const auto column = std::make_shared<StackView>(Axis::Vertical);
    column->setPlacedByFrame(false);
    root->addSubview(column);
    for (const auto* text : {"1234", "12345678"})
        column->addArrangedSubview(label(*column, text));
    root->layoutIfNeeded();
    EXPECT_EQ(column->frame().size(), (Size{40, 24}));
}

TEST(VisualFormat, NamesThePlaceOfAMistakeAndMakesNothing)
{
    const auto root = std::make_shared<View>();
    const auto a = constrained(*root);
    const std::pair<const char*, std::size_t> rows[] = {{"", 0}, {"|", 1}, {"H:[b]", 3}, {"H:|-[a", 6},
        {"[a]-", 4}, {"[a]-x-[a]", 4}, {"[a(>=)]", 5}, {"[a(>=5@1001)]", 7}, {"[a(50]", 5}, {"|[a]|[a]", 5},
        {"|[loose]", 8}, {"H:|-16-[a]=|", 10}, {"[a]-(==a)-[a]", 13}, {"[a(inf)]", 3}, {"[a]-nan-[a]", 4}};
    for (const auto& [format, position] : rows) {
        const auto result =
            VisualFormat::parse(format, {{{"a", a}, {"loose", std::make_shared<View>()}}, {}});
        ASSERT_TRUE(result.error) << format;
        EXPECT_EQ(result.error->position, position) << format << ": " << result.error->message;
        EXPECT_TRUE(result.constraints.empty()) << format;
    }
}

TEST(VisualFormat, ReadsEveryForm)
{
    const auto root = std::make_shared<View>();
    const auto a = constrained(*root), b = constrained(*root);
    a->setDebugName("a");
    b->setDebugName("b");
    root->setDebugName("root");
    const auto result = VisualFormat::parse("H:|-[a(>=50@750,<=b)]-(>=gap,<=infoGap@700)-[b(30)]-4.5-|",
        {{{"a", a}, {"b", b}}, {{"gap", 3}, {"infoGap", 20}}, LayoutAttribute::CenterY});
    ASSERT_FALSE(result.error) << result.error->message;
    std::vector<std::string> texts;
    for (const auto& constraint : result.constraints)
        texts.push_back(constraint->description());
    const std::vector<std::string> expected{"a.width >= 50 @750", "a.width <= b.width * 1 + 0 @1000",
        "a.leading = root.leading * 1 + 20 @1000", "b.width = 30 @1000",
        "b.leading >= a.trailing * 1 + 3 @1000", "b.leading <= a.trailing * 1 + 20 @700",
        "root.trailing = b.trailing * 1 + 4.5 @1000", "b.centerY = a.centerY * 1 + 0 @1000"};
    EXPECT_EQ(texts, expected);
}

} // namespace kit
