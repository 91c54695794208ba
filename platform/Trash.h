// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Date.h"
#include "platform/Error.h"
#include "platform/FileChanges.h"
#include "platform/FileSystem.h"

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace platform {

/// An item in the trash.
struct TrashedItem {
    /// Why the item is in the trash.
    enum class Reason : std::uint8_t {
        Trashed, ///< it was moved there
        NotPutBack, ///< a start found it out of its place and could not put it back
        KeptCopy, ///< another program saved in its place while it was being moved there
        /// It is a content in the cloud that nothing in the drive stands for any more. Its name is lost, and
        /// it is restored as a promise, in the folder for documents when no place is given.
        ContentWithoutPromise,
    };

    std::string identifier; ///< its name for the operations of Trash
    std::string name; ///< as bytes; the one that it had in its folder
    FileType type = FileType::Regular;
    bool isPromise = false; ///< its content is in the cloud
    bool standsForAnother = false; ///< it is an alias or a reference, whose extension is not to be shown
    std::optional<std::uint64_t> size; ///< of a document, in bytes
    std::string origin; ///< the absolute path where it was; empty when that is not known
    std::optional<Date> trashed; ///< when it came into the trash; absent when that is not known
    Reason reason = Reason::Trashed;

    bool operator==(const TrashedItem&) const = default;
};

/// The trash of the drive. It keeps items as they are, the ones that are only promised too, together with
/// where they were. The operations are without coordination: who needs others kept out calls them inside an
/// accessor of the FileCoordinator. They replace nothing and follow no link. Any thread may call; every call
/// is synchronous and waits for the disk. Unless a comment says otherwise errors are those of FileChanges,
/// and FileErrorCode::NoSuchItem for an identifier that the trash does not know (any more). Each has a
/// sentence for the user. Notification::TrashDidChange is posted after every change, also by other programs.
class Trash {
public:
    virtual ~Trash() = default;

    /// Moves an item of the drive into the trash, a folder with everything in it. An item that is not
    /// `unchangedSince` any more, or changes while it is being moved, stays (FileErrorCode::Cancelled). When
    /// another program saves in its place at that moment, both are kept, this one in the trash. Errors:
    /// FileErrorCode::Unsupported for a container and for what has a private name of the drive.
    virtual Result<TrashedItem> moveToTrash(
        const std::string& path, const std::optional<ItemVersion>& unchangedSince) = 0;
    /// Answers what is in the trash, the newest first. An error means that not everything could be listed.
    virtual Result<std::vector<TrashedItem>> items() = 0;
    /// Moves an item back and answers its path. Without a `target` that is the place where it was, or the
    /// drive's top level when this is not known; a target's last name is the item's new one. Folders on the
    /// way are made when they are missing. Errors: FileErrorCode::ItemExists when the place is taken.
    virtual Result<std::string> restore(
        const std::string& identifier, const std::optional<std::string>& target) = 0;
    /// Removes an item for good, with the contents behind its promises. All of it goes or nothing.
    virtual std::optional<Error> remove(const std::string& identifier) = 0;
    /// Removes for good what was moved into the trash before a moment. What is there for another reason, and
    /// what has no date or one that cannot be right, stays. Answers the first error; it goes on after one.
    virtual std::optional<Error> removeOlderThan(Date moment) = 0;
};

} // namespace platform
