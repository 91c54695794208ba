#include "preview/LookwellItemController.h"

#include "items/DRItem.h"
#include "platform/Log.h"
#include "platform/Services.h"
#include "platform/TypeRegistry.h"
#include "preview/PreviewItemManager.h"

namespace tarrow {

using platform::Operation;
using platform::Url;
using platform::components::PreviewController;
using platform::components::PreviewControllerDataSource;
using platform::components::PreviewControllerDelegate;

std::shared_ptr<LookwellItemController> LookwellItemController::defaultController()
{
    static const std::shared_ptr<LookwellItemController> shared = init();
    return shared;
}

std::shared_ptr<LookwellItemController> LookwellItemController::init()
{
    const auto controller = std::make_shared<LookwellItemController>();
    auto& self = *controller;
    self.setDataSource(std::shared_ptr<PreviewControllerDataSource>(controller, &self));
    self.setDelegate(std::shared_ptr<PreviewControllerDelegate>(controller, &self));
    return controller;
}

LookwellItemController::LookwellItemController() = default;

void LookwellItemController::lookwellNewItem(const std::shared_ptr<PreviewItemManager>& manager)
{
    static constexpr Operation op{"-[LookwellItemController lookwellNewItem:]"};
    _itemManager = manager;
    _arrayOfDocuments.reset();
    if (const auto item = manager ? manager->item() : nullptr; item && item->resolvedURL())
        _arrayOfDocuments = {*item->resolvedURL()};
    op.debug("LWPreviewController: reloadData");
    reloadData();
}

bool LookwellItemController::_lwPreviewItemIsPDFKind(const Url& item) const
{
    const auto& types = platform::services().typeRegistry();
    const auto type = types.typeForExtension(item.pathExtension());
    return type && types.conformsTo(*type, platform::typeIdentifier::pdf);
}

std::size_t LookwellItemController::numberOfPreviewItemsInPreviewController(const PreviewController&) const
{
    return _arrayOfDocuments ? _arrayOfDocuments->size() : 0;
}

Url LookwellItemController::previewControllerPreviewItemAtIndex(
    const PreviewController&, std::size_t index) const
{
    return (*_arrayOfDocuments)[index];
}

bool LookwellItemController::previewControllerCanEditItem(const PreviewController&, const Url& item)
{
    return _lwPreviewItemIsPDFKind(item);
}

bool LookwellItemController::previewControllerShouldSaveEditedItem(const PreviewController&, const Url& item)
{
    return _lwPreviewItemIsPDFKind(item);
}

} // namespace tarrow
