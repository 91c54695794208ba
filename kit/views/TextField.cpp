// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/views/TextField.h"

#include "kit/values/TextMeasurer.h"
#include "kit/views/ViewVisitor.h"

#include <algorithm>
#include <vector>

namespace kit {

namespace {

// An empty field still has room for a few characters. The frame of the field decides the rest.
constexpr double minimumWidth = 64;
constexpr double horizontalPadding = 8, verticalPadding = 7;

bool continuesCharacter(char byte)
{
    return (static_cast<unsigned char>(byte) & 0xC0U) == 0x80U;
}

/// Answers where each character begins, and the end of the text.
std::vector<std::size_t> characterStarts(const std::string& text)
{
    std::vector<std::size_t> starts;
    for (std::size_t byte = 0; byte < text.size(); ++byte) {
        if (!continuesCharacter(text[byte]))
            starts.push_back(byte);
    }
    starts.push_back(text.size());
    return starts;
}

struct Edit {
    TextRange range; ///< in the old text
    std::string replacement;
};

/// Answers the one range in which two texts differ.
Edit editBetween(const std::string& before, const std::string& after)
{
    const auto old = characterStarts(before), now = characterStarts(after);
    const std::size_t oldCount = old.size() - 1, newCount = now.size() - 1;
    const auto same = [&](std::size_t a, std::size_t b) {
        return before.compare(old[a], old[a + 1] - old[a], after, now[b], now[b + 1] - now[b]) == 0;
    };
    std::size_t head = 0, tail = 0;
    while (head < std::min(oldCount, newCount) && same(head, head))
        ++head;
    while (tail < std::min(oldCount, newCount) - head && same(oldCount - 1 - tail, newCount - 1 - tail))
        ++tail;
    return {{head, oldCount - head - tail}, after.substr(now[head], now[newCount - tail] - now[head])};
}

} // namespace

TextField::TextField(std::string text)
    : _text(std::move(text))
{
    _selection = {length(), 0};
}

void TextField::accept(ViewVisitor& visitor)
{
    visitor.visit(*this);
}

std::size_t TextField::length() const
{
    return characterStarts(_text).size() - 1;
}

void TextField::setText(std::string text)
{
    if (text == _text)
        return;
    _text = std::move(text);
    _selection = {length(), 0};
    invalidateIntrinsicContentSize();
    changed(ViewChange::Content | ViewChange::Selection);
}

void TextField::setPlaceholder(std::string placeholder)
{
    if (placeholder == _placeholder)
        return;
    _placeholder = std::move(placeholder);
    invalidateIntrinsicContentSize();
    changed(ViewChange::Content);
}

void TextField::setFont(const Font& font)
{
    if (font == _font)
        return;
    _font = font;
    invalidateIntrinsicContentSize();
    changed(ViewChange::Content);
}

void TextField::setAlignment(TextAlignment alignment)
{
    if (alignment == _alignment)
        return;
    _alignment = alignment;
    changed(ViewChange::Content);
}

void TextField::setInputTraits(const TextInputTraits& traits)
{
    if (traits == _inputTraits)
        return;
    _inputTraits = traits;
    changed(ViewChange::Content);
}

void TextField::setFieldStyle(FieldStyle style)
{
    if (style == _fieldStyle)
        return;
    _fieldStyle = style;
    changed(ViewChange::Content);
}

void TextField::setSelectedRange(TextRange range)
{
    const std::size_t end = length();
    range.location = std::min(range.location, end);
    range.length = std::min(range.length, end - range.location);
    // The observer is told of an equal range, too, because the native field may be about to select another
    // one.
    _selection = range;
    changed(ViewChange::Selection);
}

bool TextField::becomeFirstResponder()
{
    if (_editing)
        return true;
    const auto delegate = _delegate.lock();
    if (!isEnabled() || (delegate && !delegate->textFieldShouldBeginEditing(*this))) {
        askForFocus(false);
        return false;
    }
    _editing = true;
    changed(ViewChange::Content);
    askForFocus(true);
    if (delegate)
        delegate->textFieldDidBeginEditing(*this);
    return true;
}

bool TextField::resignFirstResponder()
{
    if (!_editing)
        return true;
    const auto delegate = _delegate.lock();
    if (delegate && !delegate->textFieldShouldEndEditing(*this)) {
        askForFocus(true);
        return false;
    }
    // The delegate may have ended the editing itself while it was asked.
    if (!_editing)
        return true;
    _editing = false;
    changed(ViewChange::Content);
    askForFocus(false);
    if (delegate)
        delegate->textFieldDidEndEditing(*this);
    return true;
}

bool TextField::userEdited(const std::string& text, TextRange selection)
{
    if (text == _text) {
        userSelected(selection);
        return true;
    }
    const auto edit = editBetween(_text, text);
    const auto delegate = _delegate.lock();
    if (delegate
        && !delegate->textFieldShouldChangeCharactersInRangeReplacementString(
            *this, edit.range, edit.replacement)) {
        changed(ViewChange::Content | ViewChange::Selection);
        return false;
    }
    _text = text;
    _selection = {};
    invalidateIntrinsicContentSize();
    userSelected(selection);
    if (const auto callback = _onEditingChanged)
        callback();
    return true;
}

void TextField::userSelected(TextRange selection)
{
    const std::size_t end = length();
    _selection.location = std::min(selection.location, end);
    _selection.length = std::min(selection.length, end - _selection.location);
}

bool TextField::userPressedReturn()
{
    if (_inputTraits.returnKeyNeedsText && _text.empty())
        return false;
    const auto delegate = _delegate.lock();
    return !delegate || delegate->textFieldShouldReturn(*this);
}

Size TextField::intrinsicContentSize(double maxWidth) const
{
    const double lineHeight = _font.lineHeight();
    const auto& shown = _text.empty() ? _placeholder : _text;
    const double textWidth = TextMeasurer::current().measure(shown, _font, {0, 1}).width;
    const Size size{
        std::max(minimumWidth, textWidth + 2 * horizontalPadding), lineHeight + 2 * verticalPadding};
    return nativeSize(maxWidth).value_or(size);
}

double TextField::firstBaselineOffset() const
{
    const auto metrics = _font.metrics();
    return (std::max(frame().height, metrics.lineHeight) - metrics.lineHeight) / 2 + metrics.ascender;
}

double TextField::lastBaselineOffset() const
{
    const auto metrics = _font.metrics();
    return (std::max(frame().height, metrics.lineHeight) - metrics.lineHeight) / 2 - metrics.descender;
}

} // namespace kit
