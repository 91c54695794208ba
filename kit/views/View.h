// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/layout/LayoutItem.h"
#include "kit/values/ObserverSlot.h"
#include "kit/values/PlatformNames.h"
#include "kit/values/TraitCollection.h"
#include "kit/views/ViewObserver.h"
#include "platform/Color.h"

#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace kit {

class Canvas;
class GestureRecognizer;
class ViewOwner;
class ViewVisitor;
class Window;

/// Says how a view is painted. Lengths are points.
struct ViewStyle {
    std::optional<Color> background;
    double borderWidth = 0;
    Color borderColor = Color::black();
    double cornerRadius = 0;
    bool clipsToBounds = false;
    bool operator==(const ViewStyle&) const = default;
};

/// The texts that assistive technology reads.
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

    // The frame is in the superview's coordinates, the bounds are in the view's own. Lengths are points.
    const Rect& frame() const override { return _frame; }
    void setFrame(const Rect& frame) override;
    Rect bounds() const { return {_boundsOrigin.x, _boundsOrigin.y, _frame.width, _frame.height}; }
    Point convertPoint(Point point, const View& to) const; ///< both in one tree
    Rect convertRect(const Rect& rect, const View& to) const;

    // The tree. Later subviews lie in front of earlier ones.
    std::shared_ptr<View> superview() const { return _superview.lock(); }
    const std::vector<std::shared_ptr<View>>& subviews() const { return _subviews; }
    void addSubview(const std::shared_ptr<View>& view);
    void insertSubview(const std::shared_ptr<View>& view, std::size_t index);
    void removeFromSuperview();
    std::shared_ptr<LayoutItem> layoutParent() const override;
    std::vector<std::shared_ptr<LayoutItem>> layoutChildren() const override;
    bool isDescendantOf(const View& view) const { return isInside(view); } ///< a view is its own descendant
    std::shared_ptr<Window> window() const;
    /// The window calls this on the root view of a shown screen.
    void setWindow(std::weak_ptr<Window> window) { _window = std::move(window); }
    /// The screen calls this on its root view.
    void setOwner(std::weak_ptr<ViewOwner> owner) { _owner = std::move(owner); }
    const TraitCollection& traits() const; ///< the nearest override, else the application's
    void overrideTraits(std::optional<TraitCollection> traits);
    bool isRightToLeft() const override { return traits().isRightToLeft(); }

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

    virtual void layoutSubviews() { }
    void invalidateIntrinsicContentSize() override;
    LayoutAnchor anchor(LayoutAttribute attribute) const override;
    virtual Size sizeThatFits(Size limit) const; ///< a limit of 0: none
    virtual void sizeToFit(); ///< keeps the origin

    virtual bool becomeFirstResponder() { return false; } ///< a plain view never takes the focus
    virtual bool resignFirstResponder() { return true; }
    virtual bool isFirstResponder() const { return false; }
    void endEditing(); ///< the focus leaves this view and everything below, where that is allowed

protected:
    void changed(ViewChanges changes);
    void askForFocus(bool wanted);
    std::optional<Size> nativeSize(double maxWidth) const;
    void setBoundsOrigin(Point origin);
    std::shared_ptr<LayoutItem> layoutReference() override;
    void layOutContent() override;
    void layoutDidBecomeStale() override;
    virtual void subviewVisibilityDidChange() { }
    /// The traits of the view changed. Overriders call the base class, which tells the subviews.
    virtual void traitsDidChange();
    virtual void willRemoveSubview(View&) { }

private:
    void resizeWithSuperview(double widthChange, double heightChange);
    Point originInRoot() const;

    Rect _frame;
    Point _boundsOrigin;
    std::weak_ptr<View> _superview;
    std::vector<std::shared_ptr<View>> _subviews;
    std::vector<std::shared_ptr<GestureRecognizer>> _recognizers;
    std::weak_ptr<Window> _window;
    std::weak_ptr<ViewOwner> _owner;
    ObserverSlot<ViewObserver> _observer;
    std::optional<TraitCollection> _traits;
    ViewStyle _style;
    Accessibility _accessibility;
    double _alpha = 1;
    bool _hidden = false, _enabled = true;
};

} // namespace kit
