// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file offers to undo changes of items, and says what became of it.

#include "browser/NavController.h"
#include "items/UndoHistory.h"
#include "kit/controllers/Window.h"
#include "platform/Localization.h"
#include "platform/Log.h"
#include "preview/PreviewDetailsViewController.h"
#include "prompts/UIUtils.h"
#include "screens/list/DocumentListController.h"

namespace tarrow {

using platform::localized;
using platform::weakly;

void NavController::beginUndoHistory()
{
    _undoHistory = std::make_shared<UndoHistory>(UndoHistory::Handlers{
        .added = weakly(this, &NavController::offerUndo),
        .begun = weakly(this, &NavController::changeBegun),
        .ended = weakly(this, &NavController::undoEnded),
    });
}

void NavController::offerUndo(std::uint64_t number, const UndoEntry& entry)
{
    const auto list = getTopDocumentListController();
    if (list && !entry.items.empty())
        list->reveal(entry.items.front());
    if (const auto shown = window())
        shown->showNotice(
            entry.sentence, {localized("Undo"), weakly(_undoHistory, &UndoHistory::undo, number)});
}

bool NavController::undoRequested()
{
    static constexpr Operation op{"-[NavController undoRequested]"};
    // A preview has edits of its own, and the user means those.
    const auto top = topViewController();
    const bool isOverview =
        getTopDocumentListController() || std::dynamic_pointer_cast<PreviewDetailsViewController>(top);
    if (!isOverview || !_undoHistory)
        return false;
    op.userAction("Pressed Undo");
    return _undoHistory->undoLatest();
}

void NavController::undoEnded(const UndoEntry& entry, const UndoOutcome& outcome)
{
    changeEnded();
    const auto& errors = outcome.errors;
    if (!AccountSession().isCurrent())
        return;
    if (errors.empty() && outcome.isWhole)
        return tell(localized("Undone: %@", {entry.sentence}));
    if (!errors.empty())
        UIUtils::showErrorsTitleParentViewController(errors,
            platform::localizedPlural(
                ".DICT.CANNOT_UNDO_ITEMS.%d", {static_cast<std::int64_t>(errors.size())}),
            topViewController());
}

} // namespace tarrow
