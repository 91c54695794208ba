// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file moves and deletes the previewed item.

#include "items/DRItem.h"
#include "items/FileUtils.h"
#include "items/UrlResolution.h"
#include "platform/Dispatch.h"
#include "platform/Log.h"
#include "platform/Services.h"
#include "platform/Weakly.h"
#include "preview/PreviewItemManager.h"
#include "prompts/UIUtils.h"

namespace tarrow {

using platform::Operation;
using platform::services;
using platform::Url;
using platform::weakly;
using screens::MoveTargetPicker;
using screens::MoveTargetScope;

namespace {

/// Changes files on a queue of its own, because another program may hold an item and the disk may be slow.
void changeFiles(platform::Work work)
{
    const auto queue = services().dispatch().makeSerialQueue("TarrowDriveAppID.previewchanges");
    // The work keeps its queue alive, so that the user's change happens even if the preview is closed.
    queue->async([queue, work = std::move(work)] { work(); });
}

struct Move {
    Url from, to;
};

std::vector<Error> moveAll(const std::vector<Move>& moves)
{
    std::vector<Error> errors;
    for (const auto& move : moves) {
        if (auto error = FileUtils::moveTo(move.from, move.to))
            errors.push_back(std::move(*error));
    }
    return errors;
}

} // namespace

/// Answers a visible screen for an alert, because the screen that asked may be gone when a change has ended.
PreviewItemManager::Screen PreviewItemManager::screenForAlerts(const Screen& wanted) const
{
    const auto navigation = navigationController();
    return (wanted && wanted->isVisible()) || !navigation ? wanted : navigation->topViewController();
}

void PreviewItemManager::showWarningAndDeleteDocumentBarButton(
    const Screen& screen, const std::shared_ptr<kit::BarButtonItem>& button)
{
    static constexpr Operation op{"-[PreviewItemManager showWarningAndDeleteDocument:barButton:]"};
    const auto url = itemURL();
    UIUtils::showDeleteWarningAlertHasContainerViewControllerUsingViewUsingButtonCompletion(
        url ? std::vector{*url} : std::vector<Url>(), false, screen, nullptr, button,
        [self = shared_from_this(), screen, asked = AccountSession()](const auto&, bool cancelled) {
            op.userAction(cancelled ? "Delete was Cancelled (itemMgr)" : "Delete was Confirmed (itemMgr)");
            if (!cancelled && asked.isCurrent())
                self->removeItem(screen);
        });
}

void PreviewItemManager::removeItem(const Screen& screen)
{
    const auto url = itemURL();
    if (!url)
        return;
    changeFiles([weak = weak_from_this(), screen = std::weak_ptr(screen), url = *url,
                    main = services().dispatch().mainQueue()] {
        const auto error = FileUtils::remove(url);
        if (!error)
            return;
        main->async(weakly(weak, [screen, error = *error](PreviewItemManager& self) {
            UIUtils::showErrorParentViewController(error, self.screenForAlerts(screen.lock()));
        }));
    });
}

void PreviewItemManager::showMoveTarget(const Screen& screen)
{
    static constexpr Operation op{"-[PreviewItemManager showMoveTarget:]"};
    op.info("Pressed Move (itemMgr)");
    const auto url = itemURL();
    const auto presenter = screen ? screen->navigationController() : nullptr;
    if (!url || !presenter)
        return;
    const std::vector items{*url};
    const auto picker = MoveTargetPicker::initWithItemsScope(
        items, trw_canCrossZoneMoveURLs(items) ? MoveTargetScope::AllContainers : MoveTargetScope::Container);
    picker->setDelegate(weak_from_this());
    _moveAsked.emplace();
    picker->setPresentationStyle(kit::PresentationStyle::OverCurrentContext);
    presenter->presentViewController(picker, true, [] { op.debug("Presented moveTarget"); });
}

void PreviewItemManager::documentTargetSelectionControllerDidSelectItemAtURL(
    const std::shared_ptr<MoveTargetPicker>& picker, const Url& folder)
{
    static constexpr Operation op{
        "-[PreviewItemManager documentTargetSelectionController:didSelectItemAtURL:]"};
    op.debug("MoveTarget = %@", folder);
    op.debug("ItemsToMove = %@", picker->itemsToMove());
    picker->dismissViewController(true);
    if (!_moveAsked.value_or(AccountSession()).isCurrent())
        return;
    std::vector<Move> moves;
    for (const auto& item : picker->itemsToMove())
        moves.push_back({item, folder.appendingPathComponent(item.lastPathComponent())});
    changeFiles(
        [weak = weak_from_this(), moves = std::move(moves), main = services().dispatch().mainQueue()] {
            auto errors = moveAll(moves);
            if (errors.empty())
                return;
            main->async(weakly(weak, [errors = std::move(errors)](PreviewItemManager& self) {
                const auto navigation = self.navigationController();
                for (const auto& error : errors) {
                    if (navigation)
                        UIUtils::showFriendlyMoveErrorParentViewController(
                            error, navigation->topViewController());
                }
            }));
        });
}

} // namespace tarrow
