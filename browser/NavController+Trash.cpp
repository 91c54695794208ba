// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file moves items to the trash, and leads to what is there.

#include "browser/NavController.h"
#include "browser/TrashScreen.h"
#include "items/MenuEnableChecks.h"
#include "platform/Dispatch.h"
#include "platform/Localization.h"
#include "platform/Log.h"
#include "prompts/UIUtils.h"
#include "screens/list/DocumentListController.h"

namespace tarrow {

using platform::localizedPlural;
using platform::weakly;

void NavController::moveItemsToTrash(const std::vector<Url>& items)
{
    static constexpr Operation op{"-[NavController moveItemsToTrash:]"};
    op.userAction("Move to Trash");
    const auto look = [items] {
        return MenuEnableChecks::isDesktopOrDocumentsInURLArray(items)
            || MenuEnableChecks::numContainersInURLArray(items) > 0;
    };
    lookThen(look,
        [items](NavController& self, bool holdsSpecialFolder) {
            if (!holdsSpecialFolder)
                return self.beginToTrash(items);
            op.warning("Not moving special folder to the trash: %@", items);
            UIUtils::showUnsupportedError(self.visibleViewController());
        },
        {});
}

void NavController::beginToTrash(const std::vector<Url>& items)
{
    const auto list = getTopDocumentListController();
    if (_editMode && list)
        setEditModeAndUpdateUIForViewController(false, list);
    const AccountSession asked;
    const auto ended = [asked, expected = UndoHistory::expect(_undoHistory, asked)](
                           NavController& self, const TrashingOutcome& outcome) {
        self.changeEnded();
        if (!asked.isCurrent())
            return;
        self.trashingEnded(outcome);
        if (outcome.undo)
            expected->add(*outcome.undo);
    };
    changeBegun(ItemChange::begin(
        asked, items, [](ItemChange& change) { return tarrow::moveItemsToTrash(change); },
        weakly(this, ended)));
}

void NavController::trashingEnded(const TrashingOutcome& outcome)
{
    if (!outcome.errors.empty())
        UIUtils::showErrorsTitleParentViewController(outcome.errors,
            localizedPlural(
                ".DICT.CANNOT_TRASH_ITEMS.%d", {static_cast<std::int64_t>(outcome.errors.size())}),
            topViewController());
}

void NavController::showTrash()
{
    static constexpr Operation op{"-[NavController showTrash]"};
    op.userAction("Show Trash");
    const auto shown = _trashScreen.lock();
    if ((shown && shown->window()) || !checkTarrowState())
        return;
    _trashScreen = TrashScreen::present(visibleViewController(),
        {weakly(this, &NavController::changeBegun), weakly(this, &NavController::changeEnded)});
}

/// Removes for good what is too old, and counts the rest, when the drive is set up.
void NavController::removeOldTrash()
{
    const auto queue = services().dispatch().makeSerialQueue("TarrowDriveAppID.oldtrash");
    queue->async([queue, asked = AccountSession()] {
        if (asked.isSignedIn())
            TrashUtils::removeOld();
    });
    countTrash();
}

void NavController::countTrash()
{
    auto& dispatch = services().dispatch();
    const auto queue = dispatch.makeSerialQueue("TarrowDriveAppID.trashcount");
    queue->async(
        [queue, main = dispatch.mainQueue(), counted = weakly(this, &NavController::trashWasCounted)] {
            const auto items = services().trash().items();
            main->async([counted, count = items ? items->size() : 0] { counted(count); });
        });
}

void NavController::trashWasCounted(std::size_t count)
{
    if (count == _trashCount || viewControllers().empty())
        return;
    _trashCount = count;
    const auto root = std::dynamic_pointer_cast<screens::DocumentListController>(viewControllers().front());
    if (!root)
        return;
    showTrashButton(root);
    if (!root->editing())
        displayStatusBar(*root);
}

/// The status line of the top level leads to the trash while something is there.
void NavController::showTrashButton(const List& list)
{
    const auto bar = statusBar(*list);
    const bool isRoot = viewControllers().empty() || viewControllers().front() == list;
    if (!bar || !isRoot)
        return;
    if (_trashCount == 0)
        return bar->setSideButton(nullptr);
    const auto count = static_cast<std::int64_t>(_trashCount);
    bar->setSideButton(std::make_shared<kit::BarButtonItem>(
        localizedPlural(".DICT.IN_TRASH.%d", {count}), weakly(this, &NavController::showTrash)));
}

} // namespace tarrow
