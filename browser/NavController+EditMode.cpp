// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file configures a list's bars and the status line under it, and lets the user select several items.

#include "browser/ListLogging.h"
#include "browser/NavController.h"
#include "browser/RunningChanges.h"
#include "drawing/FileTags.h"
#include "items/MenuEnableChecks.h"
#include "items/UrlResolution.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/views/Button.h"
#include "kit/views/View.h"
#include "platform/Formatters.h"
#include "platform/Localization.h"
#include "platform/Log.h"
#include "platform/Services.h"
#include "platform/Weakly.h"
#include "screens/list/DocumentListController.h"

namespace tarrow {

using kit::BarButtonItem;
using kit::SystemItem;
using platform::ByteCountStyle;
using platform::ByteCountUnit;
using platform::Operation;
using platform::services;
using platform::weakly;
using platform::weaklyOr;
using screens::DocumentListAction;
using screens::DocumentListController;

namespace {

/// Answers the list's title while the user selects items.
std::string selectionTitle(std::size_t selected)
{
    return selected == 0
        ? platform::localized("Select Items")
        : platform::localizedPlural(".DICT.ITEMS_SELECTED.%d", {static_cast<std::int64_t>(selected)});
}

constexpr auto offeredActions = actionBit(DocumentListAction::Delete) | actionBit(DocumentListAction::Info)
    | actionBit(DocumentListAction::Rename) | actionBit(DocumentListAction::Share)
    | actionBit(DocumentListAction::Move) | actionBit(DocumentListAction::PressurePop);

/// Answers whether a folder may be made in a list's folder, and false as long as that would have to be looked
/// up on the disk.
bool canMakeFolderIn(const DocumentListController& list)
{
    return MenuEnableChecks::isPlaceKnown(list) && MenuEnableChecks::canEnableNewFolderForSelectedItems(list);
}

/// Answers the same for files that are copied into it.
bool canAddItemsTo(const DocumentListController& list)
{
    return MenuEnableChecks::isPlaceKnown(list) && MenuEnableChecks::canAddItems(list);
}

screens::DocumentListActionSet refusedActions(const platform::Url& item)
{
    constexpr auto changes = actionBit(DocumentListAction::Delete) | actionBit(DocumentListAction::Rename)
        | actionBit(DocumentListAction::Move);
    return trw_hasPathOfSpecialFolder(item) ? changes : screens::DocumentListActionSet();
}

} // namespace

void NavController::initNewListController(const List& list)
{
    static constexpr Operation op{"-[NavController initNewListController:]"};
    _viewTitle = list->title();
    logNewList(list);
    list->setAvailableActions(offeredActions);
    list->setEditTags(weakly(this, &NavController::editTagsOfItems));
    list->setCopyItems(weakly(this, &NavController::copyItems));
    list->setDownloadVerbs(downloadVerbs());
    const bool isRoot = viewControllers().empty() || viewControllers().front() == list;
    list->setTrashVerbs({weakly(this, &NavController::moveItemsToTrash),
        isRoot ? std::function<void()>(weakly(this, &NavController::showTrash)) : nullptr});
    list->setFolderVerbs({{platform::localized("New Folder"), weaklyOr(false, list.get(), &canMakeFolderIn),
                              weakly(this, &NavController::promtForNewFolderAndCreate, nullptr)},
        {platform::localized("Add Files…"), weaklyOr(false, list.get(), &canAddItemsTo),
            weakly(this, &NavController::chooseFilesToAdd)}});
    list->setRefusedActions(refusedActions);
    configureNavBar(list);
    if (list->title().empty())
        op.warning("Warning: newList title not set");
    list->view()->setBackground(platform::Color::white());
    configureToolbar(list);
    list->setDelegate(self());
    showRunningChanges(list);
    MenuEnableChecks::lookUpPlaceOf(
        list, weakly(this, &NavController::placeBecameKnown, std::weak_ptr(list)));
}

void NavController::placeBecameKnown(const std::weak_ptr<DocumentListController>& known)
{
    const auto list = known.lock();
    if (list)
        list->folderVerbsMayHaveChanged();
    if (_editMode && list == topViewController()) {
        enableNewFolder(*list);
        updateStatusUI(list);
    }
}

void NavController::enableNewFolder(const DocumentListController& list) const
{
    if (_barButtonNewFolder)
        _barButtonNewFolder->setEnabled(canMakeFolderIn(list));
}

void NavController::configureNavBar(const List& list)
{
    const auto button = _editMode
        ? std::make_shared<BarButtonItem>(SystemItem::Cancel, weakly(this, &NavController::endEditMode))
        : std::make_shared<BarButtonItem>(
            platform::localized("Select"), weakly(this, &NavController::beginEditMode));
    if (!_editMode)
        button->setCompactImage(platform::Image::named("selection-mode-symbolic"));
    list->navigationItem().setRightItem(button);
    list->navigationItem().setNewAction(weakly(this, [shown = std::weak_ptr(list)](NavController& self) {
        const auto folder = shown.lock();
        if (folder && MenuEnableChecks::canEnableNewFolderForSelectedItems(*folder))
            self.promtForNewFolderAndCreate(nullptr);
    }));
    list->navigationItem().setHidesBackButton(_editMode);
    list->setTitle(_editMode ? platform::localized("Select Items") : _viewTitle);
}

NavController::Sender NavController::makeToolbarButton(
    const std::string& title, void (NavController::*operation)(const Sender&))
{
    const auto button = std::make_shared<kit::Button>(title);
    button->sizeToFit();
    auto item = std::make_shared<BarButtonItem>(button);
    button->setAction(weakly(this, [sender = std::weak_ptr(item), operation](NavController& self) {
        (self.*operation)(sender.lock());
    }));
    return item;
}

void NavController::configureEditToolbar(const List& list)
{
    const auto space = [] { return std::make_shared<BarButtonItem>(SystemItem::FlexibleSpace); };
    _barButtonNewFolder =
        makeToolbarButton(platform::localized("New Folder"), &NavController::promtForNewFolderAndCreate);
    _barButtonMoveItem =
        makeToolbarButton(platform::localized("Move"), &NavController::showMoveTargetForSelectedItems);
    _barButtonDeleteItem =
        makeToolbarButton(platform::localized("Delete"), &NavController::showWarningAndDeleteDocument);
    list->setToolbarItems({_barButtonNewFolder, space(), _barButtonMoveItem, space(), _barButtonDeleteItem});
}

void NavController::configureToolbar(const List& list)
{
    _barButtonNewFolder = _barButtonMoveItem = _barButtonDeleteItem = nullptr;
    if (_editMode) {
        configureEditToolbar(list);
        return;
    }
    if (!statusBar(*list))
        createStatusBarButtonPressDelegate(*list, _upgradeOffer, self());
    showTrashButton(list);
    displayStatusBar(*list);
    updateStatusUI(list);
}

void NavController::showRunningChanges(const List& list)
{
    if (_runningChanges)
        list->setChangingItems(_runningChanges->items());
    showProgress(list);
}

void NavController::showProgress(const List& list)
{
    const auto bar = statusBar(*list);
    if (!bar)
        return;
    const bool hadProgress = !bar->progressItems().empty();
    auto shown = progressOfDownloads();
    if (const auto change = _runningChanges ? _runningChanges->longOne() : nullptr)
        shown = {RunningChanges::progressText(*change), [change] { change->cancel(); }};
    bar->showProgress(
        shown ? shown->text : std::string(), shown ? shown->cancel : [] {});
    if (!list->editing() && hadProgress != shown.has_value())
        displayStatusBar(*list);
}

/// Every list on the stack shows it, because the user may go back to any.
void NavController::showInLists(void (NavController::*show)(const List&))
{
    for (const auto& screen : viewControllers()) {
        if (const auto list = std::dynamic_pointer_cast<DocumentListController>(screen))
            (this->*show)(list);
    }
}

void NavController::updateStatusUI(const List& list)
{
    if (!_pickerIsAlive)
        return;
    const auto shown = list ? list : getTopDocumentListController();
    const auto bar = shown ? statusBar(*shown) : nullptr;
    if (!bar)
        return;
    bar->setStatusText(toolbarStatusText(shown->containedItemCount()));
    bar->showUpgradeOffer(_upgradeOffer);
    if (!_editMode)
        return;
    shown->setTitle(selectionTitle(shown->selectedItemCount()));
    // The rules do not look at the disk here. The buttons are enabled as soon as the place is known.
    const bool isKnown = MenuEnableChecks::isPlaceKnown(*shown);
    if (_barButtonMoveItem)
        _barButtonMoveItem->setEnabled(isKnown && MenuEnableChecks::canShowMoveForSelectedItems(*shown));
    if (_barButtonDeleteItem)
        _barButtonDeleteItem->setEnabled(isKnown && MenuEnableChecks::canShowDeleteForSelectedItems(*shown));
}

void NavController::driveIsPutRight()
{
    updateStatusUI(nullptr);
}

void NavController::beginEditMode(const Sender&)
{
    static constexpr Operation op{"-[NavController beginEditMode:]"};
    op.userAction("Pressed Select (begin edit)");
    op.info("Begin Edit mode");
    setEditModeAndUpdateUIForViewController(true, getTopDocumentListController());
}

void NavController::endEditMode(const Sender&)
{
    static constexpr Operation op{"-[NavController endEditMode:]"};
    op.userAction("Pressed Cancel (end edit)");
    const auto list = getTopDocumentListController();
    op.debug(
        "EndEditMode.  Selected %d items: %@", list ? list->selectedItemCount() : 0, SelectedItems{list});
    setEditModeAndUpdateUIForViewController(false, list);
}

void NavController::selectAllItems(const Sender&)
{
    static constexpr Operation op{"-[NavController selectAllItems:]"};
    op.userAction("Pressed SelectAll");
    op.info("Pressed SelectAll");
    const auto list = getTopDocumentListController();
    if (!list)
        return;
    op.debug("DLC has %d contained items", list->containedItemCount());
    list->selectAllItems();
    op.debug("Selected all %d: %@", list->selectedItemCount(), SelectedItems{list});
}

void NavController::setEditModeAndUpdateUIForViewController(bool editMode, const List& list)
{
    _editMode = editMode;
    if (list)
        list->setEditingAnimated(editMode, true);
    configureVisibleControllerForMode();
    if (_editMode && list)
        enableNewFolder(*list);
}

void NavController::configureVisibleControllerForMode()
{
    const auto list = getTopDocumentListController();
    if (!list)
        return;
    configureNavBar(list);
    configureToolbar(list);
    updateStatusUI(list);
}

void NavController::documentListControllerRequestsEditing(const List& list)
{
    if (!_editMode && list == topViewController())
        beginEditMode(nullptr);
}

std::string NavController::toolbarStatusText(std::size_t itemCount) const
{
    if (services().cloudDocumentService().isPuttingRight())
        return platform::localized("Putting things right…");
    auto items = platform::localizedPlural(".DICT.ITEMS.%d", {static_cast<std::int64_t>(itemCount)});
    if (!okToShowQuota())
        return items;
    return platform::localized("%1$@, %2$@", {std::move(items), quotaAvailableString()});
}

std::string NavController::quotaAvailableString() const
{
    const auto& formatters = services().formatters();
    const auto text = formatters.byteCount(_quotaBytes, ByteCountStyle::Binary, ByteCountUnit::Included);
    const double number = formatters.byteCountNumber(_quotaBytes, ByteCountStyle::Binary);
    return platform::localizedPlural(".DICT.AVAILABLE.%g", {number, text});
}

std::vector<kit::TagDot> NavController::documentListControllerDotsForTagNames(
    const List&, const std::vector<std::string>& names)
{
    return FileTags::dotsForTags(names);
}

} // namespace tarrow
