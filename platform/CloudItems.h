// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"
#include "platform/ItemDownload.h"
#include "platform/Url.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace platform {

/// The code in errorDomain::cloud for an item that no bookmark string can name. It is an ordinary answer, no
/// fault, so it is not logged as one.
inline constexpr int notBookmarkableCode = 7;

/// Where items of the drive lie, how their contents come and go, and the texts that name them on other
/// devices.
class CloudItems {
public:
    virtual ~CloudItems() = default;

    /// Whether a URL lies in the documents area, the folder of all containers. The names are compared after
    /// the links in the folders that lead to the item were resolved; a link as the last name counts as
    /// itself. The item need not be there. Any thread may ask; the call costs a few system calls.
    virtual bool isInDocumentsArea(const Url& url) const = 0;
    /// Whether a URL lies in the drive's trash, in the same way.
    virtual bool isInTrash(const Url& url) const = 0;

    /// Answers the location with every symbolic link in its path resolved, the last name's too, as far as the
    /// path exists. It is the very same object when there is nothing to resolve, and when there are too many
    /// links. Any thread.
    virtual Url realURL(const Url& url) const = 0;
    /// Answers the URL of an absolute path that comes from outside or out of a symbolic link. Behind a link
    /// ".." leads to the folder above the link's target, as the system reads it, so the links before a
    /// ".." are resolved; a path without ".." keeps all of them. It answers nothing when a ".." follows what
    /// is no folder. Any thread; the disk is asked only for a path with "..".
    virtual std::optional<Url> urlOfPath(const std::string& path) const = 0;

    /// Makes the bookmark string that names a document on the account's other devices; it stays valid when
    /// the document is moved or renamed, because it holds the document's identifier beside its place. The
    /// completion is called once, on any thread. Its error has notBookmarkableCode for what no other device
    /// could open: an item that lies outside the drive's documents or is not there, and every item while
    /// nobody is signed in.
    virtual void RZBookmarkableStringFromDocumentURL(
        const Url& url, std::function<void(Result<std::string>)> completion) const = 0;

    /// Downloads the content of a promised document in the background and puts the document in the promise's
    /// place. The handlers are called on the main queue. A document that is here already is no error: its
    /// completion is called with nothing. All who ask for the same document meanwhile share one download,
    /// which ends early when the last of them cancels. Any thread.
    virtual std::unique_ptr<ItemDownload> startDownload(const Url& url, DownloadHandlers handlers) = 0;
    /// Does the same without a handle: the download goes on until it ends or `cancelDownload` ends it. The
    /// completion may be empty; it is called once, on the main queue.
    virtual void download(const Url& url, std::function<void(const std::optional<Error>&)> completion) = 0;
    /// Answers how much of a document has arrived, whoever downloads it; nothing while nobody does.
    /// Notification::DownloadsDidChange is posted whenever the answer changes. Any thread; the disk is not
    /// asked.
    virtual std::optional<DownloadProgress> downloadProgress(const Url& url) const = 0;
    /// Ends a document's download for all who wait for it: their completions hear FileErrorCode::Cancelled.
    /// Nothing happens when nobody downloads it. Any thread.
    virtual void cancelDownload(const Url& url) = 0;

    /// Finds the document that a bookmark string from another device names: by its identifier wherever it was
    /// moved, else at the place that the bookmark gives. The completion is called once, on any thread, with
    /// the document's URL, or with an error of the cloud domain when the text is damaged or longer than 4,096
    /// bytes, belongs to another account, or when the document is not in the drive any more.
    virtual void decodeBookmark(
        const std::string& bookmark, std::function<void(Result<Url>)> completion) const = 0;
};

} // namespace platform
