// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "preview/FileInfoCell.h"

#include "kit/layout/VisualFormat.h"
#include "kit/values/StandardColors.h"
#include "kit/views/Label.h"

namespace tarrow {

using kit::Axis;
using kit::Label;
using kit::TextAlignment;
namespace LayoutPriorities = kit::LayoutPriorities;

namespace {

/// One above that of the value, which therefore takes the room that is left.
constexpr kit::LayoutPriority nameHugging = LayoutPriorities::defaultLow + 1;

std::shared_ptr<Label> makeLabel(const std::string& text, const platform::Color& color)
{
    auto label = std::make_shared<Label>(text);
    label->setPlacedByFrame(false);
    label->setFont(FileInfoCell::font());
    label->setTextColor(color);
    label->setHugging(LayoutPriorities::required, Axis::Vertical);
    label->setCompressionResistance(LayoutPriorities::required, Axis::Vertical);
    return label;
}

} // namespace

kit::Font FileInfoCell::font()
{
    return kit::Font::preferred(kit::TextStyle::Subheadline);
}

std::shared_ptr<FileInfoCell> FileInfoCell::init()
{
    return initWithNameAndValueValueMaxLines({}, {}, 1);
}

std::shared_ptr<FileInfoCell> FileInfoCell::initWithNameAndValueValueMaxLines(
    const std::string& name, const std::string& value, int maxLines)
{
    auto cell = std::make_shared<FileInfoCell>();
    cell->build(name, value, maxLines);
    return cell;
}

void FileInfoCell::build(const std::string& name, const std::string& value, int maxLines)
{
    setPlacedByFrame(false);
    _nameLabel = makeLabel(name, kit::StandardColors::gray);
    _valueLabel = makeLabel(value, platform::Color::black());
    // The name leans towards its value.
    const bool rightToLeft = kit::TraitCollection::application().isRightToLeft();
    _nameLabel->setAlignment(rightToLeft ? TextAlignment::Left : TextAlignment::Right);
    _nameLabel->setHugging(nameHugging, Axis::Horizontal);
    _valueLabel->setMaxLines(maxLines);
    _valueLabel->setHugging(LayoutPriorities::defaultLow, Axis::Horizontal);
    _valueLabel->setCompressionResistance(LayoutPriorities::defaultLow, Axis::Horizontal);
    addSubview(_nameLabel);
    addSubview(_valueLabel);
    kit::VisualFormatInput input;
    input.views = {{"_nameLabel", _nameLabel}, {"_valueLabel", _valueLabel}};
    for (const auto* format : {"H:|[_nameLabel]-10-[_valueLabel]|", "V:|[_nameLabel]", "V:|[_valueLabel]|"})
        kit::LayoutConstraint::activate(kit::VisualFormat::constraints(format, input));
}

} // namespace tarrow
