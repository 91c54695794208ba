// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/layout/LayoutConstraint.h"
#include "kit/values/PlatformNames.h"
#include "platform/Geometry.h"

#include <array>
#include <memory>
#include <string>
#include <vector>

namespace kit {

class LayoutEngine;

enum class Axis { Horizontal, Vertical };

/// Says how the layout of the parent treats an item that is placed by its frame.
struct Autoresizing {
    bool flexibleWidth = false; ///< grows and shrinks with the parent
    bool flexibleHeight = false;
    bool operator==(const Autoresizing&) const = default;
};

/// A rectangle that takes part in a layout: its place in the tree, its anchors, priorities and wanted sizes.
/// The root of a tree owns the engine that lays the tree out. Lengths are points. Main thread only.
class LayoutItem {
public:
    LayoutItem();
    virtual ~LayoutItem();
    LayoutItem(const LayoutItem&) = delete;
    LayoutItem& operator=(const LayoutItem&) = delete;

    // The tree. A frame is in the coordinates of the parent.
    virtual std::shared_ptr<LayoutItem> layoutParent() const = 0;
    virtual std::vector<std::shared_ptr<LayoutItem>> layoutChildren() const = 0;
    bool isInside(const LayoutItem& item) const; ///< an item is inside itself
    virtual const Rect& frame() const = 0;
    virtual void setFrame(const Rect& frame) = 0;
    virtual bool isRightToLeft() const = 0;
    /// The log calls the item by this name.
    const std::string& debugName() const { return _debugName; }
    void setDebugName(std::string name) { _debugName = std::move(name); }

    void setNeedsLayout();
    void layoutIfNeeded(); ///< lays out the whole tree that the item stands in, where it is stale
    /// Makes the item the root of a separate layout, so that no constraint joins an item inside with one
    /// outside.
    void setLayoutBoundary(bool boundary);
    /// Answers the smallest size that the constraints below allow; a positive side of the target is kept.
    Size systemLayoutSizeFitting(Size target);
    static double roundToPixel(double points); ///< the nearest edge of a device pixel

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

    /// At first this is true, and the frame gives the item's place. When it is false, constraints give the
    /// place. A stack view switches it off for the views that it arranges.
    bool isPlacedByFrame() const { return _placedByFrame; }
    void setPlacedByFrame(bool placedByFrame);
    Autoresizing autoresizing() const { return _autoresizing; }
    void setAutoresizing(Autoresizing autoresizing) { _autoresizing = autoresizing; }

    /// Says how strongly the item stays as small as its content; at 0 or less it does not.
    LayoutPriority hugging(Axis axis) const { return _hugging[static_cast<std::size_t>(axis)]; }
    void setHugging(LayoutPriority priority, Axis axis);
    /// Says how strongly the item stays as large as its content; at 0 or less it does not.
    LayoutPriority compressionResistance(Axis axis) const
    {
        return _resistance[static_cast<std::size_t>(axis)];
    }
    void setCompressionResistance(LayoutPriority priority, Axis axis);

    static constexpr double noIntrinsicMetric = -1;
    /// Answers the size that the content wants when it may be `maxWidth` wide (0: any width). A side for
    /// which it has no wish is `noIntrinsicMetric`.
    virtual Size intrinsicContentSize(double maxWidth = 0) const;
    /// Answers whether the wanted height depends on the width.
    virtual bool wrapsContent() const { return false; }
    /// Answers how far the first baseline lies below the top; the next one, how far the last baseline lies
    /// above the bottom.
    virtual double firstBaselineOffset() const;
    virtual double lastBaselineOffset() const { return 0; }
    /// Call this when the content wants another size.
    virtual void invalidateIntrinsicContentSize();

    /// The active constraints whose first anchor is on this item.
    const LayoutConstraints& constraints() const { return _constraints; }

    /// Called once before the next layout after `setNeedsUpdateConstraints`.
    virtual void updateConstraints() { }
    void setNeedsUpdateConstraints();

protected:
    /// Answers a reference that keeps the item itself alive.
    virtual std::shared_ptr<LayoutItem> layoutReference() = 0;
    /// Called when the item has its frame, so that it can place its content.
    virtual void layOutContent() = 0;
    /// Called on the root of a tree when something in it becomes stale, once until the next layout.
    virtual void layoutDidBecomeStale() = 0;

    void layoutInputDidChange(); ///< priorities, constraints, the tree or the kind of placement
    void directionDidChange();
    /// The item already has the new frame. A new size makes its content stale.
    void frameDidChange(bool isAnotherSize);
    /// The item became a child. Unless it is a boundary, the engine of another root lays it out from now on.
    void didJoinLayout();
    /// Deactivates the constraints between the items inside a part of this tree and the items outside of that
    /// part.
    void deactivateConstraintsCrossing(const LayoutItem& part);

private:
    friend class LayoutConstraint;
    friend class LayoutEngine;

    LayoutItem& layoutRoot();
    LayoutEngine& engine();
    void deactivateCrossingBelow(const LayoutItem& part);
    void markTreeForLayout();
    void constraintConstantDidChange(const LayoutConstraint& constraint);

    LayoutConstraints _constraints;
    std::unique_ptr<LayoutEngine> _engine;
    std::string _debugName;
    std::array<LayoutPriority, 2> _hugging{LayoutPriorities::defaultLow, LayoutPriorities::defaultLow};
    std::array<LayoutPriority, 2> _resistance{LayoutPriorities::defaultHigh, LayoutPriorities::defaultHigh};
    Autoresizing _autoresizing;
    bool _placedByFrame = true, _needsUpdateConstraints = true;
    bool _needsLayout = true, _treeNeedsLayout = true, _layoutBoundary = false;
};

} // namespace kit
