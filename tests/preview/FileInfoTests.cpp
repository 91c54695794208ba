// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "drawing/FileTags.h"
#include "host/system/drawing/CairoImageContext.h"
#include "items/DRItem.h"
#include "items/FileUtils.h"
#include "kit/values/ImageContext.h"
#include "kit/views/Label.h"
#include "preview/FileInfoStackView.h"
#include "tests/support/DriveFixture.h"

namespace tarrow {
namespace {

using namespace testing;
using platform::DateStyle;
using Lines = std::vector<std::string>;

class FileInfo : public testing::Test {
protected:
    FileInfo()
    {
        kit::ImageContext::install(host::system::openImageContext);
        stack->setAxis(kit::Axis::Vertical);
        root->addSubview(stack);
        kit::LayoutConstraint::activate({stack->leadingAnchor().equalTo(root->leadingAnchor()),
            stack->topAnchor().equalTo(root->topAnchor()),
            stack->widthAnchor().lessThanOrEqualTo(root->widthAnchor())});
    }
    ~FileInfo() override
    {
        kit::TraitCollection::setApplication({});
        kit::ImageContext::install(nullptr);
    }

    void show(const std::shared_ptr<DRItem>& item) const
    {
        stack->setItem(item);
        drive.dispatch->runUntilIdle();
        root->layoutIfNeeded();
    }
    std::vector<std::shared_ptr<FileInfoCell>> cells() const
    {
        std::vector<std::shared_ptr<FileInfoCell>> found;
        for (const auto& view : stack->arrangedSubviews())
            found.push_back(std::static_pointer_cast<FileInfoCell>(view));
        return found;
    }
    Lines names() const
    {
        Lines found;
        for (const auto& cell : cells())
            found.push_back(cell->nameLabel()->text());
        return found;
    }
    std::string value(const char* name) const
    {
        for (const auto& cell : cells()) {
            if (cell->nameLabel()->text() == name)
                return cell->valueLabel()->text();
        }
        return "none";
    }

    testing_support::DriveFixture drive;
    std::shared_ptr<kit::View> root = std::make_shared<kit::View>(platform::Rect{0, 0, 600, 400});
    std::shared_ptr<FileInfoStackView> stack = FileInfoStackView::initWithFrame({});
};

TEST_F(FileInfo, ShowsWhatIsKnownAndNothingElse)
{
    const auto url = drive.writeDocument("Projects/Notes.txt", "content");
    drive.mark(url, host::drive::itemMark::tags, "Red,Work");
    const auto item = DRItem::initWithURL(url);
    show(item);
    EXPECT_THAT(names(), ElementsAre("Kind", "Size", "Where", "Created", "Modified", "Tags"));
    EXPECT_EQ(value("Kind"), item->localizedTypeDescription());
    EXPECT_EQ(value("Size"), item->friendlyFileSize());
    EXPECT_EQ(value("Where"), FileUtils::displayableLocationForURL(url));
    EXPECT_EQ(value("Created"), item->friendlyCreationDate(DateStyle::Long));
    EXPECT_EQ(value("Modified"), item->friendlyContentModificationDate(DateStyle::Long));
    EXPECT_EQ(value("Tags"), "Red Work");
    EXPECT_EQ(cells()[2]->valueLabel()->maxLines(), 4);

    item->setTags({});
    item->setFriendlyFileSize("");
    item->setLocalizedTypeDescription("");
    item->setCreationDate(std::nullopt);
    show(item);
    EXPECT_THAT(names(), ElementsAre("Where", "Modified"));
    EXPECT_FALSE(stack->creationDateCell());
    show(nullptr);
    EXPECT_THAT(names(), ElementsAre("Where", "Modified")) << "without an item the rows stay";
}

TEST_F(FileInfo, ShowsNoPlaceOfAnItemThatWasShownBefore)
{
    const auto first = DRItem::initWithURL(drive.writeDocument("Projects/a.txt"));
    const auto second = DRItem::initWithURL(drive.writeDocument("b.txt"));
    stack->setItem(first);
    show(second);
    EXPECT_EQ(value("Where"), FileUtils::displayableLocationForURL(second->url()));
    stack->setItem(first);
    EXPECT_EQ(value("Where"), "none") << "the place of the other item is not known yet";
}

TEST_F(FileInfo, AllNamesAreAsWideAsTheWidest)
{
    const auto item = DRItem::initWithURL(drive.writeDocument("Notes.txt"));
    show(item);
    double widest = 0;
    for (const auto& cell : cells())
        widest = std::max(widest, cell->nameLabel()->intrinsicContentSize().width);
    for (const auto& cell : cells()) {
        EXPECT_EQ(cell->nameLabel()->frame().width, widest);
        EXPECT_EQ(cell->valueLabel()->frame().x, widest + 10);
        EXPECT_EQ(cell->nameLabel()->alignment(), kit::TextAlignment::Right);
    }
    kit::TraitCollection::setApplication({.layoutDirection = kit::LayoutDirection::RightToLeft});
    show(item);
    EXPECT_EQ(cells().front()->nameLabel()->alignment(), kit::TextAlignment::Left)
        << "the name leans towards its value";
}

TEST_F(FileInfo, DatesAreAsFullAsTheRoomAllows)
{
    const auto item = DRItem::initWithURL(drive.writeDocument("Notes.txt"));
    const auto shownAt = [&](double width) {
        root->setFrame({0, 0, width, 400});
        show(item);
        return Lines{value("Created"), value("Modified")};
    };
    const auto dates = [&](DateStyle style) {
        return Lines{*item->friendlyCreationDate(style), *item->friendlyContentModificationDate(style)};
    };
    // A style fits exactly where its longer text does; the names and the gap stand beside it.
    shownAt(1000);
    const double names = cells().front()->valueLabel()->frame().x;
    const auto room = [&](DateStyle style) {
        double width = 0;
        for (const auto& text : dates(style))
            width = std::max(width, kit::Label(text).intrinsicContentSize().width);
        return width * FileInfoCell::font().pointSize / kit::Label().font().pointSize + names;
    };
    EXPECT_EQ(shownAt(room(DateStyle::Long) + 2), dates(DateStyle::Long));
    EXPECT_EQ(shownAt(room(DateStyle::Long) - 2), dates(DateStyle::Medium));
    EXPECT_EQ(shownAt(room(DateStyle::Medium) - 2), dates(DateStyle::Short));
    EXPECT_EQ(shownAt(names + 20), dates(DateStyle::Short)) << "the short ones need not fit";
    root->setFrame({0, 0, room(DateStyle::Long) + 2, 400});
    root->layoutIfNeeded();
    EXPECT_EQ((Lines{value("Created"), value("Modified")}), dates(DateStyle::Long))
        << "a wider window brings them back";
}

TEST_F(FileInfo, ATagIsADotAndItsName)
{
    const auto item = DRItem::initWithURL(drive.writeDocument("Notes.txt"));
    EXPECT_EQ(FileInfoStackView::buildTagsWithImagesStringFont(*item, FileInfoCell::font()), std::nullopt);
    item->setTags({"Red", "Work"});
    const auto text = FileInfoStackView::buildTagsWithImagesStringFont(*item, FileInfoCell::font());
    ASSERT_TRUE(text);
    ASSERT_EQ(text->runs().size(), 4U);
    const auto metrics = FileInfoCell::font().metrics();
    for (const std::size_t dot : {0U, 2U}) {
        ASSERT_TRUE(text->runs()[dot].attachment);
        EXPECT_NEAR(text->runs()[dot].attachment->size().width, metrics.capHeight + 2, 1);
        EXPECT_NEAR(text->runs()[dot].attachment->size().height, metrics.lineHeight, 1);
    }
    EXPECT_EQ(text->runs()[1].text, "Red ");
    EXPECT_EQ(text->runs()[3].text, "Work");
    for (const auto& run : text->runs())
        EXPECT_EQ(run.attributes.baselineOffset, run.attachment ? 0 : -metrics.descender)
            << "a dot stands on the baseline, and the text is raised to it";
}

} // namespace
} // namespace tarrow
