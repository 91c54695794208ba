// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/preview/PreviewSummaryView.h"

#include "kit/values/StandardColors.h"
#include "kit/views/ActivityIndicator.h"
#include "kit/views/Button.h"
#include "kit/views/ImageView.h"
#include "kit/views/Label.h"
#include "kit/views/StackView.h"

#include <algorithm>
#include <initializer_list>

namespace platform::components {

namespace {

constexpr double margin = 24;
constexpr double lineSpacing = 12;
constexpr double symbolAlpha = 0.5; ///< of a plain symbol, which only goes with the words
constexpr double buttonHeight = 48, buttonWidth = 200;

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

std::shared_ptr<ui::View> rounded(const Color& color)
{
    const auto view = std::make_shared<ui::View>();
    ui::ViewStyle style;
    style.background = color;
    style.cornerRadius = PreviewSummaryView::barHeight / 2;
    view->setStyle(style);
    return view;
}

} // namespace

std::shared_ptr<PreviewSummaryView> PreviewSummaryView::create()
{
    const auto view = std::make_shared<PreviewSummaryView>();
    view->build();
    return view;
}

void PreviewSummaryView::build()
{
    _spinner = std::make_shared<ui::ActivityIndicator>();
    _icon = std::make_shared<ui::ImageView>();
    _icon->setContentMode(ui::ContentMode::AspectFit);
    _icon->setAccessibility({.label = {}, .hint = {}, .isHidden = true});
    _title = makeLabel(ui::Font::preferred(ui::TextStyle::Title2).bold());
    _message = makeLabel(ui::Font::preferred(ui::TextStyle::Body));
    _message->setTextColor(ui::StandardColors::gray);
    _bar = rounded(ui::StandardColors::hairline);
    _filled = rounded(ui::StandardColors::tint);
    _bar->addSubview(_filled);
    _stack = std::make_shared<ui::StackView>(ui::Axis::Vertical);
    for (const auto& part :
        std::initializer_list<std::shared_ptr<ui::View>>{_spinner, _icon, _title, _message, _bar})
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
        _bar->widthAnchor().equalToConstant(barWidth),
        _bar->heightAnchor().equalToConstant(barHeight),
    });
    setContent({});
}

void PreviewSummaryView::setContent(const Content& content)
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

void PreviewSummaryView::showProgress()
{
    _bar->setHidden(!_content.progress);
    const double done = std::clamp(_content.progress.value_or(0), 0.0, 1.0) * barWidth;
    const bool fromRight = traits().layoutDirection == ui::LayoutDirection::RightToLeft;
    _filled->setFrame({fromRight ? barWidth - done : 0, 0, done, barHeight});
}

void PreviewSummaryView::setActions(const std::vector<Action>& actions)
{
    for (const auto& button : _buttons)
        button->removeFromSuperview();
    _buttons.clear();
    for (const auto& action : actions) {
        const auto button = std::make_shared<ui::Button>(action.title, action.run);
        if (action.isSuggested)
            button->setButtonStyle(ui::ButtonStyle::Suggested);
        _buttons.push_back(button);
        _stack->addArrangedSubview(button);
        ui::LayoutConstraint::activate({button->heightAnchor().equalToConstant(buttonHeight),
            button->widthAnchor().greaterThanOrEqualToConstant(buttonWidth)});
    }
    setNeedsLayout();
}

} // namespace platform::components
