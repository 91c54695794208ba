// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/move/MoveTargetPicker.h"

#include "screens/DrivePlaces.h"
#include "screens/move/MoveTargetScreen.h"
#include "screens/move/RecentMoveTargets.h"

#include <algorithm>
#include <utility>

namespace screens {

std::shared_ptr<MoveTargetPicker> MoveTargetPicker::initWithItemsScope(
    std::vector<Url> items, MoveTargetScope scope)
{
    const auto places = DrivePlaces::lookUp(foldersToLookUp(items));
    return initWithItemsScopePlaces(std::move(items), scope, places);
}

std::vector<Url> MoveTargetPicker::foldersToLookUp(const std::vector<Url>& items)
{
    auto folders = RecentMoveTargets::folders();
    if (!items.empty())
        folders.push_back(items.front().deletingLastPathComponent());
    return folders;
}

std::shared_ptr<MoveTargetPicker> MoveTargetPicker::initWithItemsScopePlaces(
    std::vector<Url> items, MoveTargetScope scope, std::shared_ptr<const DrivePlaces> places)
{
    const auto picker = std::make_shared<MoveTargetPicker>(std::move(items), scope, std::move(places));
    const auto& root = picker->places().rootFolder();
    const auto start = picker->_itemsToMove.empty()
        ? root
        : std::optional(picker->_itemsToMove.front().deletingLastPathComponent());
    if (start)
        picker->show(*start);
    // The items' container may have gone. Without a screen the picker would have no Cancel button.
    if (picker->viewControllers().empty() && root)
        picker->show(*root);
    return picker;
}

MoveTargetPicker::MoveTargetPicker(
    std::vector<Url> items, MoveTargetScope scope, std::shared_ptr<const DrivePlaces> places)
    : _itemsToMove(std::move(items))
    , _scope(scope)
    , _places(std::move(places))
{
    setPresentationStyle(kit::PresentationStyle::OverCurrentContext);
    setToolbarHidden(false);
}

std::shared_ptr<MoveTargetPicker> MoveTargetPicker::self()
{
    return std::static_pointer_cast<MoveTargetPicker>(shared_from_this());
}

std::shared_ptr<MoveTargetScreen> MoveTargetPicker::makeScreen(const Url& folder)
{
    return std::make_shared<MoveTargetScreen>(self(), folder);
}

std::vector<Url> MoveTargetPicker::wayTo(const Url& folder) const
{
    auto way = _places->foldersDownTo(folder);
    if (_scope == MoveTargetScope::AllContainers || _itemsToMove.empty() || way.empty())
        return way;
    const auto own = _places->foldersDownTo(_itemsToMove.front().deletingLastPathComponent());
    const bool isInLibrary = own.size() > 1 && !own[1].isWithin(own[0]);
    if (!isInLibrary)
        return folder.isWithin(way.front()) ? way : std::vector<Url>();
    if (!folder.isWithin(own[1]))
        return {};
    way.erase(way.begin());
    return way;
}

bool MoveTargetPicker::offers(const Url& folder) const
{
    return !wayTo(folder).empty();
}

bool MoveTargetPicker::isToBeMoved(const Url& folder) const
{
    return std::ranges::any_of(_itemsToMove, [&folder](const Url& item) { return folder.isWithin(item); });
}

bool MoveTargetPicker::canChoose(const Url& folder) const
{
    return !_itemsToMove.empty() && !isToBeMoved(folder)
        && std::ranges::any_of(_itemsToMove,
            [&folder](const Url& item) { return !(item.deletingLastPathComponent() == folder); });
}

void MoveTargetPicker::enter(const Url& folder)
{
    if (!isToBeMoved(folder))
        pushViewController(makeScreen(folder), true);
}

void MoveTargetPicker::show(const Url& folder)
{
    std::vector<std::shared_ptr<kit::ViewController>> screens;
    for (const auto& step : wayTo(folder))
        screens.push_back(makeScreen(step));
    if (!screens.empty())
        setViewControllers(std::move(screens), isViewLoaded());
}

void MoveTargetPicker::choose(const Url& folder)
{
    if (_hasEnded || !canChoose(folder))
        return;
    const auto told = _delegate.lock();
    // Only the delegate moves the items and dismisses the picker. It goes with what it wanted to move.
    if (!told)
        return cancel();
    _hasEnded = true;
    RecentMoveTargets::remember(folder);
    told->documentTargetSelectionControllerDidSelectItemAtURL(self(), folder);
}

void MoveTargetPicker::cancel()
{
    if (std::exchange(_hasEnded, true))
        return;
    dismissViewController(true, [picker = self()] {
        if (const auto told = picker->_delegate.lock())
            told->documentTargetSelectionControllerWasCancelled(picker);
    });
}

void MoveTargetPicker::userCancelled()
{
    cancel();
}

} // namespace screens
