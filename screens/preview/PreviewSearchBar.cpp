// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/preview/PreviewSearchBar.h"

#include "kit/views/Button.h"
#include "kit/views/Label.h"
#include "kit/views/TextField.h"
#include "platform/Dispatch.h"
#include "platform/Localization.h"
#include "platform/Services.h"
#include "platform/Weakly.h"
#include "screens/PlatformNames.h"
#include "screens/preview/PreviewView.h"

#include <algorithm>
#include <chrono>
#include <initializer_list>

namespace screens {

namespace {

/// The search begins after a pause in typing, because matches of an unfinished word are of no use.
constexpr auto typingPause = std::chrono::milliseconds(150);
constexpr double margin = 6, buttonSide = 44, countWidth = 76;

} // namespace

std::shared_ptr<PreviewSearchBar> PreviewSearchBar::create()
{
    const auto bar = std::make_shared<PreviewSearchBar>();
    bar->build();
    return bar;
}

void PreviewSearchBar::build()
{
    _field = std::make_shared<kit::TextField>();
    _field->setPlaceholder(localized("Search in document"));
    _field->setAccessibilityLabel(localized("Search in document"));
    _field->setInputTraits({.returnKey = kit::ReturnKey::Search,
        .returnKeyNeedsText = false,
        .capitalization = kit::Capitalization::None,
        .autocorrection = kit::Autocorrection::Off,
        .clearButton = kit::ClearButton::WhileEditing});
    _field->setDelegate(std::shared_ptr<kit::TextFieldDelegate>(shared_from_this(), this));
    _field->setOnEditingChanged(weakly(this, &PreviewSearchBar::edited));
    _count = std::make_shared<kit::Label>();
    _count->setFont(kit::Font::preferred(kit::TextStyle::Footnote));
    _count->setAlignment(kit::TextAlignment::Center);
    _previous = kit::Button::withSymbol("go-up-symbolic", localized("Previous match"),
        weakly(this, &PreviewSearchBar::showMatch, MatchStep::Previous));
    _next = kit::Button::withSymbol("go-down-symbolic", localized("Next match"),
        weakly(this, &PreviewSearchBar::showMatch, MatchStep::Next));
    _close = kit::Button::withSymbol(
        "window-close-symbolic", localized("End search"), weakly(this, [](PreviewSearchBar& self) {
            if (const auto call = self._onClose)
                call();
        }));
    for (const auto& part :
        std::initializer_list<std::shared_ptr<kit::View>>{_field, _count, _previous, _next, _close})
        addSubview(part);
    update();
}

void PreviewSearchBar::showMatch(MatchStep direction)
{
    if (const auto preview = _preview.lock())
        preview->showMatch(direction);
}

void PreviewSearchBar::edited()
{
    auto& dispatch = services().dispatch();
    dispatch.after(
        typingPause, dispatch.mainQueue(), weakly(this, [edits = ++_edits](PreviewSearchBar& self) {
            const auto preview = self._edits == edits ? self._preview.lock() : nullptr;
            if (preview)
                preview->setQuery(self._field->text());
        }));
}

bool PreviewSearchBar::textFieldShouldReturn(kit::TextField& field)
{
    const auto preview = _preview.lock();
    if (!preview)
        return true;
    if (preview->query() == field.text())
        preview->showMatch(MatchStep::Next);
    else
        preview->setQuery(field.text());
    return true;
}

void PreviewSearchBar::setPreview(const std::shared_ptr<PreviewView>& preview)
{
    _preview = preview;
    update();
}

std::string PreviewSearchBar::countText() const
{
    const auto preview = _preview.lock();
    if (!preview || preview->query().empty())
        return {};
    const auto& state = preview->searchState();
    if (state.matches == 0)
        return state.isComplete ? localized("No matches") : localized("Searching…");
    return localized(
        "%1$d of %2$d", {static_cast<std::int64_t>(state.current), static_cast<std::int64_t>(state.matches)});
}

void PreviewSearchBar::update()
{
    const auto preview = _preview.lock();
    const bool hasMatches = preview && preview->searchState().matches > 0;
    _count->setText(countText());
    _previous->setEnabled(hasMatches);
    _next->setEnabled(hasMatches);
}

void PreviewSearchBar::layoutSubviews()
{
    const double width = bounds().width;
    const bool isMirrored = traits().layoutDirection == kit::LayoutDirection::RightToLeft;
    double x = margin;
    const auto place = [&](kit::View& view, double itemWidth, double inset) {
        view.setFrame({isMirrored ? width - x - itemWidth : x, inset, itemWidth, barHeight - 2 * inset});
        x += itemWidth;
    };
    const double taken = countWidth + 3 * buttonSide + 2 * margin;
    place(*_field, std::max(0.0, width - taken), margin);
    place(*_count, countWidth, 2);
    for (const auto& button : {_previous, _next, _close})
        place(*button, buttonSide, 2);
}

} // namespace screens
