// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/views/View.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace kit {
class ActivityIndicator;
class Button;
class ImageView;
class Label;
class StackView;
} // namespace kit

namespace screens {

/// Stands in for missing content: an icon, a title that says what happened, a message that says what to do,
/// the progress of a download, and buttons, centred and not wider than a comfortable line of text. Main
/// thread only.
class PlaceholderView : public kit::View {
public:
    struct Action {
        std::string title;
        std::function<void()> run;
        bool isSuggested = false;
    };
    struct Content {
        std::string iconName{}; ///< name of an icon in the icon theme; empty: none
        std::string title{}; ///< empty: none
        std::string message{}; ///< empty: none
        bool isBusy = false; ///< shows a spinner
        std::optional<double> progress{}; ///< from 0 to 1; shows a bar
        bool operator==(const Content&) const = default;
    };

    static std::shared_ptr<PlaceholderView> create();

    static constexpr double maximumWidth = 420; ///< points; the width of the text
    static constexpr double iconSide = 96; ///< points
    static constexpr double barWidth = 240, barHeight = 6; ///< points

    using kit::View::View;

    const Content& content() const { return _content; }
    void setContent(const Content& content);
    const std::vector<std::shared_ptr<kit::Button>>& buttons() const { return _buttons; }
    /// Shows buttons below the text, the first one on top.
    void setActions(const std::vector<Action>& actions);

private:
    void build();
    void showProgress();

    Content _content;
    std::shared_ptr<kit::StackView> _stack;
    std::shared_ptr<kit::ActivityIndicator> _spinner;
    std::shared_ptr<kit::ImageView> _icon;
    std::shared_ptr<kit::Label> _title, _message;
    std::shared_ptr<kit::View> _bar, _filled;
    std::vector<std::shared_ptr<kit::Button>> _buttons;
};

} // namespace screens
