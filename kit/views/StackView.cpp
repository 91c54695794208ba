// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/views/StackView.h"

#include <algorithm>
#include <utility>

namespace kit {

namespace {

// A stack is as small as its content. The priority is the lowest one, so that this decides only what no other
// constraint decides.
constexpr LayoutPriority asSmallAsPossible = 1;

/// The attributes along and across a stack.
struct StackAttributes {
    LayoutAttribute start, end, length, center, crossStart, crossEnd, crossLength, crossCenter;
};

StackAttributes attributes(Axis axis)
{
    using enum LayoutAttribute;
    if (axis == Axis::Horizontal)
        return {Leading, Trailing, Width, CenterX, Top, Bottom, Height, CenterY};
    return {Top, Bottom, Height, CenterY, Leading, Trailing, Width, CenterX};
}

/// Makes the constraints of one stack, in the order of the layout.
class StackBuilder {
public:
    StackBuilder(const StackView& stack, std::vector<std::shared_ptr<View>> visible)
        : _stack(stack)
        , _visible(std::move(visible))
        , _names(attributes(stack.axis()))
    {
    }

    LayoutConstraints build()
    {
        if (!_visible.empty()) {
            addEnds();
            for (std::size_t index = 1; index < _visible.size(); ++index)
                addPair(*_visible[index - 1], *_visible[index]);
            for (const auto& view : _visible)
                addAcross(*view);
            if (_stack.stackAlignment() == StackAlignment::FirstBaseline)
                addBaselines();
        }
        add(_stack.anchor(_names.length).equalToConstant(0)->withPriority(asSmallAsPossible));
        add(_stack.anchor(_names.crossLength).equalToConstant(0)->withPriority(asSmallAsPossible));
        return std::move(_made);
    }

private:
    void add(std::shared_ptr<LayoutConstraint> constraint) { _made.push_back(std::move(constraint)); }

    void addEnds()
    {
        add(_visible.front()->anchor(_names.start).equalTo(_stack.anchor(_names.start)));
        add(_visible.back()->anchor(_names.end).equalTo(_stack.anchor(_names.end)));
    }

    void addPair(const View& before, const View& after)
    {
        const auto gap = after.anchor(_names.start);
        const auto end = before.anchor(_names.end);
        if (_stack.distribution() == StackDistribution::FillEqually)
            add(after.anchor(_names.length).equalTo(_visible.front()->anchor(_names.length)));
        add(gap.equalTo(end, _stack.spacing()));
    }

    void addAcross(const View& view)
    {
        const auto start = view.anchor(_names.crossStart), end = view.anchor(_names.crossEnd);
        const auto stackStart = _stack.anchor(_names.crossStart), stackEnd = _stack.anchor(_names.crossEnd);
        const auto alignment = _stack.stackAlignment();
        const bool atStart = alignment == StackAlignment::Fill || alignment == StackAlignment::Leading;
        const bool atEnd = alignment == StackAlignment::Fill || alignment == StackAlignment::Trailing;
        add(atStart ? start.equalTo(stackStart) : start.greaterThanOrEqualTo(stackStart));
        add(atEnd ? end.equalTo(stackEnd) : end.lessThanOrEqualTo(stackEnd));
        if (alignment == StackAlignment::Center)
            add(view.anchor(_names.crossCenter).equalTo(_stack.anchor(_names.crossCenter)));
    }

    void addBaselines()
    {
        for (std::size_t index = 1; index < _visible.size(); ++index)
            add(_visible[index]->firstBaselineAnchor().equalTo(_visible.front()->firstBaselineAnchor()));
    }

    const StackView& _stack;
    std::vector<std::shared_ptr<View>> _visible;
    StackAttributes _names;
    LayoutConstraints _made;
};

} // namespace

StackView::StackView(Axis axis)
    : _axis(axis)
{
}

void StackView::arrangementDidChange()
{
    setNeedsUpdateConstraints();
    changed(ViewChange::IntrinsicSize);
}

void StackView::addArrangedSubview(const std::shared_ptr<View>& view)
{
    insertArrangedSubview(view, _arranged.size());
}

void StackView::insertArrangedSubview(const std::shared_ptr<View>& view, std::size_t index)
{
    std::erase(_arranged, view);
    if (view->superview().get() != this)
        addSubview(view);
    view->setPlacedByFrame(false);
    _arranged.insert(
        _arranged.begin() + static_cast<std::ptrdiff_t>(std::min(index, _arranged.size())), view);
    arrangementDidChange();
}

void StackView::removeArrangedSubview(const std::shared_ptr<View>& view)
{
    if (std::erase(_arranged, view) > 0)
        arrangementDidChange();
}

void StackView::setAxis(Axis axis)
{
    if (std::exchange(_axis, axis) != axis)
        arrangementDidChange();
}

void StackView::setStackAlignment(StackAlignment alignment)
{
    if (std::exchange(_alignment, alignment) != alignment)
        arrangementDidChange();
}

void StackView::setDistribution(StackDistribution distribution)
{
    if (std::exchange(_distribution, distribution) != distribution)
        arrangementDidChange();
}

void StackView::setSpacing(double points)
{
    if (std::exchange(_spacing, points) != points)
        arrangementDidChange();
}

void StackView::updateConstraints()
{
    LayoutConstraint::deactivate(_own);
    std::vector<std::shared_ptr<View>> visible;
    std::ranges::copy_if(
        _arranged, std::back_inserter(visible), [](const auto& view) { return !view->isHidden(); });
    _own = StackBuilder(*this, std::move(visible)).build();
    LayoutConstraint::activate(_own);
}

void StackView::subviewVisibilityDidChange()
{
    arrangementDidChange();
}

void StackView::willRemoveSubview(View& view)
{
    removeArrangedSubview(view.shared_from_this());
}

} // namespace kit
