// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file deletes items, and asks the user before.

#include "browser/ItemDeletion.h"
#include "browser/NavController.h"
#include "items/ItemChange.h"
#include "items/MenuEnableChecks.h"
#include "kit/controllers/AlertController.h"
#include "kit/views/View.h"
#include "platform/Localization.h"
#include "platform/Log.h"
#include "platform/Weakly.h"
#include "prompts/UIUtils.h"
#include "screens/DisplayName.h"
#include "screens/list/DocumentListController.h"

namespace tarrow {

using platform::localized;
using platform::localizedPlural;
using platform::weakly;

namespace {

std::string deletedSentence(const std::vector<Url>& items, std::size_t deleted)
{
    // An app library has another name than its folder.
    const bool hasName = items.size() == 1 && MenuEnableChecks::numContainersInURLArray(items) == 0;
    return hasName ? localized("“%@” was deleted", {screens::displayName(items.front().lastPathComponent())})
                   : localizedPlural(".DICT.ITEMS_DELETED.%d", {static_cast<std::int64_t>(deleted)});
}

} // namespace

void NavController::showWarningAndDeleteDocument(const Sender&)
{
    static constexpr Operation op{"-[NavController showWarningAndDeleteDocument:]"};
    const auto list = getTopDocumentListController();
    if (!list)
        return;
    const auto items = list->selectedItems();
    op.userAction("Pressed Delete (nav)");
    op.info("Pressed Delete after selecting %{public}@ items: %@", items.size(), items);
    showWarningAndDeleteURLsUsingViewWithDocumentListControllerFinishedCompletion(items, nullptr, list, {});
}

void NavController::showWarningAndDeleteURLsUsingViewWithDocumentListControllerFinishedCompletion(
    const std::vector<Url>& urls, const std::shared_ptr<kit::View>& view, const List& list,
    const Completion& finished)
{
    static constexpr Operation op{
        "-[NavController showWarningAndDeleteURLs:usingView:withDocumentListController:finishedCompletion:]"};
    const auto libraries = MenuEnableChecks::numContainersInURLArray(urls);
    if (libraries != 0 && libraries != urls.size()) {
        op.error("Not Deleting: mix of containers and items: %@", urls);
        call(finished);
        return;
    }
    struct Facts {
        bool holdsSpecialFolder;
        std::optional<std::string> message;
    };
    const auto look = [urls] {
        const bool holdsSpecialFolder = MenuEnableChecks::isDesktopOrDocumentsInURLArray(urls);
        const bool asks = !holdsSpecialFolder && !urls.empty();
        return Facts{holdsSpecialFolder, asks ? UIUtils::messageForDeletePrompt(urls) : std::nullopt};
    };
    lookThen(
        look,
        [urls, view, list, finished](NavController& self, const Facts& facts) {
            if (!facts.holdsSpecialFolder)
                return self.askBeforeDeletion(facts.message, urls, view, list, finished);
            op.warning("Not deleting special folder: %@", urls);
            call(finished);
            UIUtils::showUnsupportedError(self.visibleViewController());
        },
        finished);
}

void NavController::askBeforeDeletion(const std::optional<std::string>& message, const std::vector<Url>& urls,
    const std::shared_ptr<kit::View>& view, const List& list, const Completion& finished)
{
    static constexpr Operation op{
        "-[NavController showWarningAndDeleteURLs:usingView:withDocumentListController:finishedCompletion:]"};
    UIUtils::showDeleteWarningAlertMessageViewControllerUsingViewUsingButtonCompletion(message,
        visibleViewController(), view, _barButtonDeleteItem,
        [browser = self(), urls, list, finished, asked = AccountSession()](const auto&, bool cancelled) {
            op.userAction(cancelled ? "Delete was Cancelled (nav)" : "Delete was Confirmed (nav)");
            const bool isConfirmed = !cancelled && asked.isCurrent();
            if (isConfirmed && list)
                browser->setEditModeAndUpdateUIForViewController(false, list);
            if (isConfirmed)
                browser->deleteConfirmed(urls, finished, asked);
            else
                call(finished);
        });
}

void NavController::deleteConfirmed(
    const std::vector<Url>& urls, const Completion& finished, const AccountSession& asked)
{
    const auto showOutcome = [asked, urls](NavController& self, const DeletionOutcome& outcome) {
        self.changeEnded();
        if (!asked.isCurrent())
            return;
        const auto failures = static_cast<std::int64_t>(outcome.failures);
        if (failures == 1)
            UIUtils::showErrorParentViewController(outcome.lastError, self.topViewController());
        else if (failures > 1)
            UIUtils::showAlertMessageParentViewController(
                localizedPlural(".DICT.CANNOT_DELETE_ITEMS.%d", {failures}), {}, self.topViewController());
        else if (outcome.deleted > 0)
            self.tell(deletedSentence(urls, outcome.deleted));
    };
    const auto change = ItemChange::begin(asked, urls, deleteItems,
        [finished, show = weakly(this, showOutcome)](const DeletionOutcome& outcome) {
            call(finished);
            show(outcome);
        });
    changeBegun(change);
}

} // namespace tarrow
