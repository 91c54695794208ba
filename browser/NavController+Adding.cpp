// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file copies items from elsewhere on this machine into the folder that is shown, and out of it.

#include "browser/NavController.h"
#include "items/ItemAdding.h"
#include "items/ItemContents.h"
#include "items/MenuEnableChecks.h"
#include "platform/DocumentSharing.h"
#include "platform/Localization.h"
#include "platform/Log.h"
#include "platform/Services.h"
#include "prompts/UIUtils.h"
#include "screens/DisplayName.h"
#include "screens/list/DocumentListController.h"

namespace tarrow {

using platform::localized;
using platform::localizedPlural;
using platform::Operation;
using platform::services;
using platform::Url;
using platform::weakly;

void NavController::chooseFilesToAdd()
{
    static constexpr Operation op{"-[NavController chooseFilesToAdd]"};
    op.userAction("Pressed Add Files");
    // The files go where the user was when they were asked for.
    const auto chosen = [list = std::weak_ptr(getTopDocumentListController()), asked = AccountSession()](
                            NavController& self, const std::vector<Url>& files) {
        if (const auto shown = list.lock())
            self.addItemsTo(shown, files, asked);
    };
    services().documentSharing().chooseFiles(weakly(this, chosen));
}

bool NavController::takesFiles() const
{
    const auto list = getTopDocumentListController();
    return list && list->presentedURL();
}

bool NavController::filesOffered(const std::vector<Url>& files)
{
    static constexpr Operation op{"-[NavController filesOffered:]"};
    op.userAction("Dropped or pasted files");
    addItems(files);
    return !files.empty();
}

void NavController::addItems(const std::vector<Url>& items)
{
    if (const auto list = getTopDocumentListController())
        addItemsTo(list, items, AccountSession());
}

void NavController::addItemsTo(const List& list, const std::vector<Url>& items, const AccountSession& asked)
{
    static constexpr Operation op{"-[NavController addItems:to:]"};
    const auto& folder = list->presentedURL();
    if (items.empty() || !folder || !asked.isCurrent())
        return;
    if (!MenuEnableChecks::canAddItems(*list))
        return UIUtils::showUnsupportedError(visibleViewController());
    op.info("Adding %d items to %@", items.size(), *folder);
    const auto accepts =
        MenuEnableChecks::containerSupportsAnyDepth(*list) ? Accepts::Everything : Accepts::FilesOnly;
    const auto ended = [asked, expected = UndoHistory::expect(_undoHistory, asked)](
                           NavController& self, const AddingOutcome& outcome) {
        self.changeEnded();
        if (!asked.isCurrent())
            return;
        self.addingEnded(outcome);
        if (outcome.undo)
            expected->add(*outcome.undo);
    };
    changeBegun(ItemChange::begin(
        asked, items,
        [folder = *folder, accepts](ItemChange& change) { return tarrow::addItems(change, folder, accepts); },
        weakly(this, ended)));
}

void NavController::addingEnded(const AddingOutcome& outcome)
{
    if (!outcome.errors.empty())
        UIUtils::showErrorsTitleParentViewController(outcome.errors,
            localizedPlural(".DICT.CANNOT_ADD_ITEMS.%d", {static_cast<std::int64_t>(outcome.errors.size())}),
            topViewController());
}

void NavController::copyItems(const std::vector<Url>& items)
{
    static constexpr Operation op{"-[NavController copyItems:]"};
    op.userAction("Copy");
    const AccountSession asked;
    const auto look = [items, asked] {
        return findDocuments(items, ContentPlace::Cloud, [&] { return asked.isSignedIn(); });
    };
    lookThen(look,
        [items, asked](NavController& self, const FoundDocuments& inCloud) {
            if (asked.isCurrent())
                self.copyFound(items, inCloud);
        },
        {});
}

/// Another program would find nothing where a document is only promised.
void NavController::copyFound(const std::vector<Url>& items, const FoundDocuments& inCloud)
{
    const auto top = visibleViewController();
    if (!inCloud.errors.empty())
        return UIUtils::showErrorParentViewController(inCloud.errors.front(), top);
    const auto missing = static_cast<std::int64_t>(inCloud.documents.size());
    if (missing == 1)
        return UIUtils::showAlertMessageParentViewController(
            localized("“%@” is still in the cloud, so it can’t be copied. Download it first.",
                {screens::displayName(inCloud.documents.front().lastPathComponent())}),
            {}, top);
    if (missing > 0)
        return UIUtils::showAlertMessageParentViewController(
            localizedPlural(".DICT.CANNOT_COPY_CLOUD_ITEMS.%d", {missing}), {}, top);
    services().documentSharing().copyFiles(items);
    tell(items.size() == 1
            ? localized("“%@” was copied", {screens::displayName(items.front().lastPathComponent())})
            : localizedPlural(".DICT.ITEMS_COPIED.%d", {static_cast<std::int64_t>(items.size())}));
}

} // namespace tarrow
