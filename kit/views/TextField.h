// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/views/Label.h"
#include "kit/views/TextFieldDelegate.h"

#include <functional>

namespace kit {

enum class ReturnKey { Default, Done, Search };
enum class Capitalization { None, Words, Sentences };
enum class Autocorrection { Default, Off };
enum class ClearButton { Never, WhileEditing };
/// A framed field stands out from its surroundings; a plain one is a line of text that can be edited.
enum class FieldStyle { Framed, Plain };

/// Says how the on-screen keyboard and the field's own controls look and behave.
struct TextInputTraits {
    ReturnKey returnKey = ReturnKey::Default;
    bool returnKeyNeedsText = false; ///< the return key works only while the field holds text
    Capitalization capitalization = Capitalization::Sentences;
    Autocorrection autocorrection = Autocorrection::Default;
    ClearButton clearButton = ClearButton::Never;
    bool isSecret = false; ///< the text is neither shown nor spoken, as a password
    bool operator==(const TextInputTraits&) const = default;
};

/// One line of text that the user edits.
class TextField : public View {
public:
    explicit TextField(std::string text = {});

    void accept(ViewVisitor& visitor) override;

    const std::string& text() const { return _text; }
    void setText(std::string text); ///< by the program: no event, the insertion point goes to the end
    const std::string& placeholder() const { return _placeholder; }
    void setPlaceholder(std::string placeholder);
    const Font& font() const { return _font; }
    void setFont(const Font& font);
    TextAlignment alignment() const { return _alignment; }
    void setAlignment(TextAlignment alignment);
    const TextInputTraits& inputTraits() const { return _inputTraits; }
    void setInputTraits(const TextInputTraits& traits);
    FieldStyle fieldStyle() const { return _fieldStyle; }
    void setFieldStyle(FieldStyle style);
    TextRange selectedRange() const { return _selection; }
    void setSelectedRange(TextRange range); ///< cut to the length of the text
    std::size_t length() const; ///< in characters

    void setDelegate(std::weak_ptr<TextFieldDelegate> delegate) { _delegate = std::move(delegate); }
    /// The callback runs once after every edit by the user.
    void setOnEditingChanged(std::function<void()> callback) { _onEditingChanged = std::move(callback); }

    bool isEditing() const { return _editing; }
    bool becomeFirstResponder() override; ///< begins editing when the delegate allows it
    bool resignFirstResponder() override; ///< ends editing when the delegate allows it
    bool isFirstResponder() const override { return _editing; }

    // Events up: the host reports what the user did.
    /// The native field now shows this text with this selection. Answers false when the edit was refused; the
    /// observer is then told to show the old text again.
    bool userEdited(const std::string& text, TextRange selection);
    void userSelected(TextRange selection);
    bool userPressedReturn(); ///< false when the key has no effect, or the delegate refuses
    bool userFocused() { return becomeFirstResponder(); }
    /// The focus moved elsewhere. Answers false when the delegate refused to end the editing; the observer is
    /// then asked to take the focus back.
    bool userLeft() { return resignFirstResponder(); }

    Size intrinsicContentSize(double maxWidth = 0) const override;
    double firstBaselineOffset() const override;
    double lastBaselineOffset() const override;

private:
    std::string _text, _placeholder;
    Font _font = Font::preferred(TextStyle::Body);
    TextAlignment _alignment = TextAlignment::Natural;
    TextInputTraits _inputTraits;
    FieldStyle _fieldStyle = FieldStyle::Framed;
    TextRange _selection;
    std::weak_ptr<TextFieldDelegate> _delegate;
    std::function<void()> _onEditingChanged;
    bool _editing = false;
};

} // namespace kit
