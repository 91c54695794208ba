// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/BarButtonItem.h"
#include "platform/StorageOffers.h"

#include <functional>
#include <memory>
#include <string>

namespace screens {
class DocumentListController;
class StorageUpgradeButton;
} // namespace screens

namespace tarrow {

class DriveStatusLabelView;

/// Is told that the user wants more storage. Main thread.
class DocumentListControllerStatusBarDelegate {
public:
    virtual ~DocumentListControllerStatusBarDelegate() = default;
    virtual void upgradeStorageButtonPressed() = 0;
};

/// The content of one folder list's toolbar: the status line and, while storage is low, the upgrade button.
/// Main thread.
class DocumentListControllerStatusBar : public std::enable_shared_from_this<DocumentListControllerStatusBar> {
public:
    using Offer = std::shared_ptr<const platform::StorageOffer>; ///< null: none

    /// Builds the content. The delegate may be null.
    void createStatusBarButtonPressDelegate(
        const Offer& offer, const std::shared_ptr<DocumentListControllerStatusBarDelegate>& delegate);
    /// Builds the line and the button.
    void configureLabels(const Offer& offer);

    void setStatusText(const std::string& text);
    /// Shows a button beside the line; null: none. displayStatusBar() brings it into the toolbar.
    void setSideButton(std::shared_ptr<kit::BarButtonItem> button) { _sideButton = std::move(button); }
    const std::shared_ptr<kit::BarButtonItem>& sideButton() const { return _sideButton; }
    /// Gives the button an offer, and shows the button when the offer says that storage is low.
    void showUpgradeOffer(const Offer& offer);
    /// Shows how far a change of items has come, and a button that cancels it, in place of the line and its
    /// button; an empty text shows those again. displayStatusBar() brings it into the toolbar.
    void showProgress(const std::string& text, std::function<void()> cancel);
    /// The user pressed the button. Its link's own action is performed. When the link has none and leaves the
    /// upgrade to the application, the delegate is told.
    void upgradeStoragePressed(const screens::StorageUpgradeButton& button);

    const std::shared_ptr<DriveStatusLabelView>& labelsView() const { return _labelsView; }
    std::shared_ptr<DocumentListControllerStatusBarDelegate> delegate() const { return _delegate.lock(); }
    /// The toolbar's items: flexible space, the content, flexible space.
    const kit::BarButtonItems& toolbarItems() const { return _toolbarItems; }
    /// The items while a progress is shown, else none.
    const kit::BarButtonItems& progressItems() const { return _progressItems; }

private:
    std::shared_ptr<DriveStatusLabelView> _labelsView;
    std::weak_ptr<DocumentListControllerStatusBarDelegate> _delegate;
    kit::BarButtonItems _toolbarItems, _progressItems;
    std::shared_ptr<DriveStatusLabelView> _progressView;
    std::shared_ptr<kit::BarButtonItem> _sideButton;
};

// These serve the status bar of a folder list. The list owns its status bar.

/// Answers null before the status bar is created.
std::shared_ptr<DocumentListControllerStatusBar> statusBar(const screens::DocumentListController& list);
void setStatusBar(
    screens::DocumentListController& list, std::shared_ptr<DocumentListControllerStatusBar> statusBar);
/// Creates a status bar for the list, in place of an earlier one.
void createStatusBarButtonPressDelegate(screens::DocumentListController& list,
    const DocumentListControllerStatusBar::Offer& offer,
    const std::shared_ptr<DocumentListControllerStatusBarDelegate>& delegate);
/// Puts the status bar into the list's toolbar, or the progress that it shows.
void displayStatusBar(screens::DocumentListController& list);

} // namespace tarrow
