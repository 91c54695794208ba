// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/views/View.h"

namespace kit {

class ScrollView;

enum class Bounce { Never, WhenLarger, Always };

/// Says which indicators a scroll view shows and how it moves at its ends.
struct ScrollBehavior {
    bool showsHorizontalIndicator = true, showsVerticalIndicator = true;
    Bounce horizontalBounce = Bounce::WhenLarger, verticalBounce = Bounce::WhenLarger;
    bool operator==(const ScrollBehavior&) const = default;
};

/// Calls down that only a scroll view makes, beside those of ViewObserver.
class ScrollObserver {
public:
    virtual ~ScrollObserver() = default;
    /// The program scrolls. The offset of the model has already changed.
    virtual void scrollTo(ScrollView& view, Point offset, bool animated) = 0;
    /// The content size, the insets or the behaviour has changed.
    virtual void scrollExtentDidChange(ScrollView& view) = 0;
};

/// Shows a part of content that is larger than the view. The content is placed by frames, from (0, 0) to the
/// content size; the offset is the origin of the bounds.
class ScrollView : public View {
public:
    using View::View;

    void accept(ViewVisitor& visitor) override;
    void setScrollObserver(std::weak_ptr<ScrollObserver> observer)
    {
        _scrollObserver.set(std::move(observer));
    }

    Size contentSize() const { return _contentSize; }
    void setContentSize(Size size);
    const EdgeInsets& contentInsets() const { return _contentInsets; }
    void setContentInsets(const EdgeInsets& insets);
    const ScrollBehavior& scrollBehavior() const { return _behavior; }
    void setScrollBehavior(const ScrollBehavior& behavior);

    Point contentOffset() const { return bounds().origin(); }
    void setContentOffset(Point offset, bool animated = false);
    /// Scrolls by the least distance that brings a rectangle of the content into view.
    void scrollRectToVisible(const Rect& rect, bool animated);

    /// Event up: the user scrolled to an offset.
    void userScrolled(Point offset);

protected:
    virtual void contentOffsetDidChange() { }

private:
    Size _contentSize;
    EdgeInsets _contentInsets;
    ScrollBehavior _behavior;
    ObserverSlot<ScrollObserver> _scrollObserver;
};

} // namespace kit
