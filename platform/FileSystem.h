// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Attributes.h"
#include "platform/Error.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace platform {

enum class FileType { Regular, Directory, SymbolicLink, Other };

/// What the file system itself says of a path; a symbolic link is not followed.
struct FileAttributes {
    FileType type = FileType::Other;
    std::uint64_t size = 0; ///< bytes
    std::optional<Date> creationDate; ///< nothing where the file system keeps none
    Date modificationDate;
    bool extensionHidden = false;
};

/// Which state of which item was looked at: while two looks are equal, nothing changed it in between.
struct ItemVersion {
    std::uint64_t device = 0, inode = 0;
    std::uint64_t size = 0; ///< bytes
    std::int64_t modified = 0, changed = 0; ///< nanoseconds since 1970: of the content, of anything
    bool operator==(const ItemVersion&) const = default;
};

/// A document's bytes, and which state of it they were read in or written as.
struct FileContent {
    std::shared_ptr<const std::string> bytes;
    ItemVersion version;
};

/// The file system, without coordination. Questions know nothing of promises; changes take a promise for the
/// item that it stands for, stay within the drive and follow no link. Any thread; every call is synchronous.
class FileSystem {
public:
    virtual ~FileSystem() = default;

    virtual Result<FileAttributes> attributesOfItem(const std::string& path) const = 0;
    virtual Result<std::string> destinationOfSymbolicLink(const std::string& path) const = 0;
    /// Whether something is at the path, links followed, and what: nothing there answers no value.
    virtual std::optional<FileType> typeOfItem(const std::string& path) const = 0;

    /// The user's own documents folder, outside the drive; nothing when none is set up.
    virtual std::optional<Url> userDocumentsFolder() const = 0;

    /// How an enumeration goes on after an entry or an error.
    enum class Continue { Yes, No };
    /// Calls `entry` for everything below a folder, at all levels, hidden files and packages' contents
    /// included, links reported but not followed. `error` hears of each folder that cannot be read.
    virtual void enumerateDeeply(const Url& folder,
        const std::function<Continue(const Url&, FileType)>& entry,
        const std::function<Continue(const Url&, const Error&)>& error) const = 0;
    /// The same for what lies directly in a folder, hidden files included.
    virtual void enumerateShallowly(const Url& folder,
        const std::function<Continue(const Url&, FileType)>& entry,
        const std::function<Continue(const Url&, const Error&)>& error) const = 0;

    /// The version of an item, or of its promise; nothing when neither is there.
    virtual std::optional<ItemVersion> versionOfItem(const std::string& path) const = 0;
    /// Makes a folder and those on the way to it that are missing. One that is there already is no error.
    virtual std::optional<Error> createFolder(const std::string& path) = 0;
    /// Removes an item for good, a folder with everything in it, a link and not its target. An item that is
    /// not `unchangedSince` any more, or changes while it is being removed, is kept
    /// (FileErrorCode::Cancelled).
    virtual std::optional<Error> removeItem(
        const std::string& path, const std::optional<ItemVersion>& unchangedSince) = 0;
    /// Moves an item to a location, its new name included. Nothing is ever replaced
    /// (FileErrorCode::ItemExists), and the item is whole under one of its names at every moment.
    virtual std::optional<Error> moveItem(const std::string& from, const std::string& to) = 0;

    /// All of a document, to be replaced later, as it was at one moment. Errors: EFBIG beyond
    /// `maximumBytes`, EACCES or EROFS when the document or its folder must not be written,
    /// FileErrorCode::NoSuchItem for none and for one that is only promised.
    virtual Result<FileContent> contentToReplace(const std::string& path, std::size_t maximumBytes) const = 0;
    /// Puts another content in a document's place: it lies whole on the disk before the name is given to it,
    /// and takes over identifier, tags and access. One that holds something else than `before` by now is kept
    /// (FileErrorCode::Cancelled). Answers the new content's version.
    virtual Result<ItemVersion> replaceContent(
        const std::string& path, const FileContent& before, std::string_view content) = 0;
    /// Makes a document with the tags and the access of another one beside it, as far as that is there.
    /// Nothing is ever replaced (FileErrorCode::ItemExists).
    virtual std::optional<Error> addDocument(
        const std::string& path, const std::string& like, std::string_view content) = 0;
};

} // namespace platform
