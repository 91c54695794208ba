// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/PlatformNames.h"

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace tarrow {

/// What is done to files, and questions about them that change nothing.
///
/// Any thread; nothing is downloaded. What changes an item blocks until other readers and writers, in any
/// process, let it, and never shows anything itself: it answers the error, or nothing.
class FileUtils {
public:
    FileUtils() = delete;

    /// Whether something exists at the URL's path, links followed.
    static bool exists(const Url& url);
    /// Whether something exists there and is not a folder.
    static bool isFile(const Url& url);
    /// Whether a folder exists there.
    static bool isDir(const Url& url);
    /// The user's documents folder outside the drive; nothing when there is none.
    static std::optional<Url> docDir();

    /// An attribute of an item, present or promised; where the promise gives none, that of the plain file.
    /// Nothing for no URL and for an attribute without a value.
    static std::optional<AttributeValue> getResourceValueForURL(
        AttributeKey key, const std::optional<Url>& url);
    /// Logs the dates and the size of what lies at a path.
    static void logFileAttributes(const std::string& path);

    /// The content type of the name's extension; nothing without an extension or for an unknown one.
    static std::optional<std::string> fileUTI(const Url& url);
    /// Whether the name's extension is one of images, movies, sounds or PDF documents.
    static bool isAudioVideoImageFile(const Url& url);
    /// Whether a document of this name may live in the container that the URL lies in.
    static bool isValidExtensionForContainer(const Url& url);
    /// Whether a text (UTF-8) may be the name of an item. Its length is not judged.
    static bool isValidFilename(std::string_view name);

    /// What stands between the names of a location line, blanks included.
    static std::string_view pathBarArrowCharacter(bool rightToLeft);

    /// Splits a location into its container and the names to show for the folders from the container's
    /// documents folder down to the item, the item's own name last (no list for the documents folder itself).
    /// Each output is set only when it was asked for and could be found. An error may be answered beside set
    /// outputs; FileErrorCode::Formatting when the location cannot be split.
    static std::optional<Error> containerAndRelativePathforURLContainerRelativePathComponents(const Url& url,
        std::shared_ptr<const DocumentContainer>* container,
        std::optional<std::vector<std::string>>* relativePathComponents);

    /// Where an item lies, as a line for the screen: the drive, the app library and the folders, without the
    /// item's own name. Nothing when the location cannot be split.
    static std::optional<std::string> displayableLocationForURL(const Url& url);

    /// Makes a folder, and those on the way to it that are missing.
    static std::optional<Error> mkdir(const Url& url);
    /// Deletes an item for good, unless it was changed since this was called: then it is kept, and
    /// FileErrorCode::Cancelled answered.
    static std::optional<Error> remove(const Url& url);
    /// Moves an item to a new location, its name included; so it renames, too. Moving it to where it is does
    /// nothing. FileErrorCode::Unsupported when a folder is at a file's new location or a file at a folder's.
    static std::optional<Error> moveTo(const Url& source, const Url& destination);
    /// Removes the downloaded copy of a cloud item. Whether no error was reported.
    static bool evictDocument(const Url& url);
};

} // namespace tarrow
