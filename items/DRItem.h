// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/PlatformNames.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace platform {
class OperationQueue;
enum class FileType;
} // namespace platform

namespace tarrow {

/// What is known of one item of the drive: a snapshot, read when it is built and again whenever its URL is
/// replaced. An empty text, list or optional means that there is none.
///
/// A record has no lock. Its fields may be read on any thread, but not while it is being read anew.
class DRItem {
    struct Token {
        explicit Token() = default;
    };

public:
    /// Reads the item at a file URL; null when there is none or it cannot be read at all.
    static std::shared_ptr<DRItem> initWithURL(const Url& url);
    /// Always throws std::invalid_argument: a record needs a URL.
    [[noreturn]] static std::shared_ptr<DRItem> init();
    DRItem(Token, const Url& url);

    /// The location that the record was built for. An equal one changes nothing, another one reads the record
    /// anew.
    const Url& url() const { return _url; }
    void setUrl(const Url& url);
    /// Where the contents really lie: references and promises resolved; for a link or an alias, its target.
    const std::optional<Url>& resolvedURL() const { return _resolvedURL; }
    void setResolvedURL(std::optional<Url> url) { _resolvedURL = std::move(url); }
    const std::string& localizedName() const { return _localizedName; }
    void setLocalizedName(std::string name) { _localizedName = std::move(name); }
    const std::string& typeIdentifier() const { return _typeIdentifier; }
    void setTypeIdentifier(std::string type) { _typeIdentifier = std::move(type); }
    const std::string& localizedTypeDescription() const { return _localizedTypeDescription; }
    void setLocalizedTypeDescription(std::string text) { _localizedTypeDescription = std::move(text); }
    /// Bytes; for a package without a size of its own, those of its contents.
    std::optional<std::uint64_t> fileSize() const { return _fileSize; }
    void setFileSize(std::optional<std::uint64_t> size) { _fileSize = size; }
    /// The size as it was read, in the user's language.
    std::string friendlyFileSize() const;
    void setFriendlyFileSize(std::string text);
    const std::optional<Date>& creationDate() const { return _creationDate; }
    void setCreationDate(std::optional<Date> date) { _creationDate = date; }
    const std::optional<Date>& contentModificationDate() const { return _contentModificationDate; }
    void setContentModificationDate(std::optional<Date> date) { _contentModificationDate = date; }
    const std::optional<Url>& parentDirectoryURL() const { return _parentDirectoryURL; }
    void setParentDirectoryURL(std::optional<Url> url) { _parentDirectoryURL = std::move(url); }
    /// The top folder of a document container.
    bool isContainer() const { return _isContainer; }
    void setIsContainer(bool value) { _isContainer = value; }
    /// A folder that is no package.
    bool isDirectory() const { return _isDirectory; }
    void setIsDirectory(bool value) { _isDirectory = value; }
    bool hasHiddenExtension() const { return _hasHiddenExtension; }
    void setHasHiddenExtension(bool value) { _hasHiddenExtension = value; }
    /// Fetches the thumbnail when it is asked for first; once for each reading, even when there was none.
    const std::optional<Image>& thumbnail();
    void setThumbnail(std::optional<Image> image) { _thumbnail = std::move(image); }
    bool thumbnailFetched() const { return _thumbnailFetched; }
    void setThumbnailFetched(bool value) { _thumbnailFetched = value; }
    bool renameable() const { return _renameable; }
    void setRenameable(bool value) { _renameable = value; }
    /// A reference to a document kept elsewhere.
    bool isBookmark() const { return _isBookmark; }
    void setIsBookmark(bool value) { _isBookmark = value; }
    const std::vector<std::string>& tags() const { return _tags; }
    void setTags(std::vector<std::string> tags) { _tags = std::move(tags); }
    /// Where the promise lies; the very same object as resolvedURL() when there is none.
    const std::optional<Url>& promiseURL() const { return _promiseURL; }
    void setPromiseURL(std::optional<Url> url) { _promiseURL = std::move(url); }
    bool isDownloaded() const { return _isDownloaded; }
    void setIsDownloaded(bool value) { _isDownloaded = value; }

    /// Judged by the identity of promiseURL() and resolvedURL(), not by their paths.
    bool isPromise() const;
    /// The text of a symbolic link that only the plain file system could read.
    const std::string& symlinkTarget() const { return _symlinkTarget; }
    bool isPackage() const { return _isPackage; }
    /// Kept from the last reading when a later one fails.
    bool canPreview() const { return _canPreview; }
    /// A symbolic link or an alias.
    bool isSymlink() const { return _isSymlink; }

    /// Clears the record and reads it anew; false when the item could not be read. A reading that could not
    /// be coordinated leaves the record cleared and counts as done.
    bool cacheValues();
    void clearValues();
    /// Reads the item from the plain file system, without coordination.
    bool initFromAttributes();
    /// Fills the record from attributes read at a location.
    void initFromKeysAndValuesWithURL(const AttributeMap& values, const Url& url);
    /// The target of an alias file, found without asking the user and without mounting anything.
    std::optional<Url> resolvePathwellAlias(const Url& url);

    /// A date in the user's language with the short time; nothing for no date.
    static std::optional<std::string> friendlyDateStyle(const std::optional<Date>& date, DateStyle style);
    std::optional<std::string> friendlyCreationDate(DateStyle style) const;
    std::optional<std::string> friendlyContentModificationDate(DateStyle style) const;
    /// The summed bytes of everything below a folder, as promised where it is not here.
    static std::uint64_t sizeOfPackage(const std::optional<Url>& url);
    /// The record in one line, for logs.
    std::string description() const;

    /// Takes the 1024-pixel thumbnail of a thumbnail map; anything else changes nothing.
    void updateThumbnailImage(const std::optional<AttributeValue>& thumbnailMap);
    bool canGenerateThumbnail() const { return false; }
    /// Calls back at once, on this thread, without an image.
    void generateThumbnail(const std::function<void(std::optional<Image>)>& completion) const;
    /// The process's queue for fetching thumbnails, at background quality; made on first use.
    static const std::shared_ptr<platform::OperationQueue>& getThumbnailQueue();

private:
    void fetchThumbnail(const Url& resolved);
    bool readCoordinated(const Url& resolved);
    bool isResolvedURL(const Url& location) const;
    bool readValues(const Url& location);
    void readType(const AttributeMap& values, const Url& location);
    void readSize(const AttributeMap& values);
    void readContainer(const AttributeMap& values, const Url& location);
    bool readFileType(platform::FileType type);
    void readLinkDestination();
    void setSize(std::optional<std::uint64_t> size);

    Url _url;
    std::optional<Url> _resolvedURL, _parentDirectoryURL, _promiseURL;
    std::string _localizedName, _typeIdentifier, _localizedTypeDescription, _symlinkTarget;
    std::optional<std::uint64_t> _fileSize;
    std::optional<std::uint64_t> _friendlySize; // the size behind friendlyFileSize(), unless a text was set
    std::string _friendlyFileSize;
    std::optional<Date> _creationDate, _contentModificationDate;
    std::optional<Image> _thumbnail;
    std::vector<std::string> _tags;
    bool _isContainer = false, _isDirectory = false, _isPackage = false, _thumbnailFetched = false;
    bool _isBookmark = false, _isDownloaded = false, _isSymlink = false, _canPreview = false;
    bool _hasHiddenExtension = true, _renameable = true;
};

} // namespace tarrow
