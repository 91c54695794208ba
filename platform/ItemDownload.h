// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"

#include <cstdint>
#include <functional>
#include <optional>

namespace platform {

/// How much of a document's content has arrived, in bytes.
struct DownloadProgress {
    std::uint64_t done = 0; ///< what has arrived
    std::optional<std::uint64_t> total; ///< the size of the whole content; nothing while it is not known
    bool operator==(const DownloadProgress&) const = default;
};

/// What the caller who asked for a download hears, on the main queue. Either handler may be empty.
struct DownloadHandlers {
    /// Called once for each MiB that arrived, and at the end.
    std::function<void(const DownloadProgress&)> progress;
    /// Called once, as the last call: with nothing when the document lies at its logical location now, else
    /// with the reason why it does not. A download that failed leaves the promise as it was and can be
    /// started again. Errors: FileErrorCode::NoSuchItem; FileErrorCode::ItemExists when another document took
    /// the name meanwhile; FileErrorCode::Unsupported for what is no document; FileErrorCode::Cancelled when
    /// somebody ended the download for all; else the system's or the cloud's.
    std::function<void(const std::optional<Error>&)> completion;
};

/// A download that was started. Destroying the object cancels the download for its caller.
class ItemDownload {
public:
    virtual ~ItemDownload() = default;
    /// Ends the caller's part in the download. The download itself ends early, and leaves the promise as it
    /// was, when nobody else waits for it and the whole content had not arrived yet. When this is called on
    /// the main thread no handler is called after it; on another thread one that runs at that moment may end
    /// later.
    virtual void cancel() = 0;
};

} // namespace platform
