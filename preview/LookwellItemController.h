// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/Menu.h"
#include "platform/LatestLook.h"
#include "platform/Url.h"
#include "preview/PreviewVerbs.h"
#include "screens/preview/PreviewController.h"

#include <memory>
#include <optional>
#include <vector>

namespace tarrow {

class PreviewItemManager;

/// The quick preview: a screen that shows the content of the manager's item. The whole process has one. Main
/// thread only.
class LookwellItemController : public screens::PreviewController,
                               private screens::PreviewControllerDataSource,
                               private screens::PreviewControllerDelegate {
public:
    /// Answers the process's only controller, which is made on the first call.
    static std::shared_ptr<LookwellItemController> defaultController();
    static std::shared_ptr<LookwellItemController> init();

    LookwellItemController();

    std::shared_ptr<PreviewItemManager> itemManager() const { return _itemManager.lock(); }
    /// The document of the manager's item, in a list of one; absent when the manager had no item.
    const std::optional<std::vector<platform::Url>>& arrayOfDocuments() const { return _arrayOfDocuments; }

    /// The actions that a peek of the preview offers. There are none.
    const kit::Menu& previewActionItems() const { return _previewActionItems; }
    void setPreviewActionItems(kit::Menu items) { _previewActionItems = std::move(items); }

    /// Makes a manager the current one and shows its item.
    void lookwellNewItem(const std::shared_ptr<PreviewItemManager>& manager);

    /// Answers whether a location's name says that it is a PDF document.
    bool _lwPreviewItemIsPDFKind(const platform::Url& item) const;

    /// Tells the manager that the screen disappears.
    void viewWillDisappear(bool animated) override;

    // The buttons in the navigation bar call these.
    void showMoveTarget(const std::shared_ptr<kit::BarButtonItem>& sender);
    void showWarningAndDeleteDocument(const std::shared_ptr<kit::BarButtonItem>& sender);

private:
    void addButtons();
    kit::Menu menu();
    void perform(PreviewVerbs::Verb PreviewVerbs::*verb);
    /// Offers other apps for a document that has no preview.
    void showOtherApps(const platform::Url& item, const std::shared_ptr<kit::View>& from);
    std::size_t numberOfPreviewItemsInPreviewController(
        const screens::PreviewController& controller) const override;
    platform::Url previewControllerPreviewItemAtIndex(
        const screens::PreviewController& controller, std::size_t index) const override;
    bool previewControllerCanEditItem(
        const screens::PreviewController& controller, const platform::Url& item) override;
    bool previewControllerShouldSaveEditedItem(
        const screens::PreviewController& controller, const platform::Url& item) override;

    bool previewControllerWantsDefaultMediaPlayer(
        const screens::PreviewController& controller, const platform::Url& item) override;

    std::weak_ptr<PreviewItemManager> _itemManager;
    const std::shared_ptr<platform::LatestLook> _look = std::make_shared<platform::LatestLook>();
    std::optional<std::vector<platform::Url>> _arrayOfDocuments;
    kit::Menu _previewActionItems;
};

} // namespace tarrow
