// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/PlaceholderView.h"

#include "kit/values/StandardColors.h"
#include "kit/views/ActivityIndicator.h"
#include "kit/views/ImageView.h"
#include "kit/views/Label.h"
#include "kit/views/StackView.h"
#include "screens/PlatformNames.h"

#include <initializer_list>

namespace screens {

namespace {

constexpr double margin = 24;
constexpr double lineSpacing = 12;
/// A plain symbol is pale because the words carry the message. An icon in colour is what the screen is about
/// and is not pale.
constexpr double symbolAlpha = 0.5;

std::shared_ptr<kit::Label> makeLabel(const kit::Font& font)
{
    const auto label = std::make_shared<kit::Label>();
    label->setFont(font);
    label->setMaxLines(0);
    label->setLineBreak(kit::LineBreak::WordWrap);
    label->setAlignment(kit::TextAlignment::Center);
    return label;
}

void show(kit::Label& label, const std::string& text)
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
    _spinner = std::make_shared<kit::ActivityIndicator>();
    _icon = std::make_shared<kit::ImageView>();
    _icon->setContentMode(kit::ContentMode::AspectFit);
    _icon->setAccessibility({.label = {}, .hint = {}, .isHidden = true});
    _title = makeLabel(kit::Font::preferred(kit::TextStyle::Title2).bold());
    _message = makeLabel(kit::Font::preferred(kit::TextStyle::Body));
    _message->setTextColor(kit::StandardColors::gray);
    _stack = std::make_shared<kit::StackView>(kit::Axis::Vertical);
    for (const auto& part :
        std::initializer_list<std::shared_ptr<kit::View>>{_spinner, _icon, _title, _message})
        _stack->addArrangedSubview(part);
    _stack->setStackAlignment(kit::StackAlignment::Center);
    _stack->setSpacing(lineSpacing);
    _stack->setPlacedByFrame(false);
    addSubview(_stack);
    kit::LayoutConstraint::activate({
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

} // namespace screens
