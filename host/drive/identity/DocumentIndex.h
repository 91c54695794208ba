// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/identity/IndexDatabase.h"

#include <cstdint>
#include <mutex>
#include <optional>
#include <string>
#include <vector>

namespace host::drive {

/// The place where a document was last seen.
struct DocumentPlace {
    std::string path; ///< the item's path below the drive's home
    std::uint64_t device = 0, inode = 0; ///< of the item or of its promise; 0: not known
    bool operator==(const DocumentPlace&) const = default;
};

struct IdentifiedPlace {
    std::uint32_t identifier = 0;
    DocumentPlace place;
    bool operator==(const IdentifiedPlace&) const = default;
};

/// The places where documents with an identifier were last seen. A place is only a hint, so the caller must
/// check whether the document still carries the identifier. A change that cannot be written is dropped. A
/// damaged index is begun anew by the next change. Any thread; several processes use the index at once.
class DocumentIndex {
public:
    using State = IndexDatabase::State;

    /// The file is opened at the first use.
    explicit DocumentIndex(std::string path)
        : _database(std::move(path))
    {
    }

    struct Answer {
        enum class Kind : std::uint8_t {
            Known,
            Unknown, ///< it is not in the index
            Removed, ///< the document was removed, and its identifier is never given again
            Unreadable, ///< the index cannot be read
        };
        Kind kind = Kind::Unreadable;
        DocumentPlace place; ///< set for a known document
    };
    /// Looks up an identifier. It does not wait for other processes unless it is for writing.
    Answer lookUp(std::uint32_t identifier, IndexDatabase::Use use = IndexDatabase::Use::Reading) const;
    /// Answers all documents at a path and below it.
    std::vector<IdentifiedPlace> documentsWithin(const std::string& path) const;
    State state() const;
    /// Answers the state like state(), but waits for other processes and creates the index when there is no
    /// usable one.
    State prepareForWriting();

    /// Answers why the index could not be used or written last, as an error of the drive's own files.
    system::SystemError failure() const;

    /// Notes the place of a document, and creates the index when there is none. Answers whether it was noted.
    /// A removed document stays removed.
    bool note(std::uint32_t identifier, const DocumentPlace& place);
    /// Reserves an identifier that the index does not know, for a place. Answers nothing when the index
    /// cannot be written.
    std::optional<std::uint32_t> reserve(const DocumentPlace& place);
    /// Gives a reserved identifier back.
    void release(std::uint32_t identifier);
    /// Notes that an item and everything below it were moved.
    void noteMove(const std::string& from, const std::string& to);
    void noteRemoval(std::uint32_t identifier);
    /// Notes all documents of the drive, after which the index is complete. Answers whether it could be
    /// written.
    bool complete(const std::vector<IdentifiedPlace>& all);

private:
    bool write(std::uint32_t identifier, const DocumentPlace& place);
    bool isReadyFor(IndexDatabase::Use use) const;

    mutable std::mutex _mutex;
    mutable IndexDatabase _database;
};

} // namespace host::drive
