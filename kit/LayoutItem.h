// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/LayoutConstraint.h"
#include "platform/Geometry.h"

#include <array>

namespace platform::ui {

enum class Axis { Horizontal, Vertical };

/// How the superview's layout treats a view that is placed by its frame.
struct Autoresizing {
    bool flexibleWidth = false; ///< grows and shrinks with the superview
    bool flexibleHeight = false;
    bool operator==(const Autoresizing&) const = default;
};

/// The side of a view that the layout works with: its anchors, priorities and wanted sizes. Lengths are
/// points.
class LayoutItem {
public:
    LayoutItem() = default;
    virtual ~LayoutItem() = default;
    LayoutItem(const LayoutItem&) = delete;
    LayoutItem& operator=(const LayoutItem&) = delete;

    virtual LayoutAnchor anchor(LayoutAttribute attribute) const = 0;
    LayoutAnchor leadingAnchor() const { return anchor(LayoutAttribute::Leading); }
    LayoutAnchor trailingAnchor() const { return anchor(LayoutAttribute::Trailing); }
    LayoutAnchor leftAnchor() const { return anchor(LayoutAttribute::Left); }
    LayoutAnchor rightAnchor() const { return anchor(LayoutAttribute::Right); }
    LayoutAnchor topAnchor() const { return anchor(LayoutAttribute::Top); }
    LayoutAnchor bottomAnchor() const { return anchor(LayoutAttribute::Bottom); }
    LayoutAnchor widthAnchor() const { return anchor(LayoutAttribute::Width); }
    LayoutAnchor heightAnchor() const { return anchor(LayoutAttribute::Height); }
    LayoutAnchor centerXAnchor() const { return anchor(LayoutAttribute::CenterX); }
    LayoutAnchor centerYAnchor() const { return anchor(LayoutAttribute::CenterY); }
    LayoutAnchor firstBaselineAnchor() const { return anchor(LayoutAttribute::FirstBaseline); }
    LayoutAnchor lastBaselineAnchor() const { return anchor(LayoutAttribute::LastBaseline); }

    /// True at first: the frame is the view's place. False: constraints place it. A stack view switches it
    /// off for what it arranges.
    bool isPlacedByFrame() const { return _placedByFrame; }
    void setPlacedByFrame(bool placedByFrame);
    Autoresizing autoresizing() const { return _autoresizing; }
    void setAutoresizing(Autoresizing autoresizing) { _autoresizing = autoresizing; }

    /// How strongly the view stays as small as its content; 0 or less: not at all.
    LayoutPriority hugging(Axis axis) const { return _hugging[static_cast<std::size_t>(axis)]; }
    void setHugging(LayoutPriority priority, Axis axis);
    /// How strongly it stays as large as its content.
    LayoutPriority compressionResistance(Axis axis) const
    {
        return _resistance[static_cast<std::size_t>(axis)];
    }
    void setCompressionResistance(LayoutPriority priority, Axis axis);

    static constexpr double noIntrinsicMetric = -1;
    /// The size that the content wants when it may be `maxWidth` wide (0: any width). A side without a wish
    /// is `noIntrinsicMetric`.
    virtual Size intrinsicContentSize(double maxWidth = 0) const;
    /// Whether the wanted height depends on the width.
    virtual bool wrapsContent() const { return false; }
    /// Where the first line stands below the top and the last line above the bottom.
    virtual double firstBaselineOffset() const;
    virtual double lastBaselineOffset() const { return 0; }
    virtual void invalidateIntrinsicContentSize() = 0;

    /// The active constraints whose first anchor is on this view.
    const LayoutConstraints& constraints() const { return _constraints; }

    /// Called before the next layout after `setNeedsUpdateConstraints`.
    virtual void updateConstraints() { }
    void setNeedsUpdateConstraints();

protected:
    virtual void layoutInputDidChange() = 0; ///< priorities, constraints or the kind of placement
    virtual void constraintConstantDidChange(const LayoutConstraint& constraint) = 0;

private:
    friend class LayoutConstraint;
    friend class LayoutEngine;

    LayoutConstraints _constraints;
    std::array<LayoutPriority, 2> _hugging{LayoutPriorities::defaultLow, LayoutPriorities::defaultLow};
    std::array<LayoutPriority, 2> _resistance{LayoutPriorities::defaultHigh, LayoutPriorities::defaultHigh};
    Autoresizing _autoresizing;
    bool _placedByFrame = true;
    bool _needsUpdateConstraints = true;
};

} // namespace platform::ui
