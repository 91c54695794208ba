// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/BarButtonItem.h"
#include "kit/controllers/ViewController.h"
#include "kit/layout/LayoutConstraint.h"
#include "platform/Geometry.h"
#include "platform/LatestLook.h"
#include "platform/Weakly.h"
#include "preview/PreviewMode.h"

#include <memory>
#include <utility>

namespace kit {
class Button;
class ScrollView;
} // namespace kit

namespace tarrow {

class PreviewItemManager;
class UndoHistory;

/// The common base of the program's own preview screens: content that scrolls between the bars, and buttons
/// to share, delete and move the item of the manager that made the screen. Main thread only.
class PreviewBaseViewController : public kit::ViewController {
public:
    using Button = std::shared_ptr<kit::BarButtonItem>;

    std::shared_ptr<PreviewItemManager> itemManager() const { return _itemManager.lock(); }
    /// Answers the manager's history, or null.
    std::shared_ptr<UndoHistory> undoHistory() const;
    void setItemManager(std::weak_ptr<PreviewItemManager> manager) { _itemManager = std::move(manager); }
    int mode() const { return _mode; } ///< the manager's mode
    void setMode(int mode) { _mode = mode; }

    // These are null before the view is loaded.
    const std::shared_ptr<kit::ScrollView>& scrollView() const { return _scrollView; }
    const std::shared_ptr<kit::View>& contentView() const { return _contentView; }
    /// Subclasses add their content to this view.
    const std::shared_ptr<kit::View>& wrapperView() const { return _wrapperView; }

    // These tie the wrapper's edges to those of the content view. They are null before the first appearance.
    const auto& parentLeadingConstraint() const { return _parentLeadingConstraint; }
    const auto& parentTrailingConstraint() const { return _parentTrailingConstraint; }
    const auto& parentTopConstraint() const { return _parentTopConstraint; }
    const auto& parentBottomConstraint() const { return _parentBottomConstraint; }

    // The buttons are made again at each appearance. They are null before the first.
    const Button& barButtonActionItem() const { return _barButtonActionItem; } ///< Share
    const Button& barButtonDeleteItem() const { return _barButtonDeleteItem; }
    const Button& barButtonMoveItem() const { return _barButtonMoveItem; }

    void loadView() override;
    void viewDidLoad() override;
    void viewWillAppear(bool animated) override;
    void viewWillDisappear(bool animated) override;
    void viewWillLayoutSubviews() override;
    void traitsDidChange(const kit::TraitCollection& previous) override;

    void setupConstraints();
    /// Answers how much of the screen lies under the bars; points.
    platform::EdgeInsets scrollViewDefaultEdgeInsets() const;
    void configureMargins();
    /// Answers the number of an InterfaceOrientation. A narrow, high screen always counts as portrait (1).
    int currentPseudoOrientation() const;
    void configureButtons();
    /// Answers the button that opens the item in another app, for the navigation bar of a phone, or null.
    virtual std::shared_ptr<kit::Button> openInAppNavControllerButton() { return nullptr; }
    /// The item may have changed. Classes that override this call it first.
    virtual void refreshItem();

    // The buttons call these.
    void openInDefaultApp();
    void showWarningAndDeleteDocument(const Button& sender);
    void showDocumentActivities(const Button& sender);
    void showMoveTarget(const Button& sender);

protected:
    /// Shows the right items of the navigation bar.
    virtual void showRightBarButtonItems(kit::BarButtonItems items);
    /// Answers how high the content shall be when the bars leave `available` for it; points. Higher content
    /// scrolls.
    virtual double contentHeight(double available) const { return available; }

private:
    using Constraint = std::shared_ptr<kit::LayoutConstraint>;

    std::shared_ptr<PreviewBaseViewController> self();
    Button makeButton(kit::SystemItem symbol, void (PreviewBaseViewController::*action)(const Button&));
    Button wrappedOpenInButton();
    void enableButtons();
    bool hasItemURL() const;
    /// Looks at the disk on another thread and goes on with what was found, unless a person has asked for
    /// something else since or has left the screen.
    template <typename Look, typename Then>
    void lookThen(Look look, Then then)
    {
        _look->begin(std::move(look),
            platform::weakly(
                this, [then = std::move(then)](PreviewBaseViewController& self, const auto& found) {
                    if (self.isVisible())
                        then(self, found);
                }));
    }

    std::weak_ptr<PreviewItemManager> _itemManager;
    const std::shared_ptr<platform::LatestLook> _look = std::make_shared<platform::LatestLook>();
    int _mode = PreviewModeDetails;
    std::shared_ptr<kit::ScrollView> _scrollView;
    std::shared_ptr<kit::View> _contentView, _wrapperView;
    Constraint _parentLeadingConstraint, _parentTrailingConstraint, _parentTopConstraint,
        _parentBottomConstraint;
    Button _barButtonActionItem, _barButtonDeleteItem, _barButtonMoveItem;
};

} // namespace tarrow
