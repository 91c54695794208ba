// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "preview/FileInfoStackView.h"

#include "drawing/FileTags.h"
#include "items/FileUtils.h"
#include "kit/layout/VisualFormat.h"
#include "kit/values/TextMeasurer.h"
#include "kit/views/Label.h"
#include "platform/Dispatch.h"
#include "platform/Localization.h"
#include "platform/Services.h"
#include "platform/Weakly.h"

#include <algorithm>
#include <utility>

namespace tarrow {

using platform::DateStyle;
using platform::localized;
using platform::services;
using platform::Url;
using platform::weakly;

namespace {

constexpr double rowSpacing = 10; // points
constexpr int locationLines = 4;
/// A tag's dot is as high as a capital letter and one point apart from the text on either side.
constexpr double dotMargin = 1;

double widthOf(const std::string& text)
{
    return kit::TextMeasurer::current().measure(text, FileInfoCell::font(), {0, 1}).width;
}

double valueWidth(const std::shared_ptr<FileInfoCell>& cell)
{
    return cell ? cell->valueLabel()->frame().width : 0;
}

} // namespace

struct FileInfoStackView::Dates {
    std::string created, modified;
};

FileInfoStackView::Dates FileInfoStackView::datesOf(const DRItem& item, DateStyle style)
{
    return {item.friendlyCreationDate(style).value_or(""),
        item.friendlyContentModificationDate(style).value_or("")};
}

/// Answers the fullest dates of which both fit; the shortest when none do.
FileInfoStackView::Dates FileInfoStackView::fittingDates(const DRItem& item, double width)
{
    for (const auto style : {DateStyle::Long, DateStyle::Medium}) {
        auto dates = datesOf(item, style);
        if (widthOf(dates.created) <= width && widthOf(dates.modified) <= width)
            return dates;
    }
    return datesOf(item, DateStyle::Short);
}

std::shared_ptr<FileInfoStackView> FileInfoStackView::initWithFrame(const platform::Rect& frame)
{
    auto stack = std::make_shared<FileInfoStackView>();
    stack->setFrame(frame);
    stack->setStackAlignment(kit::StackAlignment::Leading);
    stack->setDistribution(kit::StackDistribution::Fill);
    stack->setSpacing(rowSpacing);
    stack->setPlacedByFrame(false);
    return stack;
}

std::shared_ptr<FileInfoCell> FileInfoStackView::addCellValueMaxLines(
    const std::string& name, const std::string& value, int maxLines)
{
    auto cell = FileInfoCell::initWithNameAndValueValueMaxLines(name, value, maxLines);
    const auto last = arrangedSubviews().empty()
        ? nullptr
        : std::static_pointer_cast<FileInfoCell>(arrangedSubviews().back());
    addArrangedSubview(cell);
    if (last) {
        kit::VisualFormatInput input;
        input.views = {{"nameLabel", cell->nameLabel()}, {"lastNameLabel", last->nameLabel()}};
        kit::LayoutConstraint::activate(
            kit::VisualFormat::constraints("[nameLabel(==lastNameLabel)]", input));
    }
    return cell;
}

void FileInfoStackView::setItem(std::shared_ptr<DRItem> item)
{
    _item = std::move(item);
    if (!_item)
        return;
    rebuild();
    if (_located != _item->url())
        findLocation();
}

void FileInfoStackView::removeRows()
{
    const auto rows = arrangedSubviews();
    for (const auto& row : rows)
        row->removeFromSuperview();
}

std::shared_ptr<FileInfoCell> FileInfoStackView::addRow(
    const char* name, const std::string& value, int maxLines)
{
    return value.empty() ? nullptr : addCellValueMaxLines(localized(name), value, maxLines);
}

void FileInfoStackView::rebuild()
{
    removeRows();
    const auto dates = datesOf(*_item, DateStyle::Long);
    addRow("Kind", _item->localizedTypeDescription());
    addRow("Size", _item->friendlyFileSize());
    addRow("Where", _located == _item->url() ? _location : std::string(), locationLines);
    _creationDateCell = addRow("Created", dates.created);
    _modifiedDateCell = addRow("Modified", dates.modified);
    if (auto tags = buildTagsWithImagesStringFont(*_item, FileInfoCell::font()))
        addRow("Tags", tags->plainText())->valueLabel()->setAttributedText(std::move(tags));
}

void FileInfoStackView::findLocation()
{
    auto& dispatch = services().dispatch();
    if (!_queue)
        _queue = dispatch.makeOperationQueue("fileInfoQueue", platform::QualityOfService::UserInitiated);
    const auto known = weakly(this, &FileInfoStackView::locationIsKnown, _item->url());
    _queue->addOperation([main = dispatch.mainQueue(), known, url = _item->url()] {
        main->async([known, line = FileUtils::displayableLocationForURL(url)] { known(line); });
    });
}

void FileInfoStackView::locationIsKnown(const Url& url, const std::optional<std::string>& line)
{
    if (!_item || _item->url() != url)
        return;
    _located = url;
    _location = line.value_or("");
    if (!_location.empty())
        rebuild();
}

std::optional<kit::AttributedText> FileInfoStackView::buildTagsWithImagesStringFont(
    const DRItem& item, const kit::Font& font)
{
    if (item.tags().empty())
        return std::nullopt;
    const auto metrics = font.metrics();
    const kit::TextAttributes base{font, std::nullopt, -metrics.descender};
    const platform::Size imageSize{metrics.capHeight + 2 * dotMargin, metrics.lineHeight};
    const platform::Point dotOrigin{0, metrics.ascender - metrics.capHeight + dotMargin};
    kit::AttributedText text;
    for (const auto& tag : item.tags()) {
        if (const auto dot = FileTags::blipWithTagImageSizeBlipHeightOffset(
                tag, imageSize, static_cast<float>(metrics.capHeight), dotOrigin))
            text.append(*dot, {font, std::nullopt, 0});
        text.append(&tag == &item.tags().back() ? tag : tag + " ", base);
    }
    return text;
}

void FileInfoStackView::layoutSubviews()
{
    StackView::layoutSubviews();
    if (!_item)
        return;
    // A row is no wider than its text, so other room is tried with the fullest dates first, in the next pass.
    const auto parent = superview();
    const double room = parent ? parent->frame().width : 0;
    if (std::exchange(_room, room) != room && showDates(datesOf(*_item, DateStyle::Long)))
        return;
    const double width = std::max(valueWidth(_creationDateCell), valueWidth(_modifiedDateCell));
    if (width > 0)
        showDates(fittingDates(*_item, width));
}

/// Answers whether a row shows another date now.
bool FileInfoStackView::showDates(const Dates& dates)
{
    bool isOther = false;
    const auto show = [&](const std::shared_ptr<FileInfoCell>& cell, const std::string& text) {
        if (!cell || cell->valueLabel()->text() == text)
            return;
        cell->valueLabel()->setText(text);
        isOther = true;
    };
    show(_creationDateCell, dates.created);
    show(_modifiedDateCell, dates.modified);
    return isOther;
}

} // namespace tarrow
