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

/// The attributes of one item of the drive: a snapshot, read when the record is built and again whenever its
/// URL is replaced. An empty text, list or optional means that the item has no such attribute.
///
/// A record has no lock. Its fields may be read on any thread, but not while the record is being read again.
class DRItem : public std::enable_shared_from_this<DRItem> {
    struct Token {
        explicit Token() = default;
    };

public:
    /// Reads the item at a file URL. Answers null when there is none or it cannot be read at all.
    static std::shared_ptr<DRItem> initWithURL(const Url& url);
    /// Always throws std::invalid_argument, because a record needs a URL.
    [[noreturn]] static std::shared_ptr<DRItem> init();
    DRItem(Token, Url url);

    /// The location for which the record was built. Setting an equal one changes nothing; setting another one
    /// reads the record again.
    const Url& url() const { return _url; }
    void setUrl(const Url& url);
    /// The location of the contents, with references and promises resolved. For a link or an alias it is the
    /// target.
    const std::optional<Url>& resolvedURL() const { return _resolvedURL; }
    void setResolvedURL(std::optional<Url> url) { _resolvedURL = std::move(url); }
    const std::string& localizedName() const { return _localizedName; }
    void setLocalizedName(std::string name) { _localizedName = std::move(name); }
    const std::string& typeIdentifier() const { return _typeIdentifier; }
    void setTypeIdentifier(std::string type) { _typeIdentifier = std::move(type); }
    const std::string& localizedTypeDescription() const { return _localizedTypeDescription; }
    void setLocalizedTypeDescription(std::string text) { _localizedTypeDescription = std::move(text); }
    /// The size in bytes. For a package without a size of its own it is the sum of its contents.
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
    /// Answers whether the item is the top folder of a document container.
    bool isContainer() const { return _isContainer; }
    void setIsContainer(bool value) { _isContainer = value; }
    /// Answers whether the item is a folder and not a package.
    bool isDirectory() const { return _isDirectory; }
    void setIsDirectory(bool value) { _isDirectory = value; }
    bool hasHiddenExtension() const { return _hasHiddenExtension; }
    void setHasHiddenExtension(bool value) { _hasHiddenExtension = value; }
    /// Answers the thumbnail that is in memory, at once. The first question of a reading begins to fetch it
    /// on a worker when memory does not have it, once for each reading, even when there is none; one that the
    /// desktop does not have is made there. Main thread.
    const std::optional<Image>& thumbnail();
    /// Calls back once on the main thread when the fetch that is under way has found a thumbnail, which
    /// thumbnail() answers from then on. It is not called when no fetch is under way, when there is no
    /// thumbnail, and when the record is read again or ends before; a fetch that has not begun by then is
    /// left out. The callback holds weakly what may end first. Main thread.
    void whenThumbnailArrives(std::function<void()> arrived);
    void setThumbnail(std::optional<Image> image) { _thumbnail = std::move(image); }
    bool thumbnailFetched() const { return _thumbnailFetched; }
    void setThumbnailFetched(bool value) { _thumbnailFetched = value; }
    bool renameable() const { return _renameable; }
    void setRenameable(bool value) { _renameable = value; }
    /// Answers whether the item is a reference to a document elsewhere.
    bool isBookmark() const { return _isBookmark; }
    void setIsBookmark(bool value) { _isBookmark = value; }
    const std::vector<std::string>& tags() const { return _tags; }
    void setTags(std::vector<std::string> tags) { _tags = std::move(tags); }
    /// The location of the promise. It is the very same object as resolvedURL() when there is no promise.
    const std::optional<Url>& promiseURL() const { return _promiseURL; }
    void setPromiseURL(std::optional<Url> url) { _promiseURL = std::move(url); }
    bool isDownloaded() const { return _isDownloaded; }
    void setIsDownloaded(bool value) { _isDownloaded = value; }

    /// Compares the identity of promiseURL() and resolvedURL(), not their paths.
    bool isPromise() const;
    /// The target of a symbolic link, as text, when only the plain file system could read the link.
    const std::string& symlinkTarget() const { return _symlinkTarget; }
    bool isPackage() const { return _isPackage; }
    /// Keeps the value of the last successful reading when a later one fails.
    bool canPreview() const { return _canPreview; }
    /// Answers whether the item is a symbolic link or an alias.
    bool isSymlink() const { return _isSymlink; }

    /// Clears the record and reads it again. Answers false when the item could not be read. When the read
    /// could not be coordinated, the record stays cleared and the answer is true.
    bool cacheValues();
    void clearValues();
    /// Reads the item from the plain file system, without coordination.
    bool initFromAttributes();
    /// Fills the record from attributes that were read at a location.
    void initFromKeysAndValuesWithURL(const AttributeMap& values, const Url& url);
    /// Answers the target of an alias file. It never asks the user and never mounts anything.
    std::optional<Url> resolvePathwellAlias(const Url& url);

    /// Answers a date in the user's language with the short time, or nothing without a date.
    static std::optional<std::string> friendlyDateStyle(const std::optional<Date>& date, DateStyle style);
    std::optional<std::string> friendlyCreationDate(DateStyle style) const;
    std::optional<std::string> friendlyContentModificationDate(DateStyle style) const;
    /// Answers the sum of the bytes of everything below a folder. Items that are not downloaded count with
    /// their promised size.
    static std::uint64_t sizeOfPackage(const std::optional<Url>& url);
    /// Answers the record in one line, for logs.
    std::string description() const;

    /// Takes the 1024-pixel thumbnail of a thumbnail map; anything else changes nothing.
    void updateThumbnailImage(const std::optional<AttributeValue>& thumbnailMap);
    bool canGenerateThumbnail() const { return false; }
    /// Calls back at once on this thread, without an image.
    void generateThumbnail(const std::function<void(std::optional<Image>)>& completion) const;
    /// Answers the process's queue for fetching thumbnails, at background quality. It is made on first use.
    static const std::shared_ptr<platform::OperationQueue>& getThumbnailQueue();

private:
    struct ThumbnailFetch;
    void fetchThumbnail();
    void thumbnailsWereRead(
        const std::weak_ptr<ThumbnailFetch>& fetch, const std::optional<AttributeValue>& thumbnailMap);
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
    std::shared_ptr<ThumbnailFetch> _thumbnailFetch; // while it is under way
    std::vector<std::string> _tags;
    bool _isContainer = false, _isDirectory = false, _isPackage = false, _thumbnailFetched = false;
    bool _isBookmark = false, _isDownloaded = false, _isSymlink = false, _canPreview = false;
    bool _hasHiddenExtension = true, _renameable = true;
};

} // namespace tarrow
