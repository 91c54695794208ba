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

/// The 32-bit numbers by which the drive's documents are found after they were renamed and moved. Finding a
/// document takes three steps (the volume, the file on it, what the open file says of itself), so that a
/// caller can say which of them failed. Errors are the system's, with the errno as their code. Any thread may
/// call.
class DocumentIdentifiers {
public:
    virtual ~DocumentIdentifiers() = default;

    /// Answers the number of the volume that holds the local folder of the default container. It is asked for
    /// when it is needed first and then kept. It is nothing while it cannot be told, as when nobody is signed
    /// in; a later call tries again.
    virtual std::optional<std::uint64_t> deviceIdentifier() = 0;

    /// The file that stands for a document at the moment.
    struct File {
        std::uint64_t number = 0; ///< the inode, by which the file system tells files apart
        std::string place; ///< where the file was seen; only open() can make anything of it
    };
    /// Looks a document up by its number. While the document is where it was seen last this costs one look
    /// into the index and one system call. Otherwise its folder and then the drive are searched for it. On
    /// the main thread that search ends after 10,000 names (some ten milliseconds) and goes on in the
    /// background, so that a later call finds the document; on any other thread it goes on to the end.
    /// Errors: ENOENT when no document was found, also for 0 and for a document that was removed.
    virtual Result<File> resolve(std::uint32_t identifier) = 0;

    /// A file that is held open while it is asked.
    class OpenFile {
    public:
        struct Attributes {
            std::uint32_t documentIdentifier =
                0; ///< the number that the file carries; 0 when it carries none
            Url url; ///< where the file is now; for a promise, the logical location of its item
        };
        virtual ~OpenFile() = default;
        /// Asks the open file, wherever it was moved meanwhile. Errors: ENOENT when it has been removed,
        /// EXDEV when it was moved out of the drive.
        virtual Result<Attributes> attributes() const = 0;
    };
    /// Opens the very file that was resolved, without following a link and without reading its content.
    /// Errors: ESTALE when another file is in its place by now, ENOENT when none is.
    virtual Result<std::shared_ptr<const OpenFile>> open(const File& file) = 0;

    /// Answers the document identifier of an item of the drive, here or promised. The item is given one when
    /// it has none, and a new one when it is a copy and carries the number of another item that is still
    /// there. This is the only call that gives numbers. It waits for the disk and may search the drive, so it
    /// is not for the main thread. Errors: EXDEV for what lies outside the drive, FileErrorCode::NoSuchItem,
    /// FileErrorCode::Unsupported for what is no file or folder, else why the number could not be kept.
    virtual Result<std::uint32_t> identify(const Url& url) = 0;
};

} // namespace platform
