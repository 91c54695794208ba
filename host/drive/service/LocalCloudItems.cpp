// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/service/LocalCloudItems.h"

#include "host/drive/identity/Bookmark.h"
#include "host/drive/identity/BookmarkMaking.h"
#include "host/drive/records/AccountRecord.h"
#include "host/drive/records/BeneathRoot.h"
#include "host/drive/records/ItemFacts.h"
#include "host/drive/records/LinkRecords.h"
#include "host/drive/records/RealPath.h"
#include "host/drive/records/SmallFile.h"

#include <fcntl.h>

namespace host::drive {

namespace {

using platform::Error;
using platform::Result;
using platform::Url;

bool isWithin(const Url& url, const std::string& folder)
{
    const auto real = url.isFileURL() ? realPathOfEntry(url.path()) : std::nullopt;
    return real && Url::fileURL(*real).isWithin(Url::fileURL(folder));
}

bool leadsUpwards(std::string_view path)
{
    return path.ends_with("/..") || path.find("/../") != std::string_view::npos;
}

Error unusableBookmark(const char* sentence)
{
    return cloudError(CloudErrorCode::UnusableBookmark, {}, sentence);
}

// Answers the document that a bookmark names by its place, unless another document has taken that place.
std::optional<Url> documentAtPlace(const DriveLayout& layout, const Bookmark& bookmark)
{
    const auto path = layout.containerDocuments(bookmark.container) + '/' + bookmark.path;
    const auto facts = lookAtItem(path);
    if (facts.presence == ItemFacts::Presence::Missing)
        return std::nullopt;
    const auto found = facts.presence == ItemFacts::Presence::Promised ? facts.promise.documentIdentifier
                                                                       : facts.marks.documentIdentifier;
    if (bookmark.documentIdentifier != 0 && found != 0 && found != bookmark.documentIdentifier)
        return std::nullopt;
    return Url::fileURL(path);
}

Result<Url> findBookmarked(
    const DriveLayout& layout, LocalDocumentIdentifiers& identifiers, const std::string& text)
{
    const auto bookmark = Bookmark::decode(text);
    if (!bookmark)
        return unusableBookmark("The link to the document is damaged.");
    const auto account = AccountRecord::read(layout);
    if (!account || account->identity != bookmark->account)
        return unusableBookmark("The link leads to a document of another account.");
    // The identifier stays with a document when it is moved, so it counts before the place.
    auto found = identifiers.find(bookmark->documentIdentifier);
    if (!found)
        found = documentAtPlace(layout, *bookmark);
    if (!found)
        return unusableBookmark("The document isn’t in the drive any more.");
    // A missing document and one outside the drive get the same sentence, so that nothing is told about files
    // outside.
    if (!isWithin(*found, layout.documents()))
        return unusableBookmark("The document isn’t in the drive any more.");
    return *found;
}

} // namespace

LocalCloudItems::LocalCloudItems(DriveLayout layout, std::shared_ptr<LocalDocumentIdentifiers> identifiers,
    std::shared_ptr<CloudStore> store, const DriveDependencies& dependencies)
    : _layout(std::move(layout))
    , _identifiers(std::move(identifiers))
    , _downloads(std::make_shared<RunningDownloads>(
          LocalDownload::Setting{_layout, std::move(store),
              dependencies.dispatch->makeOperationQueue(
                  "TarrowDriveAppID.downloads", platform::QualityOfService::UserInitiated),
              dependencies.dispatch->mainQueue(), dependencies.fileCoordinator},
          dependencies.notificationCenter))
    , _queue(dependencies.dispatch->makeSerialQueue("TarrowDriveAppID.bookmarks"))
{
}

bool LocalCloudItems::isInDocumentsArea(const Url& url) const
{
    return isWithin(url, _layout.documents());
}

bool LocalCloudItems::isInTrash(const Url& url) const
{
    return isWithin(url, _layout.trash());
}

Url LocalCloudItems::realURL(const Url& url) const
{
    const auto real = url.isFileURL() ? realPath(url.path()) : std::nullopt;
    return real && *real != url.path() ? Url::fileURL(*real) : url;
}

std::optional<Url> LocalCloudItems::urlOfPath(const std::string& path) const
{
    if (!leadsUpwards(path))
        return Url::fileURL(path);
    const auto real = realPathOfEntry(path);
    return real ? std::optional(Url::fileURL(*real)) : std::nullopt;
}

/// A downloaded document has another inode than its promise, so the index is told.
LocalCloudItems::Completion LocalCloudItems::identifying(const Url& url, Completion completion) const
{
    return [identifiers = _identifiers, path = url.path(), completion = std::move(completion)](
               const auto& error) {
        if (!error)
            identifiers->replaced(path);
        if (completion)
            completion(error);
    };
}

std::unique_ptr<platform::ItemDownload> LocalCloudItems::startDownload(
    const Url& url, platform::DownloadHandlers handlers)
{
    handlers.completion = identifying(url, std::move(handlers.completion));
    return _downloads->start(url.path(), std::move(handlers));
}

void LocalCloudItems::download(const Url& url, Completion completion)
{
    _downloads->startUnkept(url.path(), identifying(url, std::move(completion)));
}

std::optional<platform::DownloadProgress> LocalCloudItems::downloadProgress(const Url& url) const
{
    return _downloads->progress(url.path());
}

void LocalCloudItems::cancelDownload(const Url& url)
{
    _downloads->cancel(url.path());
}

void LocalCloudItems::RZBookmarkableStringFromDocumentURL(
    const Url& url, std::function<void(Result<std::string>)> completion) const
{
    _queue->async([layout = _layout, identifiers = _identifiers, url, completion = std::move(completion)] {
        completion(makeBookmark(layout, url, [&identifiers](const std::string& path) {
            return identifiers->identifyAt(path).value.value_or(0);
        }));
    });
}

void LocalCloudItems::decodeBookmark(
    const std::string& bookmark, std::function<void(Result<Url>)> completion) const
{
    _queue->async(
        [layout = _layout, identifiers = _identifiers, bookmark, completion = std::move(completion)] {
            completion(findBookmarked(layout, *identifiers, bookmark));
        });
}

} // namespace host::drive
