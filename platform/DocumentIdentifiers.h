// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"
#include "platform/Url.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <string>

namespace platform {

/// The 32-bit numbers by which the drive's documents are found after they were renamed and moved. Finding one
/// takes three steps, so that a caller can say which of them failed. The errors are the system's. Any thread.
class DocumentIdentifiers {
public:
    virtual ~DocumentIdentifiers() = default;

    /// The number of the volume that holds the local folder of the default container: determined on first
    /// need and kept. Nothing while it cannot be told (signed out); a later call tries again.
    virtual std::optional<std::uint64_t> deviceIdentifier() = 0;

    /// The file that stands for a document at the moment.
    struct File {
        std::uint64_t number = 0; ///< the file system's own
        std::string place; ///< where it was seen, in the service's terms
    };
    /// Looks a document up. Costs one look into the index while the document is where it was last seen. Where
    /// it is not, its folder and then the drive are searched, on the main thread only so far that nobody
    /// notices; the search is then ended in the background, and a later call finds the document.
    virtual Result<File> resolve(std::uint32_t identifier) = 0;

    /// A file that is held open while it is asked.
    class OpenFile {
    public:
        struct Attributes {
            std::uint32_t documentIdentifier = 0; ///< 0: it carries none
            Url url; ///< where the file is now; for a promise, where its item shows
        };
        virtual ~OpenFile() = default;
        virtual Result<Attributes> attributes() const = 0;
    };
    /// Opens the very file that was resolved (ESTALE when another is in its place); no link is followed.
    virtual Result<std::shared_ptr<const OpenFile>> open(const File& file) = 0;

    /// The document identifier of an item of the drive, here or promised, which gets one when it has none and
    /// a new one when it carries that of another item that is still there (a copy). It waits for the disk and
    /// may search the drive: not for the main thread. Errors: EXDEV for what lies elsewhere,
    /// FileErrorCode::Unsupported for what is no file or folder, else why no identifier could be kept.
    virtual Result<std::uint32_t> identify(const Url& url) = 0;
};

} // namespace platform
