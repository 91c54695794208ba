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

/// The bar in which the field of a form is filled in: its name, and what it holds. It stands above the
/// keyboard, where the field itself may be hidden or too small to write in. Main thread only.
class PreviewFieldBar : public kit::View, private kit::TextFieldDelegate {
public:
    static constexpr double barHeight = 72; ///< points

    static std::shared_ptr<PreviewFieldBar> create();
    using kit::View::View;

    /// Called when the person has written a text and goes on to the next field.
    void setOnNext(std::function<void()> callback) { _onNext = std::move(callback); }
    /// Called when the person leaves the field in which a text is written.
    void setOnLeave(std::function<void()> callback) { _onLeave = std::move(callback); }
    /// Called when the button is pressed that switches a box, or asks for a choice.
    void setOnPress(std::function<void()> callback) { _onPress = std::move(callback); }

    /// Shows a field. A text that is being written is not touched by the same field once more.
    void setField(const FormField& field);
    /// What was written and is not in the field yet; nothing when it is. It counts as taken then.
    std::optional<std::string> takeText();

    const std::shared_ptr<kit::Label>& nameLabel() const { return _name; }
    const std::shared_ptr<kit::TextField>& textField() const { return _text; } ///< hidden for boxes
    const std::shared_ptr<kit::Button>& button() const { return _button; } ///< hidden for texts

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

/// What a choice, a box or a button holds, in words.
std::string fieldValueWords(const FormField& field);
/// The name of a field for people; never empty.
std::string fieldName(const FormField& field);

} // namespace screens
