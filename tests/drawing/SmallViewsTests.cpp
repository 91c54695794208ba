// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "drawing/ConstraintUtils.h"
#include "drawing/HairlineView.h"
#include "drawing/PieProgressIndicatorView.h"
#include "drawing/ThumbnailImageView.h"
#include "items/DRItem.h"
#include "kit/values/Canvas.h"
#include "kit/values/Screen.h"
#include "kit/views/ImageView.h"
#include "tests/support/DriveFixture.h"

#include <numbers>

namespace tarrow {
namespace {

using namespace testing;
using kit::View;
using platform::Image;
using platform::Rect;
using platform::Size;

constexpr kit::TraitCollection phone{kit::SizeClass::Compact, kit::SizeClass::Regular};
constexpr kit::TraitCollection tablet{kit::SizeClass::Regular, kit::SizeClass::Regular};

Image imageOf(int width, int height)
{
    return Image::fromPixels(width, height, 1, {});
}

class Thumbnails : public testing::Test {
protected:
    Thumbnails() { view->overrideTraits(phone); }

    std::shared_ptr<DRItem> itemWith(std::optional<Image> thumbnail) const
    {
        auto item = DRItem::initWithURL(drive.writeDocument("Notes.txt"));
        item->setThumbnail(std::move(thumbnail));
        item->setThumbnailFetched(true);
        return item;
    }
    const kit::ImageView& show(std::optional<Image> thumbnail) const
    {
        view->setItem(itemWith(std::move(thumbnail)));
        view->layoutIfNeeded();
        return *view->thumbnailView();
    }

    testing_support::DriveFixture drive;
    std::shared_ptr<ThumbnailImageView> view = ThumbnailImageView::initWithFrame({0, 0, 300, 300});
};

TEST_F(Thumbnails, AnImageFitsIntoTheMarginAndStaysInTheMiddle)
{
    const struct {
        const char* what;
        int width, height;
        Rect place;
    } rows[] = {
        {"wide", 100, 50, {17, 83.5, 266, 133}},
        {"high", 100, 200, {83.5, 17, 133, 266}},
        {"large", 1024, 1024, {17, 17, 266, 266}},
        {"tiny, enlarged eight times", 10, 10, {110, 110, 80, 80}},
    };
    for (const auto& row : rows) {
        const auto& image = show(imageOf(row.width, row.height));
        EXPECT_NEAR(image.frame().x, row.place.x, 1e-4) << row.what;
        EXPECT_NEAR(image.frame().y, row.place.y, 1e-4) << row.what;
        EXPECT_NEAR(image.frame().width, row.place.width, 1e-4) << row.what;
        EXPECT_NEAR(image.frame().height, row.place.height, 1e-4) << row.what;
        EXPECT_FALSE(view->isGenericImage());
        EXPECT_EQ(image.style().borderWidth, 1) << row.what;
    }
}

TEST_F(Thumbnails, AnItemWithoutAThumbnailShowsTheIconOfItsType)
{
    for (const auto& none : {std::optional<Image>(), std::optional(imageOf(10, 0))}) {
        show(imageOf(10, 10));
        const auto& image = show(none);
        EXPECT_TRUE(view->isGenericImage());
        ASSERT_TRUE(image.image());
        EXPECT_EQ(image.image()->iconName(), "text-x-generic");
        EXPECT_EQ(image.style().borderWidth, 0);
        const auto size = image.image()->size();
        EXPECT_GT(size.width, 0);
        EXPECT_EQ(
            image.frame(), (Rect{150 - size.width, 150 - size.height, 2 * size.width, 2 * size.height}));
    }
    view->setItem(nullptr);
    EXPECT_TRUE(view->thumbnailView()->image()) << "without an item the image stays";
}

TEST_F(Thumbnails, MuchRoomHasALargerMargin)
{
    EXPECT_EQ(view->margins(), 17);
    for (const auto size : {kit::SizeClass::Compact, kit::SizeClass::Regular}) {
        view->overrideTraits(kit::TraitCollection{kit::SizeClass::Regular, size});
        EXPECT_EQ(view->margins(), size == kit::SizeClass::Regular ? 45 : 17);
    }
}

TEST(Hairline, IsAsThickAsAPixelAndFollowsTheDisplay)
{
    const auto show = [](double scale) {
        kit::Screen::setMain(kit::Screen{{0, 0, 100, 100}, scale, kit::UserInterfaceIdiom::Phone, {}});
        auto traits = phone;
        traits.displayScale = scale;
        return traits;
    };
    const auto root = std::make_shared<View>(Rect{0, 0, 100, 100});
    root->overrideTraits(show(1));
    const auto line = HairlineView::init();
    root->addSubview(line);
    kit::LayoutConstraint::activate(
        {line->topAnchor().equalTo(root->topAnchor()), line->leadingAnchor().equalTo(root->leadingAnchor()),
            line->widthAnchor().equalTo(root->widthAnchor())});
    for (const double scale : {1.0, 2.0, 3.0, 1.0}) {
        root->overrideTraits(show(scale));
        root->layoutIfNeeded();
        EXPECT_DOUBLE_EQ(line->frame().height, 1 / scale);
        EXPECT_DOUBLE_EQ(line->_hairlineThicknessInPoints(), 1 / scale);
    }
    kit::Screen::setMain(std::nullopt);
}

class RecordingCanvas : public kit::Canvas {
public:
    void setFillColor(const platform::Color&) override { }
    void setStrokeColor(const platform::Color&) override { }
    void setLineWidth(double) override { }
    void fillRect(const Rect&) override { }
    void strokeRect(const Rect&) override { }
    void fillEllipse(const Rect&) override { }
    void strokeEllipse(const Rect& rect) override { ellipse = rect; }
    void fillPie(const kit::Pie& drawn) override { pie = drawn; }
    void strokeArc(const kit::Pie&) override { }
    void drawImage(const Image&, const Rect&) override { }
    void drawText(std::string_view, const kit::Font&, platform::Point) override { }

    kit::Pie pie;
    Rect ellipse;
};

class DisplayCounter : public kit::ViewObserver {
public:
    void viewDidChange(View&, kit::ViewChanges changes) override
    {
        count += changes.contains(kit::ViewChange::Display) ? 1 : 0;
    }
    void viewWantsFocus(View&, bool) override { }
    int count = 0;
};

TEST(Pie, IsNeverEmptyAndNeverFull)
{
    const auto pie = PieProgressIndicatorView::initWithFrame({0, 0, 40, 31});
    const auto observer = std::make_shared<DisplayCounter>();
    pie->setObserver(observer);
    const struct {
        float progress;
        double share;
    } rows[] = {{0, 0.005}, {0.25F, 0.25}, {1, 0.995}, {7, 0.995}, {-1, 0.005}};
    for (const auto& row : rows) {
        pie->setProgress(row.progress);
        RecordingCanvas canvas;
        pie->drawRect(canvas);
        EXPECT_EQ(canvas.pie.center, (platform::Point{20, 15.5}));
        EXPECT_EQ(canvas.pie.radius, 16);
        EXPECT_DOUBLE_EQ(canvas.pie.startAngle, -std::numbers::pi / 2);
        EXPECT_NEAR(canvas.pie.endAngle - canvas.pie.startAngle, row.share * 2 * std::numbers::pi, 1e-6);
        EXPECT_EQ(canvas.ellipse, (Rect{0, 0, 40, 31}));
    }
    const int before = observer->count;
    pie->setProgress(-1);
    EXPECT_EQ(observer->count, before) << "the same progress is not drawn again";
    pie->setProgress(0.5F);
    EXPECT_EQ(observer->count, before + 1);
}

TEST(Constraints, StackTwoViewsAndStretchOne)
{
    const auto parent = std::make_shared<View>(Rect{0, 0, 100, 90});
    const auto top = std::make_shared<View>(), bottom = std::make_shared<View>(),
               inside = std::make_shared<View>();
    for (const auto& view : {top, bottom, inside}) {
        view->setPlacedByFrame(false);
        parent->addSubview(view);
    }
    const auto stacked = ConstraintUtils::verticallyStackedConstraintsInParentTopChildBottomChildMiddleGap(
        parent, top, bottom, 6);
    const auto stretched = ConstraintUtils::stretchSubviewConstraintsWithinView(inside, parent);
    EXPECT_EQ(stacked.size(), 7U);
    EXPECT_EQ(stretched.size(), 4U);
    kit::LayoutConstraint::activate(stacked);
    kit::LayoutConstraint::activate(stretched);
    kit::LayoutConstraint::activate({top->widthAnchor().equalToConstant(40),
        top->heightAnchor().equalToConstant(24), bottom->widthAnchor().equalToConstant(60)});
    parent->layoutIfNeeded();
    EXPECT_EQ(top->frame(), (Rect{30, 0, 40, 24}));
    EXPECT_EQ(bottom->frame(), (Rect{20, 30, 60, 60}));
    EXPECT_EQ(inside->frame(), (Rect{0, 0, 100, 90}));
}

} // namespace
} // namespace tarrow
