// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/FileUtils.h"

#include "platform/FileChanges.h"
#include "platform/FileCoordinator.h"

namespace tarrow {

namespace {

using platform::WritingOptions;

platform::FileCoordinator& coordinator()
{
    return services().fileCoordinator();
}

platform::FileChanges& changes()
{
    return services().fileChanges();
}

/// Answers the date of an item's content, or why it cannot be told.
Result<Date> modificationDate(const Url& url)
{
    constexpr AttributeKey keys[] = {AttributeKey::ContentModificationDate};
    const auto values =
        services().cloudDocumentService().promisedItems().promisedItemResourceValues(url, keys);
    const auto value =
        values ? std::optional(values->value(keys[0])) : FileUtils::getResourceValueForURL(keys[0], url);
    if (const auto* date = value ? std::get_if<Date>(&*value) : nullptr)
        return *date;
    return values.error.value_or(Error(FileErrorCode::Cancelled));
}

/// Answers the error of an item that is kept, with the sentence of the reason if there is one.
Error kept(const Result<Date>& date)
{
    auto info = date.error ? date.error->userInfo() : platform::PropertyDictionary();
    return Error(FileErrorCode::Cancelled, std::move(info));
}

/// The state of an item when its deletion was requested.
struct KnownState {
    Result<Date> date;
    std::optional<platform::ItemVersion> version;
};

/// Answers the error of a change that nobody wants any more, or nothing.
std::optional<Error> refuseUnwanted(const FileUtils::StillWanted& stillWanted)
{
    return stillWanted && !stillWanted() ? std::optional(Error(FileErrorCode::Cancelled)) : std::nullopt;
}

/// Deletes the item in a coordinated write, if it is unchanged.
std::optional<Error> removeUnchanged(const Url& location, const KnownState& before)
{
    static constexpr Operation op{"+[FileUtils remove:]"};
    const auto date = modificationDate(location);
    std::optional<Error> error = kept(before.date ? date : before.date);
    if (date && before.date && *date == *before.date)
        error = changes().removeItem(location.path(), before.version);
    if (!error)
        op.info("Deleted item: '%@'", location);
    else if (error->is(FileErrorCode::Cancelled))
        op.info("Date changed during delete (user chose Keep?) -- preserving document: '%@'", location);
    else
        op.error("failed to delete item:'%@': %@", location, *error);
    return error;
}

/// Moves the item in a coordinated write and tells the presenters.
std::optional<Error> moveAnnounced(const Url& source, const Url& destination)
{
    static constexpr Operation op{"+[FileUtils move:to:]"};
    coordinator().itemWillMove(source, destination);
    op.debug("Moving src2:  '%@'", source);
    op.debug("Moving dest2: '%@'", destination);
    auto error = changes().moveItem(source.path(), destination.path());
    if (error) {
        op.warning("KD Move failed: %@", *error);
        return error;
    }
    op.info("Move successful");
    coordinator().itemDidMove(source, destination);
    return std::nullopt;
}

/// Answers an error when the kinds of the items at both ends do not allow a move.
std::optional<Error> refuseKinds(const Url& source, const Url& destination)
{
    static constexpr Operation op{"+[FileUtils move:to:]"};
    if (!FileUtils::exists(source))
        op.info("Move: source filename does not exist, must be a fault.");
    if (FileUtils::isFile(source) && FileUtils::isDir(destination)) {
        op.error("Move: must move a file to a file (dest is a dir)");
        return Error(FileErrorCode::Unsupported);
    }
    if (FileUtils::isDir(source) && FileUtils::isFile(destination)) {
        op.error("Move: must move a dir to a dir (dest is a file)");
        return Error(FileErrorCode::Unsupported);
    }
    return std::nullopt;
}

} // namespace

std::optional<Error> FileUtils::mkdir(const Url& url, const StillWanted& stillWanted)
{
    static constexpr Operation op{"+[FileUtils mkdir:]"};
    op.debug("Creating directory: '%@'", url);
    std::optional<Error> failed;
    const auto refused = coordinator().coordinateWriting(url, WritingOptions::None, [&](const Url& location) {
        failed = refuseUnwanted(stillWanted);
        if (!failed)
            failed = changes().createFolder(location.path());
        if (failed)
            op.error("failed to create directory:'%@': %@", location, *failed);
        else
            op.info("Created directory: '%@'", location);
    });
    auto result = refused ? refused : failed;
    op.debug("Coordinated Write returned %@", result);
    return result;
}

std::optional<Error> FileUtils::remove(const Url& url, const StillWanted& stillWanted)
{
    static constexpr Operation op{"+[FileUtils remove:]"};
    op.debug("Removing item: '%@'", url);
    // The version is read first, so that a change between the two reads shows in the date.
    const auto version = changes().versionOfItem(url.path());
    const KnownState before{modificationDate(url), version};
    std::optional<Error> failed;
    const auto refused =
        coordinator().coordinateWriting(url, WritingOptions::ForDeleting, [&](const Url& location) {
            failed = refuseUnwanted(stillWanted);
            if (!failed)
                failed = removeUnchanged(location, before);
        });
    auto result = refused ? refused : failed;
    op.info("Coordinated Write returned %@", result);
    return result;
}

std::optional<Error> FileUtils::moveTo(
    const Url& source, const Url& destination, const StillWanted& stillWanted)
{
    static constexpr Operation op{"+[FileUtils move:to:]"};
    op.debug("Moving src1:  '%@'", source);
    op.debug("Moving dest1: '%@'", destination);
    if (source.path() == destination.path()) {
        op.debug("Move: src and dest are the same");
        return std::nullopt;
    }
    if (auto refused = refuseKinds(source, destination))
        return refused;
    std::optional<Error> failed;
    const auto refused = coordinator().coordinateWriting(source, WritingOptions::ForMoving, destination,
        WritingOptions::ForReplacing, [&](const Url& from, const Url& to) {
            failed = refuseUnwanted(stillWanted);
            if (!failed)
                failed = moveAnnounced(from, to);
        });
    auto result = refused ? refused : failed;
    if (result)
        op.warning("Move failed: %@", *result);
    return result;
}

std::optional<Error> FileUtils::copyTo(
    const Url& source, const Url& destination, const StillWanted& stillWanted)
{
    static constexpr Operation op{"+[FileUtils copy:to:]"};
    op.debug("Copying '%@' to '%@'", source, destination);
    const auto goesOn = [&] { return !stillWanted || stillWanted(); };
    std::optional<Error> failed;
    const auto refused =
        coordinator().coordinateWriting(destination, WritingOptions::None, [&](const Url& location) {
            failed = refuseUnwanted(stillWanted);
            if (!failed)
                failed = changes().addCopy(source.path(), location.path(), goesOn);
        });
    auto result = refused ? refused : failed;
    if (result)
        op.warning("Copy failed: %@", *result);
    return result;
}

std::optional<Error> FileUtils::evict(const Url& url)
{
    static constexpr Operation op{"+[FileUtils evictDocument:]"};
    std::optional<Error> failed;
    const auto refused = coordinator().coordinateWriting(url, WritingOptions::None,
        [&](const Url& location) { failed = changes().evictItem(location.path()); });
    const auto error = refused ? refused : failed;
    if (error)
        op.warning("Evict error: %@", *error);
    return error;
}

bool FileUtils::evictDocument(const Url& url)
{
    return !evict(url);
}

} // namespace tarrow
