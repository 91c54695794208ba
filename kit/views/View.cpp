// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/views/View.h"

#include "kit/views/ViewVisitor.h"

#include <algorithm>
#include <cmath>

namespace kit {

View::View(const Rect& frame)
    : _frame(frame)
{
}

View::~View() = default;

void View::accept(ViewVisitor& visitor)
{
    visitor.visit(*this);
}

void View::setFrame(const Rect& frame)
{
    if (frame == _frame)
        return;
    const Size before = _frame.size();
    _frame = frame;
    if (frame.size() != before) {
        for (const auto& view : _subviews)
            view->resizeWithSuperview(frame.width - before.width, frame.height - before.height);
    }
    frameDidChange(frame.size() != before);
    changed(ViewChange::Frame);
}

void View::resizeWithSuperview(double widthChange, double heightChange)
{
    if (!isPlacedByFrame())
        return;
    Rect frame = _frame;
    if (autoresizing().flexibleWidth)
        frame.width = std::max(0.0, frame.width + widthChange);
    if (autoresizing().flexibleHeight)
        frame.height = std::max(0.0, frame.height + heightChange);
    setFrame(frame);
}

Point View::convertPoint(Point point, const View& to) const
{
    const Point here = originInRoot(), there = to.originInRoot();
    return {point.x + here.x - there.x, point.y + here.y - there.y};
}

Rect View::convertRect(const Rect& rect, const View& to) const
{
    const Point origin = convertPoint(rect.origin(), to);
    return {origin.x, origin.y, rect.width, rect.height};
}

/// Answers where the origin of the view's own coordinates lies in those of the root's superview.
Point View::originInRoot() const
{
    Point origin;
    const View* view = this;
    for (std::shared_ptr<View> next; view; view = next.get()) {
        origin.x += view->_frame.x - view->_boundsOrigin.x;
        origin.y += view->_frame.y - view->_boundsOrigin.y;
        next = view->superview();
    }
    return origin;
}

void View::addSubview(const std::shared_ptr<View>& view)
{
    insertSubview(view, _subviews.size());
}

void View::insertSubview(const std::shared_ptr<View>& view, std::size_t index)
{
    if (!view || view.get() == this || isDescendantOf(*view))
        return;
    if (view->superview().get() == this) {
        std::erase(_subviews, view);
    } else {
        view->removeFromSuperview();
        view->_superview = weak_from_this();
    }
    _subviews.insert(
        _subviews.begin() + static_cast<std::ptrdiff_t>(std::min(index, _subviews.size())), view);
    layoutInputDidChange();
    view->didJoinLayout();
    changed(ViewChange::Subviews);
}

void View::removeFromSuperview()
{
    const auto superview = _superview.lock();
    if (!superview)
        return;
    const auto self = shared_from_this();
    superview->willRemoveSubview(*this);
    superview->deactivateConstraintsCrossing(*this);
    superview->layoutInputDidChange();
    std::erase(superview->_subviews, self);
    _superview.reset();
    superview->changed(ViewChange::Subviews);
}

std::shared_ptr<Window> View::window() const
{
    if (const auto window = _window.lock())
        return window;
    const auto above = superview();
    return above ? above->window() : nullptr;
}

const TraitCollection& View::traits() const
{
    if (_traits)
        return *_traits;
    const auto above = superview();
    return above ? above->traits() : TraitCollection::application();
}

void View::overrideTraits(std::optional<TraitCollection> traits)
{
    if (traits == _traits)
        return;
    _traits = traits;
    traitsDidChange();
}

void View::traitsDidChange()
{
    directionDidChange();
    changed(ViewChange::Content);
    for (const auto& view : _subviews)
        view->traitsDidChange();
}

void View::setHidden(bool hidden)
{
    if (hidden == _hidden)
        return;
    _hidden = hidden;
    if (const auto above = superview())
        above->subviewVisibilityDidChange();
    changed(ViewChange::Visibility);
}

void View::setAlpha(double alpha)
{
    if (alpha == _alpha)
        return;
    _alpha = alpha;
    changed(ViewChange::Visibility);
}

void View::setStyle(const ViewStyle& style)
{
    if (style == _style)
        return;
    _style = style;
    changed(ViewChange::Style);
}

void View::setBackground(std::optional<Color> color)
{
    ViewStyle style = _style;
    style.background = color;
    setStyle(style);
}

void View::setBorder(double width, const Color& color)
{
    ViewStyle style = _style;
    style.borderWidth = width;
    style.borderColor = color;
    setStyle(style);
}

void View::setNeedsDisplay()
{
    changed(ViewChange::Display);
}

void View::setEnabled(bool enabled)
{
    if (enabled == _enabled)
        return;
    _enabled = enabled;
    changed(ViewChange::Enabled);
}

void View::setAccessibility(Accessibility accessibility)
{
    if (accessibility == _accessibility)
        return;
    _accessibility = std::move(accessibility);
    changed(ViewChange::Accessibility);
}

void View::setAccessibilityLabel(std::string label)
{
    Accessibility accessibility = _accessibility;
    accessibility.label = std::move(label);
    setAccessibility(std::move(accessibility));
}

void View::addGestureRecognizer(std::shared_ptr<GestureRecognizer> recognizer)
{
    _recognizers.push_back(std::move(recognizer));
    changed(ViewChange::Gestures);
}

void View::endEditing()
{
    resignFirstResponder();
    const auto subviews = _subviews;
    for (const auto& view : subviews)
        view->endEditing();
}

void View::changed(ViewChanges changes)
{
    _observer.notify([&](ViewObserver& observer) { observer.viewDidChange(*this, changes); });
}

void View::askForFocus(bool wanted)
{
    _observer.notify([&](ViewObserver& observer) { observer.viewWantsFocus(*this, wanted); });
}

std::optional<Size> View::nativeSize(double maxWidth) const
{
    const auto observer = _observer.lock();
    return observer ? observer->nativeSize(*this, maxWidth) : std::nullopt;
}

void View::setBoundsOrigin(Point origin)
{
    if (origin == _boundsOrigin)
        return;
    _boundsOrigin = origin;
    changed(ViewChange::Bounds);
}

} // namespace kit
