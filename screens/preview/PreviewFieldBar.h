// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/views/TextFieldDelegate.h"
#include "kit/views/View.h"
#include "platform/PagedDocumentEditing.h"
#include "screens/PlatformNames.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace kit {
class Button;
class Label;
class TextField;
} // namespace kit

namespace screens {

/// The bar in which the user fills in a field of a form. It shows the field's name and value above the
/// keyboard, because the field itself may be hidden or too small to write in. Main thread only.
class PreviewFieldBar : public kit::View, private kit::TextFieldDelegate {
public:
    static constexpr double barHeight = 72; ///< points

    static std::shared_ptr<PreviewFieldBar> create();
    using kit::View::View;

    /// Called when the user has written a text and goes on to the next field.
    void setOnNext(std::function<void()> callback) { _onNext = std::move(callback); }
    /// Called when the user leaves the field that is being written in.
    void setOnLeave(std::function<void()> callback) { _onLeave = std::move(callback); }
    /// Called when the user presses the button that switches a check box or asks for a choice.
    void setOnPress(std::function<void()> callback) { _onPress = std::move(callback); }

    /// Shows a field. Showing the same field again does not touch a text that is being written.
    void setField(const FormField& field);
    /// Answers the text that was written and is not in the field yet, or nothing. The text counts as taken
    /// from then on.
    std::optional<std::string> takeText();

    const std::shared_ptr<kit::Label>& nameLabel() const { return _name; }
    const std::shared_ptr<kit::TextField>& textField() const
    {
        return _text;
    } ///< hidden for check boxes and choices
    const std::shared_ptr<kit::Button>& button() const { return _button; } ///< hidden for text fields

    void layoutSubviews() override;

private:
    void build();
    bool textFieldShouldReturn(kit::TextField& field) override;
    void textFieldDidEndEditing(kit::TextField& field) override;

    std::optional<FormField> _field;
    std::shared_ptr<kit::Label> _name;
    std::shared_ptr<kit::TextField> _text;
    std::shared_ptr<kit::Button> _button;
    std::function<void()> _onNext, _onLeave, _onPress;
};

/// Answers the value of a choice, a check box or a button in words.
std::string fieldValueWords(const FormField& field);
/// Answers the name of a field in words; never empty.
std::string fieldName(const FormField& field);

} // namespace screens
