// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/views/Label.h"

#include "kit/values/TextMeasurer.h"
#include "kit/views/ViewVisitor.h"

#include <cmath>

namespace kit {

namespace {

// Sizes are rounded up, because a text that lost a fraction of a pixel would be cut or wrapped.
Size roundedUp(Size size)
{
    const auto up = [](double points) {
        const double rounded = View::roundToPixel(points);
        return rounded < points - 1e-9 ? View::roundToPixel(points + (points - rounded)) : rounded;
    };
    return {up(size.width), up(size.height)};
}

} // namespace

Label::Label(std::string text)
    : _text(std::move(text))
{
}

void Label::accept(ViewVisitor& visitor)
{
    visitor.visit(*this);
}

void Label::textDidChange()
{
    invalidateIntrinsicContentSize();
    changed(ViewChange::Content);
}

void Label::setText(std::string text)
{
    if (text == _text && !_attributedText)
        return;
    _text = std::move(text);
    _attributedText.reset();
    textDidChange();
}

void Label::setAttributedText(std::optional<AttributedText> text)
{
    if (text == _attributedText)
        return;
    _attributedText = std::move(text);
    _text = _attributedText ? _attributedText->plainText() : std::string();
    textDidChange();
}

void Label::setFont(const Font& font)
{
    if (font == _font)
        return;
    _font = font;
    textDidChange();
}

void Label::setTextColor(std::optional<Color> color)
{
    if (color == _textColor)
        return;
    _textColor = color;
    changed(ViewChange::Content);
}

void Label::setAlignment(TextAlignment alignment)
{
    if (alignment == _alignment)
        return;
    _alignment = alignment;
    changed(ViewChange::Content);
}

void Label::setLineBreak(LineBreak lineBreak)
{
    if (lineBreak == _lineBreak)
        return;
    _lineBreak = lineBreak;
    changed(ViewChange::Content);
}

void Label::setMaxLines(int lines)
{
    if (lines == _maxLines)
        return;
    _maxLines = lines;
    textDidChange();
}

Size Label::intrinsicContentSize(double maxWidth) const
{
    const auto& measurer = TextMeasurer::current();
    const TextLimits limits{maxWidth, _maxLines};
    if (_attributedText)
        return roundedUp(measurer.measure(*_attributedText, _font, limits));
    if (_text.empty())
        return {0, 0};
    return roundedUp(measurer.measure(_text, _font, limits));
}

double Label::firstBaselineOffset() const
{
    return _font.metrics().ascender;
}

double Label::lastBaselineOffset() const
{
    return -_font.metrics().descender;
}

} // namespace kit
