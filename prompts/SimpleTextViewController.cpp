// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "prompts/SimpleTextViewController.h"

#include "kit/layout/LayoutConstraint.h"
#include "kit/values/StandardColors.h"
#include "kit/views/Label.h"

namespace tarrow {

using platform::ui::Font;
using platform::ui::Label;
using platform::ui::LayoutAttribute;
using platform::ui::LayoutConstraint;

namespace {

constexpr int mostLines = 5;

} // namespace

Font SimpleTextViewController::messageLabelFont() const
{
    return Font::preferred(platform::ui::TextStyle::Footnote);
}

void SimpleTextViewController::viewDidLoad()
{
    _messageLabel = std::make_shared<Label>();
    _messageLabel->setMaxLines(mostLines);
    _messageLabel->setFont(messageLabelFont());
    _messageLabel->setTextColor(platform::ui::StandardColors::red);
    view()->addSubview(_messageLabel);
    constrainLabel();
}

void SimpleTextViewController::constrainLabel()
{
    using enum LayoutAttribute;
    _messageLabel->setPlacedByFrame(false);
    for (const auto axis : {platform::ui::Axis::Horizontal, platform::ui::Axis::Vertical})
        view()->setHugging(platform::ui::LayoutPriorities::required, axis);
    const auto label = [this](LayoutAttribute attribute) { return _messageLabel->anchor(attribute); };
    const auto edge = [this](LayoutAttribute attribute) { return view()->anchor(attribute); };
    LayoutConstraint::activate({
        label(Height).equalTo(edge(Height)),
        label(Top).equalTo(edge(Top)),
        label(Leading).equalTo(edge(Leading), _labelHorizontalInsets()),
        label(Trailing).equalTo(edge(Trailing), -_labelHorizontalInsets()),
    });
}

} // namespace tarrow
