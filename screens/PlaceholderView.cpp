// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/PlaceholderView.h"

#include "kit/values/StandardColors.h"
#include "kit/views/ActivityIndicator.h"
#include "kit/views/ImageView.h"
#include "kit/views/Label.h"
#include "kit/views/StackView.h"

#include <initializer_list>

namespace platform::components {

namespace {

constexpr double margin = 24;
constexpr double lineSpacing = 12;
/// Of a plain symbol: what is said is in the words. An icon in colour is what the screen is about.
constexpr double symbolAlpha = 0.5;

std::shared_ptr<ui::Label> makeLabel(const ui::Font& font)
{
    const auto label = std::make_shared<ui::Label>();
    label->setFont(font);
    label->setMaxLines(0);
    label->setLineBreak(ui::LineBreak::WordWrap);
    label->setAlignment(ui::TextAlignment::Center);
    return label;
}

void show(ui::Label& label, const std::string& text)
{
    label.setText(text);
    label.setHidden(text.empty());
}

} // namespace

std::shared_ptr<PlaceholderView> PlaceholderView::create()
{
    const auto view = std::make_shared<PlaceholderView>();
    view->build();
    return view;
}

void PlaceholderView::build()
{
    _spinner = std::make_shared<ui::ActivityIndicator>();
    _icon = std::make_shared<ui::ImageView>();
    _icon->setContentMode(ui::ContentMode::AspectFit);
    _icon->setAccessibility({.label = {}, .hint = {}, .isHidden = true});
    _title = makeLabel(ui::Font::preferred(ui::TextStyle::Title2).bold());
    _message = makeLabel(ui::Font::preferred(ui::TextStyle::Body));
    _message->setTextColor(ui::StandardColors::gray);
    _stack = std::make_shared<ui::StackView>(ui::Axis::Vertical);
    for (const auto& part :
        std::initializer_list<std::shared_ptr<ui::View>>{_spinner, _icon, _title, _message})
        _stack->addArrangedSubview(part);
    _stack->setStackAlignment(ui::StackAlignment::Center);
    _stack->setSpacing(lineSpacing);
    _stack->setPlacedByFrame(false);
    addSubview(_stack);
    ui::LayoutConstraint::activate({
        _stack->centerXAnchor().equalTo(centerXAnchor()),
        _stack->centerYAnchor().equalTo(centerYAnchor()),
        _stack->widthAnchor().lessThanOrEqualTo(widthAnchor(), -2 * margin),
        _stack->widthAnchor().lessThanOrEqualToConstant(maximumWidth),
        _icon->widthAnchor().equalToConstant(iconSide),
        _icon->heightAnchor().equalToConstant(iconSide),
    });
    setContent({});
}

void PlaceholderView::setContent(const Content& content)
{
    _content = content;
    _spinner->setHidden(!content.isBusy);
    if (content.isBusy)
        _spinner->startAnimating();
    else
        _spinner->stopAnimating();
    const bool hasIcon = !content.isBusy && !content.iconName.empty();
    _icon->setHidden(!hasIcon);
    _icon->setImage(hasIcon ? std::optional(Image::named(content.iconName)) : std::nullopt);
    _icon->setAlpha(content.iconName.ends_with("-symbolic") ? symbolAlpha : 1);
    show(*_title, content.title);
    show(*_message, content.message);
    setNeedsLayout();
}

} // namespace platform::components
