// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/PlatformNames.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace tarrow {

/// Operations on files, and questions about files that change nothing.
///
/// Any thread; nothing is downloaded. An operation that changes an item blocks until other readers and
/// writers in any process have let it. It never shows anything itself: it answers the error, or nothing.
class FileUtils {
public:
    FileUtils() = delete;

    /// Answers whether something exists at the URL's path. Links are followed.
    static bool exists(const Url& url);
    /// Answers whether something exists there that is not a folder.
    static bool isFile(const Url& url);
    /// Answers whether a folder exists there.
    static bool isDir(const Url& url);
    /// Answers the user's documents folder outside the drive, or nothing when there is none.
    static std::optional<Url> docDir();

    /// Answers an attribute of an item, present or promised. An attribute that the promise does not have is
    /// read from the plain file. Answers nothing without a URL and for an attribute without a value.
    static std::optional<AttributeValue> getResourceValueForURL(
        AttributeKey key, const std::optional<Url>& url);
    /// Logs the dates and the size of the item at a path.
    static void logFileAttributes(const std::string& path);

    /// Answers the content type of the name's extension, or nothing without an extension or for an unknown
    /// one.
    static std::optional<std::string> fileUTI(const Url& url);
    /// Answers whether the name's extension is one of images, movies, sounds or PDF documents.
    static bool isAudioVideoImageFile(const Url& url);
    /// Answers whether a document of this name may lie in the container in which the URL lies.
    static bool isValidExtensionForContainer(const Url& url);
    /// Answers whether a text (UTF-8) may be the name of an item. The length is not checked.
    static bool isValidFilename(std::string_view name);

    /// Answers the separator between the names of a location line, blanks included.
    static std::string_view pathBarArrowCharacter(bool rightToLeft);

    /// Splits a location into its container and the names to show for the folders from the container's
    /// documents folder down to the item, the item's own name last (no list for the documents folder itself).
    /// Each output is set only when it was asked for and could be found. The answer is an error, even beside
    /// outputs that are set, or nothing; FileErrorCode::Formatting means that the location cannot be split.
    static std::optional<Error> containerAndRelativePathforURLContainerRelativePathComponents(const Url& url,
        std::shared_ptr<const DocumentContainer>* container,
        std::optional<std::vector<std::string>>* relativePathComponents);

    /// Answers the location of an item as a line for the screen: the drive, the app library and the folders,
    /// without the item's own name. Answers nothing when the location cannot be split.
    static std::optional<std::string> displayableLocationForURL(const Url& url);

    /// Asked once it is the change's turn, on the same thread, right before the disk is changed. When it
    /// answers false, nothing is changed and FileErrorCode::Cancelled is answered. Empty: always wanted.
    using StillWanted = std::function<bool()>;

    /// Creates a folder and the missing folders above it.
    static std::optional<Error> mkdir(const Url& url, const StillWanted& stillWanted = {});
    /// Deletes an item for good. If the item changed after this was called, it is kept and
    /// FileErrorCode::Cancelled is answered.
    static std::optional<Error> remove(const Url& url, const StillWanted& stillWanted = {});
    /// Moves an item to a new location whose last part is the item's new name, so this renames as well.
    /// Moving an item to its own location does nothing. Answers FileErrorCode::Unsupported when a folder is
    /// at a file's new location or a file at a folder's.
    static std::optional<Error> moveTo(
        const Url& source, const Url& destination, const StillWanted& stillWanted = {});
    /// Copies an item from anywhere on this machine to a location of the drive, see
    /// platform::FileChanges::addCopy(). It asks `stillWanted` on the way, too.
    static std::optional<Error> copyTo(
        const Url& source, const Url& destination, const StillWanted& stillWanted = {});
    /// Gives an item other tags in place of its own, adds tags and takes some away, or takes such a change
    /// back. All answer the tags before, which changeTagsBack() needs. The last gives an item that still has
    /// the tags of the change the ones before, in their order; tags that were changed since stay as they are.
    /// The item may be only promised; for a reference the document that it stands for gets them. Tags that
    /// cannot be are FileErrorCode::InvalidName, items that can have none FileErrorCode::Unsupported, and a
    /// change is given up when the item changes all the time (EBUSY).
    static Result<std::vector<std::string>> setTags(
        const Url& url, const std::vector<std::string>& tags, const StillWanted& stillWanted = {});
    static Result<std::vector<std::string>> changeTags(const Url& url, const std::vector<std::string>& added,
        const std::vector<std::string>& removed, const StillWanted& stillWanted = {});
    static Result<std::vector<std::string>> changeTagsBack(const Url& url,
        const std::vector<std::string>& before, const std::vector<std::string>& added,
        const std::vector<std::string>& removed, const StillWanted& stillWanted = {});
    /// Removes the downloaded copy of a document and keeps the content in the cloud. See
    /// platform::FileChanges::evictItem() for the errors.
    static std::optional<Error> evict(const Url& url);
    /// Does the same and answers whether no error was reported.
    static bool evictDocument(const Url& url);
};

} // namespace tarrow
