// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace platform {

/// Names the state of an item that was looked at. While two looks are equal, nothing has changed the item in
/// between.
struct ItemVersion {
    std::uint64_t device = 0, inode = 0; ///< by which the system tells items apart
    std::uint64_t size = 0; ///< bytes
    /// When the content was changed last, and when anything of the item was (also its name or an attribute),
    /// in nanoseconds since 1970.
    std::int64_t modified = 0, changed = 0;
    bool operator==(const ItemVersion&) const = default;
};

/// A document's bytes, together with the state of the document that they are.
struct FileContent {
    std::shared_ptr<const std::string> bytes; ///< never null when a call answers it
    ItemVersion version; ///< the state in which they were read or written
};

/// Answers whether a text (UTF-8) can be the name of a tag: it is not empty, has at most 255 bytes, no comma
/// and no control character, and neither begins nor ends with a blank.
bool isTag(std::string_view text);

/// The changes of the drive's items, and the looks that a change is compared with. They are without
/// coordination: who needs others kept out calls them inside an accessor of the FileCoordinator. They take a
/// promise for the item that it stands for, stay within the drive (EXDEV elsewhere) and follow no link. Paths
/// are absolute, and are bytes as the system has them; one that holds a NUL is refused. Any thread may call;
/// every call is synchronous and waits for the disk. Unless a comment says otherwise errors are the system's:
/// FileErrorCode::NoSuchItem, ItemExists and InvalidName where they fit, else the errno. Each has a sentence
/// for the user.
class FileChanges {
public:
    virtual ~FileChanges() = default;

    /// Answers the version of an item, or of its promise; nothing when neither is there, and outside of the
    /// drive.
    virtual std::optional<ItemVersion> versionOfItem(const std::string& path) const = 0;
    /// Makes a folder and those on the way to it that are missing. A folder that is there already is no
    /// error. When the folder cannot be made, those that were made on the way go again. Errors: ItemExists
    /// also where a promise has the name.
    virtual std::optional<Error> createFolder(const std::string& path) = 0;
    /// Removes an item for good: a folder with everything in it, a promise with its content in the cloud, a
    /// link and not its target. All of it goes or nothing. An item that is not `unchangedSince` any more, or
    /// changes while it is being removed, is kept (FileErrorCode::Cancelled); so is a folder with something
    /// in it that may not be removed, or that is mounted (EBUSY).
    virtual std::optional<Error> removeItem(
        const std::string& path, const std::optional<ItemVersion>& unchangedSince) = 0;
    /// Moves an item to a location, whose last name is the item's new one. Nothing is ever replaced
    /// (FileErrorCode::ItemExists), and the item is whole under one of its names at every moment, also when
    /// the process is killed. To another file system it is copied, compared and then removed; one that
    /// changes meanwhile stays where it was (FileErrorCode::Cancelled). Errors: EINVAL for a folder that
    /// would come to lie in itself.
    virtual std::optional<Error> moveItem(const std::string& from, const std::string& to) = 0;

    /// Removes the downloaded copy of a document or package and keeps the content in the cloud; a promise
    /// takes its place. One that is only promised already is no error. Errors: FileErrorCode::Unsupported for
    /// what is neither; FileErrorCode::ItemExists when a promise of another content lies beside it;
    /// FileErrorCode::Cancelled when it changes meanwhile; EBUSY while something in a package is being
    /// changed, and why a package could not be copied or removed later. It stays whole after every error.
    virtual std::optional<Error> evictItem(const std::string& path) = 0;

    /// Reads all of a document, as it was at one moment, to be replaced later. Errors: EFBIG beyond
    /// `maximumBytes`; EACCES or EROFS when the document or its folder must not be written; EBUSY when the
    /// document changed in each of three attempts; FileErrorCode::NoSuchItem when there is none and when it
    /// is only promised; FileErrorCode::Unsupported for what is no file.
    virtual Result<FileContent> contentToReplace(const std::string& path, std::size_t maximumBytes) const = 0;
    /// Replaces a document's content and answers the version of the new one. The new content lies whole on
    /// the disk before it gets the name in one step, and it takes over identifier, tags and access. A
    /// document that does not hold `before` any more, because another program saved it, is kept
    /// (FileErrorCode::Cancelled); other tags or a new name are no such change.
    virtual Result<ItemVersion> replaceContent(
        const std::string& path, const FileContent& before, std::string_view content) = 0;
    /// Answers the tags that an item shall have in place of these. It is asked again when another program
    /// changes the item in between.
    using TagEdit = std::function<std::vector<std::string>(const std::vector<std::string>& before)>;
    /// Gives an item other tags, also one that is only promised, and answers those that it had before.
    /// Nothing is written when the tags stay the same. Errors: FileErrorCode::InvalidName for a tag that
    /// cannot be kept (see isTag()); FileErrorCode::Unsupported for what can have no tags, such as a link;
    /// E2BIG or ENOSPC for more tags than an item can have; EBUSY when another program changed the item in
    /// each of three attempts.
    virtual Result<std::vector<std::string>> editTags(const std::string& path, const TagEdit& edit) = 0;

    /// Makes a document with the tags and the access of another one, `like`, as far as that one is there; the
    /// identifier stays with the other one. Nothing is ever replaced (FileErrorCode::ItemExists), and a
    /// document that cannot be made whole leaves nothing.
    virtual std::optional<Error> addDocument(
        const std::string& path, const std::string& like, std::string_view content) = 0;
    /// Copies an item from anywhere on this machine to a location of the drive: a folder with everything in
    /// it, a link as a link. The copy is whole and on the disk when it gets its name, nothing is ever
    /// replaced (FileErrorCode::ItemExists), and an item that cannot be copied whole leaves nothing. The copy
    /// has the contents, dates, tags and access of its original, but its user may always change it, and it is
    /// an item of its own. `goesOn` is asked many times on the way. Errors: FileErrorCode::Cancelled when it
    /// answers false, and when another program changes the item meanwhile; FileErrorCode::Unsupported for a
    /// folder that would come to lie in itself, for what is still in the cloud, and for what is neither a
    /// document nor a folder nor a link.
    virtual std::optional<Error> addCopy(
        const std::string& from, const std::string& to, const std::function<bool()>& goesOn) = 0;
};

} // namespace platform
