// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/TrashUtils.h"

#include "platform/CopyName.h"
#include "platform/Dispatch.h"
#include "platform/FileChanges.h"
#include "platform/FileCoordinator.h"

#include <chrono>

namespace tarrow {

namespace {

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
    return top.value_or(Url::fileURL("/")).appendingPathComponent(item.name);
}

void TrashUtils::removeOld()
{
    static constexpr Operation op{"+[TrashUtils removeOld]"};
    const auto now = services().dispatch().now();
    constexpr auto longestStay = std::chrono::nanoseconds(std::chrono::days(daysInTrash));
    if (const auto error = services().trash().removeOlderThan({now.nanoseconds - longestStay.count()}))
        op.warning("Cannot remove what is old in the trash: %@", *error);
}

} // namespace tarrow
