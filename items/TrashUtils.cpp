// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/TrashUtils.h"

#include "platform/CopyName.h"
#include "platform/Dispatch.h"
#include "platform/FileChanges.h"
#include "platform/FileCoordinator.h"
#include "platform/Localization.h"
#include "screens/DisplayName.h"

#include <chrono>

namespace tarrow {

namespace {

using platform::localized;
using platform::WritingOptions;

constexpr int mostCopies = 1000; ///< items of one name

/// Performs a change in a coordinated write, if it is still wanted then.
template <typename Value>
Result<Value> coordinated(const Url& url, WritingOptions options, const FileUtils::StillWanted& stillWanted,
    const std::function<Result<Value>(const Url& location)>& change)
{
    Result<Value> result = Error(FileErrorCode::Cancelled);
    const auto refused =
        services().fileCoordinator().coordinateWriting(url, options, [&](const Url& location) {
            if (!stillWanted || stillWanted())
                result = change(location);
        });
    return refused ? Result<Value>(*refused) : result;
}

Result<Url> restoreTo(const TrashedItem& item, const Url& target, const FileUtils::StillWanted& stillWanted)
{
    return coordinated<Url>(target, WritingOptions::None, stillWanted, [&](const Url& location) {
        const auto path = services().trash().restore(item.identifier, location.path());
        return path ? Result<Url>(Url::fileURL(*path)) : *path.error;
    });
}

bool isNameLost(const TrashedItem& item)
{
    return item.reason == TrashedItem::Reason::ContentWithoutPromise;
}

/// Answers the error of an item that stays as it is.
Error refusal(FileErrorCode code, const Url& item, std::string sentence)
{
    return Error(code,
        {{std::string(platform::errorKey::localizedDescription), std::move(sentence)},
            {std::string(platform::errorKey::filePath), item.path()}});
}

std::string shownName(const Url& url)
{
    return screens::displayName(url.lastPathComponent());
}

/// Moves items back that were moved to the trash, and answers why the others stay there.
std::vector<Error> moveAllBack(const std::vector<TrashedItem>& items, ItemChange& change)
{
    auto outcome = restoreItems(change, items, IfTaken::Refuse);
    for (const auto& item : outcome.refused)
        outcome.errors.push_back(refusal(FileErrorCode::ItemExists, TrashUtils::placeOf(item),
            localized(
                "“%@” wasn’t put back, because its old place is taken.", {screens::displayName(item.name)})));
    return outcome.errors;
}

UndoEntry undoOf(const std::vector<TrashedItem>& items)
{
    const auto count = static_cast<std::int64_t>(items.size());
    auto sentence = count == 1
        ? localized("“%@” was moved to the trash", {screens::displayName(items.front().name)})
        : platform::localizedPlural(".DICT.ITEMS_TRASHED.%d", {count});
    return {std::move(sentence), placesOf(items),
        [items](ItemChange& change) { return moveAllBack(items, change); }};
}

} // namespace

Result<TrashedItem> TrashUtils::moveToTrash(const Url& url, const StillWanted& stillWanted)
{
    static constexpr Operation op{"+[TrashUtils moveToTrash:]"};
    op.debug("Moving item to the trash: '%@'", url);
    const auto version = services().fileChanges().versionOfItem(url.path());
    auto result = coordinated<TrashedItem>(url, WritingOptions::ForDeleting, stillWanted,
        [&](const Url& location) { return services().trash().moveToTrash(location.path(), version); });
    if (result.error)
        op.warning("failed to move item to the trash:'%@': %@", url, *result.error);
    return result;
}

Result<Url> TrashUtils::restore(const TrashedItem& item, const StillWanted& stillWanted)
{
    return restoreTo(item, placeOf(item), stillWanted);
}

Result<Url> TrashUtils::restoreBeside(const TrashedItem& item, const StillWanted& stillWanted)
{
    const auto place = placeOf(item);
    Result<Url> result = Error(FileErrorCode::ItemExists);
    for (int number = 2; number <= mostCopies && result.error && result.error->is(FileErrorCode::ItemExists);
         ++number) {
        const auto name = platform::copyName(place.lastPathComponent(), number);
        result = restoreTo(item, place.deletingLastPathComponent().appendingPathComponent(name), stillWanted);
    }
    return result;
}

Url TrashUtils::placeOf(const TrashedItem& item)
{
    if (!item.origin.empty())
        return Url::fileURL(item.origin);
    // Nobody restores anything while nobody is signed in, and the trash refuses a place outside the drive.
    const auto top = services().cloudDocumentService().containers().defaultContainerURL();
    const auto folder = top.value_or(Url::fileURL("/"));
    return (isNameLost(item) ? folder.appendingPathComponent("Documents") : folder)
        .appendingPathComponent(item.name);
}

void TrashUtils::removeOld()
{
    static constexpr Operation op{"+[TrashUtils removeOld]"};
    const auto now = services().dispatch().now();
    constexpr auto longestStay = std::chrono::nanoseconds(std::chrono::days(daysInTrash));
    if (const auto error = services().trash().removeOlderThan({now.nanoseconds - longestStay.count()}))
        op.warning("Cannot remove what is old in the trash: %@", *error);
}

TrashingOutcome moveItemsToTrash(ItemChange& change)
{
    TrashingOutcome outcome;
    std::vector<TrashedItem> moved;
    outcome.errors = change.forEachItem([&](const Url& item) {
        auto result = TrashUtils::moveToTrash(item, change.stillWanted());
        if (result)
            moved.push_back(std::move(*result.value));
        const bool isChanged =
            result.error && result.error->is(FileErrorCode::Cancelled) && change.isWanted();
        return isChanged
            ? std::optional(refusal(FileErrorCode::Cancelled, item,
                localized("“%@” wasn’t moved, because another program has changed it.", {shownName(item)})))
            : result.error;
    });
    if (!moved.empty())
        outcome.undo = undoOf(moved);
    return outcome;
}

RestoringOutcome restoreItems(ItemChange& change, const std::vector<TrashedItem>& items, IfTaken ifTaken)
{
    RestoringOutcome outcome;
    auto next = items.begin();
    outcome.errors = change.forEachItem([&](const Url&) -> std::optional<Error> {
        const auto& item = *next++;
        auto result = TrashUtils::restore(item, change.stillWanted());
        const bool isTaken = result.error && result.error->is(FileErrorCode::ItemExists);
        // The name of a content without a promise is none that anybody has chosen.
        const bool keepsBoth = ifTaken == IfTaken::KeepBoth || isNameLost(item);
        if (isTaken && keepsBoth)
            result = TrashUtils::restoreBeside(item, change.stillWanted());
        else if (isTaken)
            outcome.refused.push_back(item);
        if (result)
            outcome.restored.push_back(*result);
        return isTaken && !keepsBoth ? std::nullopt : result.error;
    });
    return outcome;
}

std::vector<Error> removeItemsForGood(ItemChange& change, const std::vector<TrashedItem>& items)
{
    auto next = items.begin();
    return change.forEachItem([&](const Url&) {
        auto error = services().trash().remove((next++)->identifier);
        // Another program may have removed it meanwhile.
        return error && error->is(FileErrorCode::NoSuchItem) ? std::nullopt : error;
    });
}

std::vector<Url> placesOf(const std::vector<TrashedItem>& items)
{
    std::vector<Url> places;
    places.reserve(items.size());
    for (const auto& item : items)
        places.push_back(TrashUtils::placeOf(item));
    return places;
}

} // namespace tarrow
