// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"
#include "platform/ItemDownload.h"
#include "platform/Url.h"

#include <functional>
#include <memory>
#include <string>

namespace platform {

/// The code in errorDomain::cloud for what no bookmark string can name. It is an ordinary answer, no fault.
inline constexpr int notBookmarkableCode = 7;

/// Where items of the drive lie, and the texts that name them on other devices.
class CloudItems {
public:
    virtual ~CloudItems() = default;

    /// Whether a URL lies in the documents area (compared name by name, after resolving links in the folders
    /// that lead to it). Any thread.
    virtual bool isInDocumentsArea(const Url& url) const = 0;
    /// Whether a URL lies in the drive's trash. Any thread.
    virtual bool isInTrash(const Url& url) const = 0;

    /// The path with every symbolic link in it resolved as far as it exists. Any thread.
    virtual Url realURL(const Url& url) const = 0;

    /// Removes the downloaded copy of a document and keeps it in the cloud; one that is only promised is no
    /// error. Errors: FileErrorCode::NoSuchItem, FileErrorCode::Unsupported for what is no document,
    /// FileErrorCode::Cancelled for one that changes meanwhile, else the system's. Any thread.
    virtual std::optional<Error> evictItem(const Url& url) = 0;

    /// Makes the bookmark string that names a document on the account's other devices; it outlives moves and
    /// new names of the document. The completion is called once, on any thread; with notBookmarkableCode for
    /// what no other device could open (it lies outside the drive's documents, or is not there).
    virtual void RZBookmarkableStringFromDocumentURL(
        const Url& url, std::function<void(Result<std::string>)> completion) const = 0;

    /// Brings the content of a promised document here, in the background, and puts the document in the
    /// promise's place. One that is here already is no error, and its handlers are called, too. Any thread.
    /// Who asks for the same document meanwhile waits for the same download.
    virtual std::unique_ptr<ItemDownload> startDownload(const Url& url, DownloadHandlers handlers) = 0;
    /// The same without a handle: it goes on until it ends or is cancelled by `cancelDownload`, and the
    /// completion is called once, on the main queue.
    virtual void download(const Url& url, std::function<void(const std::optional<Error>&)> completion) = 0;
    /// How much of a document has arrived that anybody downloads; nothing while nobody does.
    /// Notification::DownloadsDidChange says when to ask again. Any thread.
    virtual std::optional<DownloadProgress> downloadProgress(const Url& url) const = 0;
    /// Ends a document's download for all who wait for it: they hear FileErrorCode::Cancelled. Any thread.
    virtual void cancelDownload(const Url& url) = 0;

    /// Finds the document that a bookmark string from another device names. The completion is called once, on
    /// any thread, with the URL or the error (damaged, too large, unknown account or document).
    virtual void decodeBookmark(
        const std::string& bookmark, std::function<void(Result<Url>)> completion) const = 0;
};

} // namespace platform
