// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file moves and deletes the previewed item.

#include "items/DRItem.h"
#include "items/FileUtils.h"
#include "items/ItemMoves.h"
#include "items/UrlResolution.h"
#include "platform/Log.h"
#include "preview/PreviewItemManager.h"
#include "prompts/UIUtils.h"
#include "screens/DrivePlaces.h"

namespace tarrow {

using platform::Operation;
using platform::Url;
using screens::MoveTargetPicker;
using screens::MoveTargetScope;

namespace {

using Screen = PreviewItemManager::Screen;

/// Finds where an error is shown. A change may end after the preview was left and its manager is gone, so
/// this holds the stack and not the manager.
class ErrorPlace {
public:
    ErrorPlace(const std::shared_ptr<kit::NavigationController>& navigation, const Screen& asking)
        : _navigation(navigation)
        , _asking(asking)
    {
    }
    /// Answers the screen that asked while it is visible, else the top screen of the stack.
    Screen screen() const
    {
        const auto asking = _asking.lock();
        const auto navigation = _navigation.lock();
        return (asking && asking->isVisible()) || !navigation ? asking : navigation->topViewController();
    }

private:
    std::weak_ptr<kit::NavigationController> _navigation;
    std::weak_ptr<kit::ViewController> _asking;
};

} // namespace

void PreviewItemManager::showWarningAndDeleteDocumentBarButton(
    const Screen& screen, const std::shared_ptr<kit::BarButtonItem>& button)
{
    static constexpr Operation op{"-[PreviewItemManager showWarningAndDeleteDocument:barButton:]"};
    const auto url = itemURL();
    const auto answered = [screen, asked = AccountSession()](PreviewItemManager& self, bool cancelled) {
        op.userAction(cancelled ? "Delete was Cancelled (itemMgr)" : "Delete was Confirmed (itemMgr)");
        if (!cancelled && asked.isCurrent())
            self.removeItem(screen, asked);
    };
    lookThen(
        screen, [url] { return url ? UIUtils::messageForDeletePrompt({*url}) : std::nullopt; },
        [screen, button, answered](PreviewItemManager& self, const std::optional<std::string>& message) {
            UIUtils::showDeleteWarningAlertMessageViewControllerUsingViewUsingButtonCompletion(message,
                screen, nullptr, button,
                [self = self.shared_from_this(), answered](
                    const auto&, bool cancelled) { answered(*self, cancelled); });
        });
}

std::shared_ptr<kit::NavigationController> PreviewItemManager::stackOf(const Screen& screen)
{
    return screen ? screen->navigationController() : nullptr;
}

void PreviewItemManager::removeItem(const Screen& screen, const AccountSession& asked)
{
    const auto url = itemURL();
    if (!url)
        return;
    ItemChange::begin(
        asked, {*url},
        [](ItemChange& change) {
            return change.forEachItem(
                [&](const Url& item) { return FileUtils::remove(item, change.stillWanted()); });
        },
        [place = ErrorPlace(navigationController(), screen)](const std::vector<Error>& errors) {
            for (const auto& error : errors)
                UIUtils::showErrorParentViewController(error, place.screen());
        });
}

void PreviewItemManager::showMoveTarget(const Screen& screen)
{
    static constexpr Operation op{"-[PreviewItemManager showMoveTarget:]"};
    op.info("Pressed Move (itemMgr)");
    const auto url = itemURL();
    const auto presenter = stackOf(screen);
    if (!url || !presenter)
        return;
    struct Facts {
        MoveTargetScope scope;
        std::shared_ptr<const screens::DrivePlaces> places;
    };
    const std::vector items{*url};
    const auto look = [items, shown = MoveTargetPicker::foldersToLookUp(items)] {
        const bool mayLeave = trw_canCrossZoneMoveURLs(items);
        return Facts{mayLeave ? MoveTargetScope::AllContainers : MoveTargetScope::Container,
            screens::DrivePlaces::lookUp(shown)};
    };
    lookThen(screen, look, [items, presenter](PreviewItemManager& self, const Facts& facts) {
        const auto picker = MoveTargetPicker::initWithItemsScopePlaces(items, facts.scope, facts.places);
        picker->setDelegate(self.weak_from_this());
        self._moveAsked.emplace();
        picker->setPresentationStyle(kit::PresentationStyle::OverCurrentContext);
        presenter->presentViewController(picker, true, [] { op.debug("Presented moveTarget"); });
    });
}

void PreviewItemManager::documentTargetSelectionControllerDidSelectItemAtURL(
    const std::shared_ptr<MoveTargetPicker>& picker, const Url& folder)
{
    static constexpr Operation op{
        "-[PreviewItemManager documentTargetSelectionController:didSelectItemAtURL:]"};
    op.debug("MoveTarget = %@", folder);
    op.debug("ItemsToMove = %@", picker->itemsToMove());
    picker->dismissViewController(true);
    const auto asked = _moveAsked.value_or(AccountSession());
    if (!asked.isCurrent())
        return;
    struct Outcome {
        std::vector<Error> errors;
        std::optional<UndoEntry> undo;
    };
    if (const auto url = itemURL())
        _movedTo = folder.appendingPathComponent(url->lastPathComponent());
    ItemChange::begin(
        asked, picker->itemsToMove(),
        [folder](ItemChange& change) {
            auto outcome = moveItems(change, folder);
            return Outcome{std::move(outcome.errors), undoOfMoves(outcome.moved)};
        },
        [place = ErrorPlace(navigationController(), nullptr),
            expected = UndoHistory::expect(undoHistory(), asked)](const Outcome& outcome) {
            if (outcome.undo)
                expected->add(*outcome.undo);
            for (const auto& error : outcome.errors)
                UIUtils::showFriendlyMoveErrorParentViewController(error, place.screen());
        });
}

} // namespace tarrow
