#pragma once

#include "platform/ui/Font.h"
#include "platform/ui/View.h"

#include <string>

namespace platform::ui {

enum class TextSpacing { Proportional, Monospaced };

/// A text of any length that can be read, scrolled and selected but not edited. It scrolls by itself and
/// wraps at the view's width.
class TextView : public View {
public:
    explicit TextView(std::string text = {});

    void accept(ViewVisitor& visitor) override;

    /// Well-formed UTF-8 without NUL characters.
    const std::string& text() const { return _text; }
    void setText(std::string text);
    const Font& font() const { return _font; }
    void setFont(const Font& font);
    TextSpacing spacing() const { return _spacing; }
    void setSpacing(TextSpacing spacing);

private:
    std::string _text;
    Font _font = Font::preferred(TextStyle::Body);
    TextSpacing _spacing = TextSpacing::Proportional;
};

} // namespace platform::ui
