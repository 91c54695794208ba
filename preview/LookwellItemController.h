#pragma once

#include "platform/Url.h"
#include "platform/components/PreviewController.h"

#include <memory>
#include <optional>
#include <vector>

namespace tarrow {

class PreviewItemManager;

/// The quick preview: the screen that shows the content of the manager's item. There is one for the whole
/// process. Main thread only.
class LookwellItemController : public platform::components::PreviewController,
                               private platform::components::PreviewControllerDataSource,
                               private platform::components::PreviewControllerDelegate {
public:
    /// The process's one, made on the first call.
    static std::shared_ptr<LookwellItemController> defaultController();
    static std::shared_ptr<LookwellItemController> init();

    LookwellItemController();

    std::shared_ptr<PreviewItemManager> itemManager() const { return _itemManager.lock(); }
    /// The one document of the manager's item; nothing when it had none.
    const std::optional<std::vector<platform::Url>>& arrayOfDocuments() const { return _arrayOfDocuments; }

    /// Makes a manager the current one and shows its item.
    void lookwellNewItem(const std::shared_ptr<PreviewItemManager>& manager);

    /// Whether a location's name says that it is a PDF document.
    bool _lwPreviewItemIsPDFKind(const platform::Url& item) const;

private:
    std::size_t numberOfPreviewItemsInPreviewController(
        const platform::components::PreviewController& controller) const override;
    platform::Url previewControllerPreviewItemAtIndex(
        const platform::components::PreviewController& controller, std::size_t index) const override;
    bool previewControllerCanEditItem(
        const platform::components::PreviewController& controller, const platform::Url& item) override;
    bool previewControllerShouldSaveEditedItem(
        const platform::components::PreviewController& controller, const platform::Url& item) override;

    std::weak_ptr<PreviewItemManager> _itemManager;
    std::optional<std::vector<platform::Url>> _arrayOfDocuments;
};

} // namespace tarrow
