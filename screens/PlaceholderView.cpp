// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/PlaceholderView.h"

#include "kit/values/StandardColors.h"
#include "kit/views/ActivityIndicator.h"
#include "kit/views/Button.h"
#include "kit/views/ImageView.h"
#include "kit/views/Label.h"
#include "kit/views/StackView.h"
#include "screens/PlatformNames.h"

#include <algorithm>
#include <initializer_list>

namespace screens {

namespace {

constexpr double margin = 24;
constexpr double lineSpacing = 12;
constexpr double buttonHeight = 48, buttonWidth = 200;
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

std::shared_ptr<kit::View> rounded(const Color& color)
{
    const auto view = std::make_shared<kit::View>();
    kit::ViewStyle style;
    style.background = color;
    style.cornerRadius = PlaceholderView::barHeight / 2;
    view->setStyle(style);
    return view;
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
    _bar = rounded(kit::StandardColors::hairline);
    _filled = rounded(kit::StandardColors::tint);
    _bar->addSubview(_filled);
    _stack = std::make_shared<kit::StackView>(kit::Axis::Vertical);
    for (const auto& part :
        std::initializer_list<std::shared_ptr<kit::View>>{_spinner, _icon, _title, _message, _bar})
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
        _bar->widthAnchor().equalToConstant(barWidth),
        _bar->heightAnchor().equalToConstant(barHeight),
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
    const bool hasIcon = !content.iconName.empty();
    _icon->setHidden(!hasIcon);
    _icon->setImage(hasIcon ? std::optional(Image::named(content.iconName)) : std::nullopt);
    _icon->setAlpha(content.iconName.ends_with("-symbolic") ? symbolAlpha : 1);
    show(*_title, content.title);
    show(*_message, content.message);
    showProgress();
    setNeedsLayout();
}

void PlaceholderView::showProgress()
{
    _bar->setHidden(!_content.progress);
    const double done = std::clamp(_content.progress.value_or(0), 0.0, 1.0) * barWidth;
    const bool fromRight = traits().layoutDirection == kit::LayoutDirection::RightToLeft;
    _filled->setFrame({fromRight ? barWidth - done : 0, 0, done, barHeight});
}

void PlaceholderView::setActions(const std::vector<Action>& actions)
{
    for (const auto& button : _buttons)
        button->removeFromSuperview();
    _buttons.clear();
    for (const auto& action : actions) {
        const auto button = std::make_shared<kit::Button>(action.title, action.run);
        if (action.isSuggested)
            button->setButtonStyle(kit::ButtonStyle::Suggested);
        _buttons.push_back(button);
        _stack->addArrangedSubview(button);
        kit::LayoutConstraint::activate({button->heightAnchor().equalToConstant(buttonHeight),
            button->widthAnchor().greaterThanOrEqualToConstant(buttonWidth)});
    }
    setNeedsLayout();
}

} // namespace screens
