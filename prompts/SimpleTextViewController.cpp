// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "prompts/SimpleTextViewController.h"

#include "kit/layout/LayoutConstraint.h"
#include "kit/values/StandardColors.h"
#include "kit/views/Label.h"

namespace tarrow {

using kit::Font;
using kit::Label;
using kit::LayoutAttribute;
using kit::LayoutConstraint;

namespace {

constexpr int mostLines = 5;

} // namespace

Font SimpleTextViewController::messageLabelFont() const
{
    return Font::preferred(kit::TextStyle::Footnote);
}

void SimpleTextViewController::viewDidLoad()
{
    _messageLabel = std::make_shared<Label>();
    _messageLabel->setMaxLines(mostLines);
    _messageLabel->setFont(messageLabelFont());
    _messageLabel->setTextColor(kit::StandardColors::red);
    view()->addSubview(_messageLabel);
    constrainLabel();
}

void SimpleTextViewController::constrainLabel()
{
    using enum LayoutAttribute;
    _messageLabel->setPlacedByFrame(false);
    for (const auto axis : {kit::Axis::Horizontal, kit::Axis::Vertical})
        view()->setHugging(kit::LayoutPriorities::required, axis);
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
