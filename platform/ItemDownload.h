// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"

#include <cstdint>
#include <functional>
#include <optional>

namespace platform {

/// How much of a content has arrived, in bytes.
struct DownloadProgress {
    std::uint64_t done = 0;
    std::optional<std::uint64_t> total; ///< nothing while the size is not known
    bool operator==(const DownloadProgress&) const = default;
};

/// What the one who asked for a download hears, on the main queue.
struct DownloadHandlers {
    /// At most a few times a second's worth of bytes: once for each MiB that arrived. May be empty.
    std::function<void(const DownloadProgress&)> progress;
    /// Once, as the last call: nothing when the document lies at its logical location, else why it does not.
    /// A download that failed leaves the promise as it was, and can be started again. Errors:
    /// FileErrorCode::NoSuchItem, FileErrorCode::Unsupported for what is no document, else the system's or
    /// the cloud's.
    std::function<void(const std::optional<Error>&)> completion;
};

/// A download that was started. It is cancelled when this is destroyed.
class ItemDownload {
public:
    virtual ~ItemDownload() = default;
    /// Ends the download early and leaves the promise as it was, unless the whole content had arrived
    /// already. Called on the main thread, no handler is called after this.
    virtual void cancel() = 0;
};

} // namespace platform
