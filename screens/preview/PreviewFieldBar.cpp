// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/preview/PreviewFieldBar.h"

#include "kit/views/Button.h"
#include "kit/views/TextField.h"
#include "platform/Localization.h"
#include "platform/Weakly.h"

#include <algorithm>
#include <utility>

namespace screens {

namespace {

constexpr double margin = 8, nameHeight = 22;

bool isWritten(const FormField& field)
{
    return field.kind == FormField::Kind::Text && !field.isMultiline;
}

/// Answers as many of a text's first characters as a field takes.
std::string cut(const std::string& text, std::size_t characters)
{
    if (characters == 0)
        return text;
    std::size_t end = 0;
    for (std::size_t count = 0; end < text.size(); ++end) {
        const bool begins = (static_cast<unsigned char>(text[end]) & 0xC0U) != 0x80U;
        if (begins && ++count > characters)
            break;
    }
    return text.substr(0, end);
}

} // namespace

std::string fieldName(const FormField& field)
{
    return field.name.empty() ? localized("Field") : field.name;
}

std::string fieldValueWords(const FormField& field)
{
    if (field.isMultiline)
        return field.text.empty() ? localized("Write…") : field.text.substr(0, field.text.find('\n'));
    if (field.kind != FormField::Kind::Choice)
        return field.isOn ? localized("On") : localized("Off");
    std::string words;
    for (const auto index : field.chosen)
        words += (words.empty() ? "" : ", ") + field.options[index];
    if (words.empty())
        words = field.text;
    return words.empty() ? localized("Choose…") : words;
}

std::shared_ptr<PreviewFieldBar> PreviewFieldBar::create()
{
    const auto bar = std::make_shared<PreviewFieldBar>();
    bar->build();
    return bar;
}

void PreviewFieldBar::build()
{
    _name = std::make_shared<kit::Label>();
    _name->setFont(kit::Font::preferred(kit::TextStyle::Footnote));
    _text = std::make_shared<kit::TextField>();
    _text->setDelegate(std::shared_ptr<kit::TextFieldDelegate>(shared_from_this(), this));
    _button = std::make_shared<kit::Button>(std::string(), weakly(this, [](PreviewFieldBar& self) {
        if (const auto call = self._onPress)
            call();
    }));
    for (const auto& part : std::initializer_list<std::shared_ptr<kit::View>>{_name, _text, _button})
        addSubview(part);
}

void PreviewFieldBar::setField(const FormField& field)
{
    const bool isSame = _field && _field->id == field.id;
    const bool isBeingWritten = isSame && _text->text() != _field->text;
    const auto name = fieldName(field);
    _field = field;
    _name->setText(name);
    _text->setHidden(!isWritten(field));
    _text->setInputTraits({.returnKey = kit::ReturnKey::Done,
        .clearButton = kit::ClearButton::WhileEditing,
        .isSecret = field.isSecret});
    _button->setHidden(isWritten(field));
    _text->setAccessibilityLabel(name);
    if (isWritten(field) && !isBeingWritten && _text->text() != field.text)
        _text->setText(field.text);
    const auto value = isWritten(field) ? std::string() : fieldValueWords(field);
    _button->setTitle(value);
    _button->setAccessibilityLabel(localized("%1$@: %2$@", {name, value}));
    setNeedsLayout();
}

std::optional<std::string> PreviewFieldBar::takeText()
{
    if (!_field || !isWritten(*_field) || _text->text() == _field->text)
        return std::nullopt;
    _field->text = cut(_text->text(), _field->maxLength);
    if (_text->text() != _field->text)
        _text->setText(_field->text);
    return _field->text;
}

bool PreviewFieldBar::textFieldShouldReturn(kit::TextField&)
{
    if (const auto call = _onNext)
        call();
    return true;
}

void PreviewFieldBar::textFieldDidEndEditing(kit::TextField&)
{
    if (const auto call = _onLeave)
        call();
}

void PreviewFieldBar::layoutSubviews()
{
    const double width = std::max(0.0, bounds().width - 2 * margin);
    _name->setFrame({margin, 2, width, nameHeight});
    const Rect below{margin, nameHeight + 2, width, barHeight - nameHeight - 4};
    _text->setFrame(below);
    _button->setFrame(below);
}

} // namespace screens
