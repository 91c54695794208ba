// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/preview/PreviewEditBar.h"

#include "kit/views/Button.h"
#include "platform/Localization.h"
#include "platform/Weakly.h"
#include "screens/PlatformNames.h"

#include <algorithm>
#include <utility>

namespace screens {

std::shared_ptr<PreviewEditBar> PreviewEditBar::create()
{
    const auto bar = std::make_shared<PreviewEditBar>();
    bar->build();
    return bar;
}

void PreviewEditBar::build()
{
    const struct {
        EditTool tool;
        const char* icon;
        std::string name;
    } tools[] = {
        {EditTool::Undo, "edit-undo-symbolic", localized("Undo")},
        {EditTool::Highlight, "trw-highlight-symbolic", localized("Highlight the selected text")},
        {EditTool::Underline, "format-text-underline-symbolic", localized("Underline the selected text")},
        {EditTool::Note, "trw-note-symbolic", localized("Add a note")},
        {EditTool::PreviousField, "go-up-symbolic", localized("Previous field")},
        {EditTool::NextField, "go-down-symbolic", localized("Next field")},
        {EditTool::Done, nullptr, localized("Done")},
    };
    for (const auto& [tool, icon, name] : tools) {
        const auto button = std::make_shared<kit::Button>(
            icon ? std::string() : name, weakly(this, [pressed = tool](PreviewEditBar& self) {
                if (const auto call = self._onTool)
                    call(pressed);
            }));
        if (icon)
            button->setImage(Image::named(icon));
        else
            button->setButtonStyle(kit::ButtonStyle::Suggested);
        button->setAccessibilityLabel(name);
        addSubview(button);
        _buttons[tool] = button;
    }
    setState({});
}

void PreviewEditBar::setState(const State& state)
{
    _buttons[EditTool::Undo]->setEnabled(state.canUndo);
    for (const auto tool : {EditTool::Highlight, EditTool::Underline, EditTool::Note})
        _buttons[tool]->setHidden(!state.canMark);
    for (const auto tool : {EditTool::Highlight, EditTool::Underline})
        _buttons[tool]->setEnabled(state.hasMarkable);
    for (const auto tool : {EditTool::PreviousField, EditTool::NextField})
        _buttons[tool]->setHidden(!state.hasFields);
    setNeedsLayout();
}

void PreviewEditBar::layoutSubviews()
{
    const double width = bounds().width;
    const bool isMirrored = traits().layoutDirection == kit::LayoutDirection::RightToLeft;
    const auto place = [&](kit::View& view, double x, double y, double itemWidth, double height) {
        view.setFrame({isMirrored ? width - x - itemWidth : x, y, itemWidth, height});
    };
    double x = 0;
    for (const auto& [tool, button] : _buttons) {
        if (tool == EditTool::Done || button->isHidden())
            continue;
        place(*button, x, 0, barHeight, barHeight);
        x += barHeight;
    }
    constexpr double margin = 2;
    auto& done = *_buttons[EditTool::Done];
    const double wanted = std::max(barHeight, done.intrinsicContentSize().width) + margin;
    const double doneWidth = std::clamp(wanted, 0.0, std::max(0.0, width - x));
    place(done, width - doneWidth, margin, doneWidth - margin, barHeight - 2 * margin);
}

} // namespace screens
