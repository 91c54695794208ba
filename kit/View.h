// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/LayoutItem.h"
#include "kit/ObserverSlot.h"
#include "kit/TraitCollection.h"
#include "kit/ViewObserver.h"
#include "platform/Color.h"

#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace platform::ui {

class Canvas;
class GestureRecognizer;
class LayoutEngine;
class ViewController;
class ViewVisitor;
class Window;

/// How a view is painted. Lengths are points.
struct ViewStyle {
    std::optional<Color> background;
    double borderWidth = 0;
    Color borderColor = Color::black();
    double cornerRadius = 0;
    bool clipsToBounds = false;
    bool operator==(const ViewStyle&) const = default;
};

/// What assistive technology reads.
struct Accessibility {
    std::string label; ///< empty: the text that the view shows
    std::string hint;
    bool isHidden = false;
    bool operator==(const Accessibility&) const = default;
};

/// A rectangle of the interface with its subviews. Made with std::make_shared; a class that gives itself
/// subviews or constraints does so after its constructor has ended. Main thread only.
class View : public LayoutItem, public std::enable_shared_from_this<View> {
public:
    explicit View(const Rect& frame = {});
    ~View() override;

    virtual void accept(ViewVisitor& visitor);
    void setObserver(std::weak_ptr<ViewObserver> observer) { _observer.set(std::move(observer)); }

    // Geometry: the frame is in the superview's coordinates, the bounds in the view's own. Points.
    const Rect& frame() const { return _frame; }
    void setFrame(const Rect& frame);
    Rect bounds() const { return {_boundsOrigin.x, _boundsOrigin.y, _frame.width, _frame.height}; }
    Point convertPoint(Point point, const View& to) const; ///< both in one tree
    Rect convertRect(const Rect& rect, const View& to) const;
    static double roundToPixel(double points); ///< the nearest edge of a device pixel

    // The tree. Later subviews lie in front.
    std::shared_ptr<View> superview() const { return _superview.lock(); }
    const std::vector<std::shared_ptr<View>>& subviews() const { return _subviews; }
    void addSubview(const std::shared_ptr<View>& view);
    void insertSubview(const std::shared_ptr<View>& view, std::size_t index);
    void bringSubviewToFront(const std::shared_ptr<View>& view);
    void removeFromSuperview();
    bool isDescendantOf(const View& view) const; ///< a view is its own descendant
    std::shared_ptr<Window> window() const;
    void setWindow(
        std::weak_ptr<Window> window); ///< the window's affair, for the root view of a shown screen
    const TraitCollection& traits() const; ///< the nearest override, else the application's
    void overrideTraits(std::optional<TraitCollection> traits);

    bool isHidden() const { return _hidden; }
    void setHidden(bool hidden);
    double alpha() const { return _alpha; }
    void setAlpha(double alpha);
    const ViewStyle& style() const { return _style; }
    void setStyle(const ViewStyle& style);
    void setBackground(std::optional<Color> color);
    void setBorder(double width, const Color& color);
    virtual bool drawsItself() const { return false; } ///< whether `drawRect` draws anything
    virtual void drawRect(Canvas&) const { }
    void setNeedsDisplay();

    bool isEnabled() const { return _enabled; }
    void setEnabled(bool enabled);
    const Accessibility& accessibility() const { return _accessibility; }
    void setAccessibility(Accessibility accessibility);
    void setAccessibilityLabel(std::string label);
    const std::vector<std::shared_ptr<GestureRecognizer>>& gestureRecognizers() const { return _recognizers; }
    void addGestureRecognizer(std::shared_ptr<GestureRecognizer> recognizer);
    const std::string& debugName() const { return _debugName; }
    void setDebugName(std::string name) { _debugName = std::move(name); }

    void setNeedsLayout();
    void layoutIfNeeded(); ///< lays out the whole tree that the view stands in, where it is stale
    virtual void layoutSubviews() { }
    void invalidateIntrinsicContentSize() override;
    LayoutAnchor anchor(LayoutAttribute attribute) const override;
    virtual Size sizeThatFits(Size limit) const; ///< a limit of 0: none
    virtual void sizeToFit(); ///< keeps the origin
    /// The smallest size that the constraints below allow; a positive target side is kept.
    Size systemLayoutSizeFitting(Size target);
    /// The root of a layout of its own: constraints inside have nothing to do with views outside.
    void setLayoutBoundary(bool boundary);

    virtual bool becomeFirstResponder() { return false; } ///< a plain view never takes the focus
    virtual bool resignFirstResponder() { return true; }
    void endEditing(); ///< the focus leaves this view and everything below, where that is allowed

protected:
    void changed(ViewChanges changes);
    void askForFocus(bool wanted);
    std::optional<Size> nativeSize(double maxWidth) const;
    void setBoundsOrigin(Point origin);
    void layoutInputDidChange() override;
    void constraintConstantDidChange(const LayoutConstraint& constraint) override;
    virtual void subviewVisibilityDidChange() { }
    virtual void willRemoveSubview(View&) { }

private:
    friend class LayoutConstraint;
    friend class LayoutEngine;
    friend class ViewController;

    View& layoutRoot();
    LayoutEngine& engine();
    void markTreeForLayout();
    void traitsDidChange();
    void resizeWithSuperview(double widthChange, double heightChange);
    void deactivateConstraintsCrossing(const View& part);
    Point originInRoot() const;

    Rect _frame;
    Point _boundsOrigin;
    std::weak_ptr<View> _superview;
    std::vector<std::shared_ptr<View>> _subviews;
    std::vector<std::shared_ptr<GestureRecognizer>> _recognizers;
    std::weak_ptr<Window> _window;
    std::weak_ptr<ViewController> _controller;
    std::unique_ptr<LayoutEngine> _engine;
    ObserverSlot<ViewObserver> _observer;
    std::optional<TraitCollection> _traits;
    ViewStyle _style;
    Accessibility _accessibility;
    std::string _debugName;
    double _alpha = 1;
    bool _hidden = false, _enabled = true;
    bool _needsLayout = true, _treeNeedsLayout = true, _layoutBoundary = false;
};

} // namespace platform::ui
