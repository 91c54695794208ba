// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/ItemAdding.h"

#include "items/TrashUtils.h"
#include "platform/CopyName.h"
#include "platform/FileChanges.h"
#include "platform/Localization.h"
#include "platform/TypeRegistry.h"
#include "screens/DisplayName.h"
#include "screens/FolderPlaces.h"

namespace tarrow {

using platform::ItemVersion;
using platform::localized;

namespace {

constexpr int mostCopies = 1000; ///< items of one name

/// A copy that was made, and its state then.
struct AddedItem {
    Url url;
    std::optional<ItemVersion> version;
};

std::string shownName(const Url& url)
{
    return screens::displayName(url.lastPathComponent());
}

/// Answers the error of an item that stays as it is.
Error refusal(const Error& error, const Url& item, std::string sentence)
{
    return Error(error.domain(), error.code(),
        {{std::string(platform::errorKey::localizedDescription), std::move(sentence)},
            {std::string(platform::errorKey::filePath), item.path()}});
}

/// Answers whether an item is a folder that a person sees as one.
bool isFolder(const Url& item)
{
    const auto type = FileUtils::fileUTI(item);
    const bool isPackage =
        type && services().typeRegistry().conformsTo(*type, platform::typeIdentifier::package);
    return FileUtils::isDir(item) && !isPackage;
}

/// Copies an item under the first name that is free.
Result<AddedItem> addItem(const Url& item, const Url& folder, const FileUtils::StillWanted& stillWanted)
{
    std::optional<Error> error(FileErrorCode::ItemExists);
    for (int number = 1; number <= mostCopies && error->is(FileErrorCode::ItemExists); ++number) {
        const auto place =
            folder.appendingPathComponent(platform::copyName(item.lastPathComponent(), number));
        error = FileUtils::copyTo(item, place, stillWanted);
        if (!error)
            return AddedItem{place, services().fileChanges().versionOfItem(place.path())};
    }
    return std::move(*error);
}

/// Answers whether an item is still what was added; a new name or other tags do not matter.
bool isUnchanged(const AddedItem& item)
{
    auto now = services().fileChanges().versionOfItem(item.url.path());
    if (!now || !item.version)
        return false;
    now->changed = item.version->changed;
    return now == item.version;
}

std::optional<Error> removeAdded(const AddedItem& item, const ItemChange& change)
{
    const auto isWanted = [&] { return change.isWanted() && isUnchanged(item); };
    auto error = TrashUtils::moveToTrash(item.url, isWanted).error;
    if (!error || !error->is(FileErrorCode::Cancelled) || !change.isWanted())
        return error;
    return refusal(*error, item.url,
        localized("“%@” wasn’t moved, because another program has changed it.", {shownName(item.url)}));
}

UndoEntry undoOf(const std::vector<AddedItem>& added, const Url& folder)
{
    const auto count = static_cast<std::int64_t>(added.size());
    const auto title = screens::folderTitle(folder);
    std::vector<Url> places;
    places.reserve(added.size());
    for (const auto& item : added)
        places.push_back(item.url);
    auto sentence = count == 1 ? localized("“%1$@” was added to “%2$@”", {shownName(places.front()), title})
                               : platform::localizedPlural(".DICT.ITEMS_ADDED.%d", {count, title});
    return {std::move(sentence), std::move(places), [added](ItemChange& change) {
                auto next = added.begin();
                return change.forEachItem([&](const Url&) { return removeAdded(*next++, change); });
            }};
}

} // namespace

AddingOutcome addItems(ItemChange& change, const Url& folder, Accepts accepts)
{
    AddingOutcome outcome;
    std::vector<AddedItem> added;
    outcome.errors = change.forEachItem([&](const Url& item) -> std::optional<Error> {
        if (accepts == Accepts::FilesOnly && isFolder(item))
            return refusal(Error(FileErrorCode::Unsupported), item,
                localized("“%1$@” wasn’t added, because “%2$@” can’t hold this folder.",
                    {shownName(item), screens::folderTitle(folder)}));
        auto result = addItem(item, folder, change.stillWanted());
        if (result)
            added.push_back(*result);
        const bool isChanged =
            result.error && result.error->is(FileErrorCode::Cancelled) && change.isWanted();
        return isChanged
            ? std::optional(refusal(*result.error, item,
                localized("“%@” wasn’t added, because another program has changed it.", {shownName(item)})))
            : result.error;
    });
    for (const auto& item : added)
        outcome.added.push_back(item.url);
    if (!added.empty())
        outcome.undo = undoOf(added, folder);
    return outcome;
}

} // namespace tarrow
