// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/ItemMoves.h"

#include "platform/FileSystem.h"
#include "platform/Localization.h"
#include "screens/DisplayName.h"
#include "screens/FolderPlaces.h"

#include <thread>

namespace tarrow {

using platform::ItemVersion;
using platform::localized;

namespace {

std::string shownName(const Url& url)
{
    return screens::displayName(url.lastPathComponent());
}

std::optional<ItemVersion> versionOf(const Url& url)
{
    return services().fileChanges().versionOfItem(url.path());
}

std::optional<std::uint64_t> numberOf(const Url& url)
{
    const auto value = FileUtils::getResourceValueForURL(AttributeKey::DocumentIdentifier, url);
    const auto* number = value ? std::get_if<std::uint64_t>(&*value) : nullptr;
    return number ? std::optional(*number) : std::nullopt;
}

/// Answers the error of an item that stays as it is.
Error refusal(FileErrorCode code, const Url& item, std::string sentence)
{
    return Error(code,
        {{std::string(platform::errorKey::localizedDescription), std::move(sentence)},
            {std::string(platform::errorKey::filePath), item.path()}});
}

/// Answers whether what has an item's name now is another item. A document that was saved or downloaded since
/// has another inode, but still its number.
bool isReplaced(const MovedItem& item, const ItemVersion& now)
{
    const bool isSameFile =
        item.version && now.device == item.version->device && now.inode == item.version->inode;
    return !isSameFile && !(item.number && item.number == numberOf(item.to));
}

std::optional<Error> moveBack(const MovedItem& item, const FileUtils::StillWanted& stillWanted)
{
    bool isOther = false;
    const auto error = FileUtils::moveTo(item.to, item.from, [&] {
        const auto now = versionOf(item.to);
        isOther = now && isReplaced(item, *now);
        return !isOther && stillWanted();
    });
    const bool isChanged = error && error->is(FileErrorCode::Cancelled) && stillWanted();
    if (isOther || isChanged)
        return refusal(FileErrorCode::Cancelled, item.to,
            localized("“%@” wasn’t put back, because another program has changed it.", {shownName(item.to)}));
    if (!error)
        return std::nullopt;
    if (error->is(FileErrorCode::ItemExists) || error->is(FileErrorCode::Unsupported))
        return refusal(FileErrorCode::ItemExists, item.to,
            localized("“%@” wasn’t put back, because its old place is taken.", {shownName(item.to)}));
    const auto folder = item.from.deletingLastPathComponent();
    if (error->is(FileErrorCode::NoSuchItem) && versionOf(item.to) && !FileUtils::exists(folder))
        return refusal(FileErrorCode::NoSuchItem, item.to,
            localized("“%1$@” wasn’t put back, because the folder “%2$@” is no longer there.",
                {shownName(item.to), shownName(folder)}));
    return error;
}

std::vector<Error> moveAllBack(const std::vector<MovedItem>& moved, ItemChange& change)
{
    auto next = moved.begin();
    return change.forEachItem([&](const Url&) { return moveBack(*next++, change.stillWanted()); });
}

std::vector<Url> placesOf(const std::vector<MovedItem>& moved)
{
    std::vector<Url> places;
    for (const auto& item : moved)
        places.push_back(item.to);
    return places;
}

bool isEmptyFolder(const Url& folder)
{
    using platform::FileSystem;
    bool isEmpty = true;
    const auto found = [&](const Url&, const auto&) {
        isEmpty = false;
        return FileSystem::Continue::No;
    };
    services().fileSystem().enumerateShallowly(folder, found, found);
    return isEmpty;
}

/// Answers whether a folder is empty and whoever puts something into it from now on gives it another version.
/// File systems count time in steps, so two changes within a step would not differ.
bool isEmptyForSure(const Url& folder)
{
    constexpr auto fineStep = std::chrono::milliseconds(50), coarseStep = std::chrono::milliseconds(2100);
    constexpr std::int64_t second = 1'000'000'000;
    const auto before = versionOf(folder);
    if (!before || !isEmptyFolder(folder))
        return false;
    const bool isCoarse = before->changed % second == 0 && before->modified % second == 0;
    std::this_thread::sleep_for(isCoarse ? coarseStep : fineStep);
    return versionOf(folder) == before && isEmptyFolder(folder);
}

Error keptBecauseChanged(const Url& folder)
{
    return refusal(FileErrorCode::Cancelled, folder,
        localized("The folder “%@” was kept, because another program has changed it.", {shownName(folder)}));
}

/// Answers why a folder that was made is not the user's to remove any more, or nothing.
std::optional<Error> refuseChanged(const MadeFolder& folder)
{
    const auto now = versionOf(folder.url);
    if (!now)
        return refusal(FileErrorCode::NoSuchItem, folder.url,
            localized("“%@” is no longer there.", {shownName(folder.url)}));
    return now == folder.version ? std::nullopt : std::optional(keptBecauseChanged(folder.url));
}

/// Removes a folder unless something is in it.
std::optional<Error> removeEmpty(const Url& folder, const FileUtils::StillWanted& stillWanted)
{
    bool isEmpty = true;
    auto error = FileUtils::remove(folder, [&] {
        isEmpty = isEmptyForSure(folder);
        return isEmpty && stillWanted();
    });
    if (!isEmpty)
        return refusal(FileErrorCode::Cancelled, folder,
            localized("The folder “%@” was kept, because it isn’t empty.", {shownName(folder)}));
    if (!error || !error->is(FileErrorCode::Cancelled))
        return error;
    return stillWanted() ? std::optional(keptBecauseChanged(folder)) : std::nullopt;
}

} // namespace

Result<MovedItem> moveItem(
    const Url& source, const Url& destination, const FileUtils::StillWanted& stillWanted)
{
    const auto before = versionOf(source);
    const auto number = numberOf(source);
    if (auto error = FileUtils::moveTo(source, destination, stillWanted))
        return std::move(*error);
    if (source.path() == destination.path())
        return {};
    // A move within a file system keeps the inode; only a move to another one makes a new item.
    const auto after = versionOf(destination);
    const bool isCopy = before && after && before->device != after->device;
    return MovedItem{source, destination, isCopy ? after : before, number};
}

MoveOutcome moveItems(ItemChange& change, const Url& folder)
{
    MoveOutcome outcome;
    outcome.errors = change.forEachItem([&](const Url& item) {
        auto moved =
            moveItem(item, folder.appendingPathComponent(item.lastPathComponent()), change.stillWanted());
        if (moved)
            outcome.moved.push_back(std::move(*moved.value));
        return moved.error;
    });
    return outcome;
}

MadeFolder madeFolder(const Url& folder)
{
    return {folder, versionOf(folder)};
}

std::string movedSentence(const Url& from, const Url& to)
{
    const auto folder = to.deletingLastPathComponent();
    if (folder == from.deletingLastPathComponent())
        return localized("“%1$@” is now called “%2$@”", {shownName(from), shownName(to)});
    return localized("“%1$@” was moved to “%2$@”", {shownName(to), screens::folderTitle(folder)});
}

std::optional<UndoEntry> undoOfMoves(const std::vector<MovedItem>& moved)
{
    if (moved.empty())
        return std::nullopt;
    const auto& first = moved.front();
    const auto count = static_cast<std::int64_t>(moved.size());
    return UndoEntry{count == 1 ? movedSentence(first.from, first.to)
                                : platform::localizedPlural(".DICT.ITEMS_MOVED.%d",
                                    {count, screens::folderTitle(first.to.deletingLastPathComponent())}),
        placesOf(moved), [moved](ItemChange& change) { return moveAllBack(moved, change); }};
}

UndoEntry undoOfNewFolder(const MadeFolder& folder, const std::vector<MovedItem>& moved)
{
    auto entry = undoOfMoves(moved).value_or(
        UndoEntry{localized("The folder “%@” was created", {shownName(folder.url)}), {folder.url}, {}});
    entry.changeBack = [folder, moved](ItemChange& change) {
        const auto refused = refuseChanged(folder);
        auto errors = moved.empty() ? std::vector<Error>() : moveAllBack(moved, change);
        if (!errors.empty() || !change.isWanted())
            return errors;
        if (auto kept = refused ? refused : removeEmpty(folder.url, change.stillWanted()))
            errors.push_back(std::move(*kept));
        return errors;
    };
    return entry;
}

} // namespace tarrow
