// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/views/View.h"

#include <memory>
#include <string>

namespace kit {
class ActivityIndicator;
class ImageView;
class Label;
class StackView;
} // namespace kit

namespace screens {

/// Stands in for missing content: an icon, a title that says what happened and a message that says what to
/// do, centred and not wider than a comfortable line of text. Main thread only.
class PlaceholderView : public kit::View {
public:
    struct Content {
        std::string iconName{}; ///< name of an icon in the icon theme; empty: none
        std::string title{}; ///< empty: none
        std::string message{}; ///< empty: none
        bool isBusy = false; ///< shows a spinner in place of the icon
        bool operator==(const Content&) const = default;
    };

    static std::shared_ptr<PlaceholderView> create();

    static constexpr double maximumWidth = 420; ///< points; the width of the text
    static constexpr double iconSide = 96; ///< points

    using kit::View::View;

    const Content& content() const { return _content; }
    void setContent(const Content& content);

private:
    void build();

    Content _content;
    std::shared_ptr<kit::StackView> _stack;
    std::shared_ptr<kit::ActivityIndicator> _spinner;
    std::shared_ptr<kit::ImageView> _icon;
    std::shared_ptr<kit::Label> _title, _message;
};

} // namespace screens
