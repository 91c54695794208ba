// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "preview/LookwellItemController.h"

#include "items/DRItem.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/views/View.h"
#include "platform/Localization.h"
#include "platform/Log.h"
#include "platform/Services.h"
#include "platform/TypeRegistry.h"
#include "platform/Weakly.h"
#include "preview/PreviewItemManager.h"
#include "preview/TarrowDriveAppPreview.h"
#include "screens/DocumentInteractionSheet.h"

#include <utility>

namespace tarrow {

using kit::BarButtonItem;
using kit::SystemItem;
using platform::Operation;
using platform::Url;
using platform::weakly;
using screens::PreviewController;
using screens::PreviewControllerDataSource;
using screens::PreviewControllerDelegate;
using Button = std::shared_ptr<BarButtonItem>;

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
    self.addButtons();
    self.navigationItem().setMenu(platform::localized("More"),
        platform::weaklyOr(kit::Menu(), controller, &LookwellItemController::menu));
    self.setOpenInHandler(weakly(controller, &LookwellItemController::showOtherApps));
    return controller;
}

LookwellItemController::LookwellItemController() = default;

void LookwellItemController::addButtons()
{
    const auto button = [this](SystemItem symbol, void (LookwellItemController::*action)(const Button&)) {
        return std::make_shared<BarButtonItem>(symbol, weakly(this, action));
    };
    setAdditionalRightBarButtonItems(
        {button(SystemItem::Trash, &LookwellItemController::showWarningAndDeleteDocument),
            button(SystemItem::Organize, &LookwellItemController::showMoveTarget)});
}

kit::Menu LookwellItemController::menu()
{
    constexpr std::pair<const char*, PreviewVerbs::Verb PreviewVerbs::*> entries[] = {
        {"Share", &PreviewVerbs::share},
        {"Rename", &PreviewVerbs::rename},
        {"Info", &PreviewVerbs::showInfo},
        {"Move to Trash", &PreviewVerbs::moveToTrash},
    };
    kit::Menu menu;
    const auto manager = itemManager();
    for (const auto& [title, verb] : entries) {
        if (manager && currentPreviewItem() && manager->previewVerbs().*verb)
            menu.push_back({.title = platform::localized(title),
                .handler = weakly(this, &LookwellItemController::perform, verb),
                .image = {}});
    }
    return menu;
}

void LookwellItemController::perform(PreviewVerbs::Verb PreviewVerbs::*verb)
{
    keepEdits();
    const auto manager = itemManager();
    const auto item = manager ? manager->item() : nullptr;
    if (item && manager->previewVerbs().*verb)
        (manager->previewVerbs().*verb)(item->url());
}

void LookwellItemController::viewWillDisappear(bool animated)
{
    if (const auto manager = itemManager())
        manager->viewControllerWillDisappear(*this);
    PreviewController::viewWillDisappear(animated);
}

void LookwellItemController::showOtherApps(const Url& item, const std::shared_ptr<kit::View>& from)
{
    using screens::DocumentInteractionSheet;
    const auto show = [item, from](
                          LookwellItemController& self, const DocumentInteractionSheet::ItemFacts& facts) {
        const auto manager = self.itemManager();
        if (!self.isVisible() || !manager)
            return;
        const auto sheet = DocumentInteractionSheet::interactionControllerWithURLFacts(item, facts);
        manager->setDocumentInteractionController(sheet);
        sheet->presentOptionsMenuFromRectInView(
            self.shared_from_this(), from ? from->bounds() : platform::Rect(), from, true);
    };
    _look->begin([item] { return DocumentInteractionSheet::lookUp(item); }, weakly(this, show));
}

void LookwellItemController::showMoveTarget(const Button&)
{
    static constexpr Operation op{"-[LookwellItemController showMoveTarget:]"};
    op.userAction("Pressed Move (LW)");
    op.info("Pressed Move");
    keepEdits();
    if (const auto manager = itemManager())
        manager->showMoveTarget(shared_from_this());
}

void LookwellItemController::showWarningAndDeleteDocument(const Button& sender)
{
    static constexpr Operation op{"-[LookwellItemController showWarningAndDeleteDocument:]"};
    op.userAction("Pressed Delete (LW)");
    keepEdits();
    if (const auto manager = itemManager())
        manager->showWarningAndDeleteDocumentBarButton(shared_from_this(), sender);
}

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

bool LookwellItemController::previewControllerWantsDefaultMediaPlayer(
    const PreviewController&, const Url& item)
{
    return wantsDefaultMediaPlayer(item);
}

} // namespace tarrow
