// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/views/Button.h"

#include "kit/views/ViewVisitor.h"

#include <algorithm>

namespace kit {

namespace {

// The side of an icon whose size the theme decides, and its distance to the title.
constexpr double namedIconSide = 16;
constexpr double iconSpacing = 6;

Size imageSize(const Image& image)
{
    return image.isNamed() ? Size{namedIconSide, namedIconSide} : image.size();
}

} // namespace

Button::Button(std::string title, std::function<void()> action)
    : _titleLabel(std::make_shared<Label>(std::move(title)))
    , _action(std::move(action))
{
}

std::shared_ptr<Button> Button::withSymbol(
    const char* icon, const std::string& label, std::function<void()> action)
{
    auto button = std::make_shared<Button>(std::string(), std::move(action));
    button->setImage(Image::named(icon));
    button->setAccessibilityLabel(label);
    return button;
}

void Button::accept(ViewVisitor& visitor)
{
    visitor.visit(*this);
}

void Button::contentDidChange()
{
    invalidateIntrinsicContentSize();
    changed(ViewChange::Content);
}

void Button::setTitle(std::string title)
{
    if (title == _titleLabel->text())
        return;
    _titleLabel->setText(std::move(title));
    contentDidChange();
}

void Button::setTitleFont(const Font& font)
{
    if (font == _titleLabel->font())
        return;
    _titleLabel->setFont(font);
    contentDidChange();
}

void Button::setImage(std::optional<Image> image)
{
    if (image == _image)
        return;
    _image = std::move(image);
    contentDidChange();
}

void Button::setButtonStyle(ButtonStyle style)
{
    if (style == _buttonStyle)
        return;
    _buttonStyle = style;
    contentDidChange();
}

void Button::setContentInsets(const EdgeInsets& insets)
{
    if (insets == _contentInsets)
        return;
    _contentInsets = insets;
    contentDidChange();
}

bool Button::press()
{
    if (!isEnabled() || isHidden())
        return false;
    // The action may set another action or release the button.
    const auto keepAlive = shared_from_this();
    if (const auto action = _action)
        action();
    return true;
}

Size Button::intrinsicContentSize(double maxWidth) const
{
    if (const auto size = nativeSize(maxWidth))
        return *size;
    Size content = _titleLabel->intrinsicContentSize();
    if (_image) {
        const Size image = imageSize(*_image);
        content.width += image.width + (content.width > 0 ? iconSpacing : 0);
        content.height = std::max(content.height, image.height);
    }
    return {content.width + _contentInsets.left + _contentInsets.right,
        content.height + _contentInsets.top + _contentInsets.bottom};
}

double Button::firstBaselineOffset() const
{
    return _contentInsets.top + _titleLabel->firstBaselineOffset();
}

double Button::lastBaselineOffset() const
{
    return _contentInsets.bottom + _titleLabel->lastBaselineOffset();
}

void Button::layoutSubviews()
{
    placeTitle();
}

void Button::sizeToFit()
{
    View::sizeToFit();
    placeTitle();
}

/// Places the title to the right of the image, and centres both together.
void Button::placeTitle()
{
    const Size title = _titleLabel->intrinsicContentSize();
    const double imageWidth = _image ? imageSize(*_image).width + (title.width > 0 ? iconSpacing : 0) : 0;
    _titleLabel->setFrame({roundToPixel((bounds().width - title.width + imageWidth) / 2),
        roundToPixel((bounds().height - title.height) / 2), title.width, title.height});
}

} // namespace kit
