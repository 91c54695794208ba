// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/AttributedText.h"
#include "kit/views/View.h"

namespace kit {

enum class TextAlignment { Natural, Left, Center, Right };
enum class LineBreak { WordWrap, TruncateTail, TruncateMiddle };

/// Shows text that cannot be edited.
class Label : public View {
public:
    explicit Label(std::string text = {});

    void accept(ViewVisitor& visitor) override;

    const std::string& text() const { return _text; }
    /// Sets the text; a styled text is dropped.
    void setText(std::string text);
    const std::optional<AttributedText>& attributedText() const { return _attributedText; }
    /// Sets the styled text; `text()` then answers its characters.
    void setAttributedText(std::optional<AttributedText> text);

    const Font& font() const { return _font; }
    void setFont(const Font& font);
    const std::optional<Color>& textColor() const { return _textColor; } ///< nothing: the platform's
    void setTextColor(std::optional<Color> color);
    TextAlignment alignment() const { return _alignment; }
    void setAlignment(TextAlignment alignment);
    LineBreak lineBreak() const { return _lineBreak; }
    void setLineBreak(LineBreak lineBreak);
    int maxLines() const { return _maxLines; } ///< 1 at first; 0: as many as it takes
    void setMaxLines(int lines);

    Size intrinsicContentSize(double maxWidth = 0) const override;
    bool wrapsContent() const override { return _maxLines != 1; }
    double firstBaselineOffset() const override;
    double lastBaselineOffset() const override;

private:
    void textDidChange();

    std::string _text;
    std::optional<AttributedText> _attributedText;
    Font _font = Font::preferred(TextStyle::Body);
    std::optional<Color> _textColor;
    TextAlignment _alignment = TextAlignment::Natural;
    LineBreak _lineBreak = LineBreak::TruncateTail;
    int _maxLines = 1;
};

} // namespace kit
