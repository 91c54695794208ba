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

/// Where a document was last seen.
struct DocumentPlace {
    std::string path; ///< the item's, below the drive's home
    std::uint64_t device = 0, inode = 0; ///< of the item or of its promise; 0: not known
    bool operator==(const DocumentPlace&) const = default;
};

struct IdentifiedPlace {
    std::uint32_t identifier = 0;
    DocumentPlace place;
    bool operator==(const IdentifiedPlace&) const = default;
};

/// Where documents with an identifier were last seen. It is a hint only: who asks must look whether the
/// document still carries the identifier. What cannot be written is left out; a damaged index is begun anew
/// by the next change. Any thread; several processes use it at once.
class DocumentIndex {
public:
    using State = IndexDatabase::State;

    /// Nothing is opened before it is needed.
    explicit DocumentIndex(std::string path)
        : _database(std::move(path))
    {
    }

    struct Answer {
        enum class Kind : std::uint8_t {
            Known,
            Unknown, ///< it is not in the index
            Removed, ///< the document was removed; its identifier is never given again
            Unreadable, ///< the index cannot be asked
        };
        Kind kind = Kind::Unreadable;
        DocumentPlace place; ///< of a known one
    };
    /// Waits for nobody unless it is for writing.
    Answer lookUp(std::uint32_t identifier, IndexDatabase::Use use = IndexDatabase::Use::Reading) const;
    /// All documents at a path and below it.
    std::vector<IdentifiedPlace> documentsWithin(const std::string& path) const;
    State state() const;
    /// The same, but with patience, and of an index that was made where there was none to use.
    State prepareForWriting();

    /// Notes where a document is, making the index when there is none; whether it was noted. One that was
    /// removed stays so.
    bool note(std::uint32_t identifier, const DocumentPlace& place);
    /// An identifier that the index does not know, noted for a place; nothing when it cannot be written.
    std::optional<std::uint32_t> reserve(const DocumentPlace& place);
    /// Gives a reserved identifier back.
    void release(std::uint32_t identifier);
    /// An item and everything below it lies elsewhere now.
    void noteMove(const std::string& from, const std::string& to);
    void noteRemoval(std::uint32_t identifier);
    /// Notes everything that the drive holds; from then on the index is complete. Whether it could be
    /// written.
    bool complete(const std::vector<IdentifiedPlace>& all);

private:
    bool write(std::uint32_t identifier, const DocumentPlace& place);
    bool isReadyFor(IndexDatabase::Use use) const;

    mutable std::mutex _mutex;
    mutable IndexDatabase _database;
};

} // namespace host::drive
