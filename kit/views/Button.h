// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/PlatformNames.h"
#include "kit/views/Label.h"
#include "platform/Image.h"

#include <functional>

namespace kit {

enum class ButtonStyle { System, Suggested, Destructive };

/// A button with a title, an image or both.
class Button : public View {
public:
    explicit Button(std::string title = {}, std::function<void()> action = {});

    /// Makes a button that shows a symbol of the icon theme; `label` is its accessible name.
    static std::shared_ptr<Button> withSymbol(
        const char* icon, const std::string& label, std::function<void()> action = {});

    void accept(ViewVisitor& visitor) override;

    const std::string& title() const { return _titleLabel->text(); }
    void setTitle(std::string title);
    void setTitleFont(const Font& font);
    /// Answers the title as a label, in the button's coordinates. It is no subview, because a peer draws the
    /// title by itself.
    const std::shared_ptr<Label>& titleLabel() const { return _titleLabel; }
    const std::optional<Image>& image() const { return _image; }
    void setImage(std::optional<Image> image);
    ButtonStyle buttonStyle() const { return _buttonStyle; }
    void setButtonStyle(ButtonStyle style);
    const EdgeInsets& contentInsets() const { return _contentInsets; } ///< between the edge and the title
    void setContentInsets(const EdgeInsets& insets);

    /// The action is called once for each press.
    void setAction(std::function<void()> action) { _action = std::move(action); }
    /// Event up: the user pressed the button. Answers false, and does nothing, when it is disabled or hidden.
    bool press();

    Size intrinsicContentSize(double maxWidth = 0) const override;
    double firstBaselineOffset() const override;
    double lastBaselineOffset() const override;
    void layoutSubviews() override;
    void sizeToFit() override;

private:
    void contentDidChange();
    void placeTitle();

    std::shared_ptr<Label> _titleLabel;
    std::optional<Image> _image;
    ButtonStyle _buttonStyle = ButtonStyle::System;
    EdgeInsets _contentInsets{6, 8, 6, 8};
    std::function<void()> _action;
};

} // namespace kit
