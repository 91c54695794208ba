#include "platform/ui/TextView.h"

#include "platform/ui/ViewVisitor.h"

#include <utility>

namespace platform::ui {

TextView::TextView(std::string text)
    : _text(std::move(text))
{
}

void TextView::accept(ViewVisitor& visitor)
{
    visitor.visit(*this);
}

void TextView::setText(std::string text)
{
    if (text == _text)
        return;
    _text = std::move(text);
    changed(ViewChange::Content);
}

void TextView::setFont(const Font& font)
{
    if (font == _font)
        return;
    _font = font;
    changed(ViewChange::Content);
}

void TextView::setSpacing(TextSpacing spacing)
{
    if (std::exchange(_spacing, spacing) != spacing)
        changed(ViewChange::Content);
}

} // namespace platform::ui
