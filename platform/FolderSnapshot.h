// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"
#include "platform/Url.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace platform {

enum class FolderEntryKind : std::uint8_t { Document, Package, Folder, Library, Link };

/// One item of a folder as its list needs it: what is known without touching the item itself.
struct FolderEntry {
    std::string_view
        name; ///< the logical name, as the bytes that the file system has; lives as long as the snapshot
    FolderEntryKind kind;
    bool isPromise; ///< only a promise of the item is here
};

enum class ListingStage : std::uint8_t {
    FirstRows, ///< the first rows in their final order; more follow
    Complete,
    Failed, ///< the folder could not be read, or not to its end; error() says why
};

class FolderSnapshot;

/// The exact way from one snapshot of a folder to another that was made of it. All indexes rise.
struct FolderRevision {
    std::weak_ptr<const FolderSnapshot> before;
    std::vector<std::uint32_t> removed; ///< in the snapshot before
    std::vector<std::uint32_t> inserted; ///< in the new one; a name may be both, when its place changed
    std::vector<std::uint32_t>
        touched; ///< in the new one: kept their places, but may be or hold another thing
};

/// The items of one folder at one moment, sorted, packed (about 12 bytes and the name for each item).
/// Immutable; any thread.
class FolderSnapshot {
public:
    /// An item that lies elsewhere but shows in the folder: an app library at the top of the drive.
    struct ExtraItem {
        Url url;
        std::string name;
        FolderEntryKind kind = FolderEntryKind::Library;
        std::string iconName;
        bool operator==(const ExtraItem&) const = default;
    };

    class Builder;

    const Url& folder() const { return _folder; }
    ListingStage stage() const { return _stage; }
    const std::optional<Error>& error() const { return _error; }

    std::size_t count() const { return _records.size(); }
    FolderEntry entry(std::size_t index) const;
    FolderEntryKind kind(std::size_t index) const { return _records[index].kind; }
    /// The item's logical location.
    Url url(std::size_t index) const;
    /// The extra item behind an entry; null for an item of the folder itself.
    const ExtraItem* extraItem(std::size_t index) const;

    /// How it came from the snapshot before it; nothing when the folder was read whole.
    const std::optional<FolderRevision>& revision() const { return _revision; }
    /// Whether most of the bytes that it keeps are names of items that have gone.
    bool isMostlyWaste() const;

private:
    struct Record {
        std::uint32_t nameOffset;
        std::uint16_t nameLength;
        FolderEntryKind kind;
        bool isPromise;
        std::int32_t extra; ///< index of the extra item, or -1
    };

    explicit FolderSnapshot(Url folder)
        : _folder(std::move(folder))
    {
    }

    std::string_view nameOf(const Record& record) const;

    Url _folder;
    ListingStage _stage = ListingStage::Complete;
    std::optional<Error> _error;
    std::optional<FolderRevision> _revision;
    std::shared_ptr<const std::string> _sharedNames; ///< of all snapshots that were made one of the other
    std::string _names; ///< what came since; offsets go on from the shared ones
    std::vector<Record> _records;
    std::vector<ExtraItem> _extras;
};

/// Packs entries, given in their final order, into a snapshot.
class FolderSnapshot::Builder {
public:
    explicit Builder(Url folder)
        : _snapshot(new FolderSnapshot(std::move(folder)))
    {
    }
    /// Begins a revision: the names of the snapshot before are shared with it rather than copied.
    explicit Builder(const FolderSnapshot& before);

    void reserve(std::size_t entries, std::size_t nameBytes);
    void append(std::string_view name, FolderEntryKind kind, bool isPromise);
    void append(ExtraItem item);
    /// Takes over entries of the snapshot that this is a revision of, all at once, or one that is another
    /// thing now.
    void keep(const FolderSnapshot& before, std::size_t first, std::size_t count);
    void keep(const FolderSnapshot& before, std::size_t index, FolderEntryKind kind, bool isPromise);
    std::size_t count() const { return _snapshot->count(); }

    /// Ends the building; the builder is empty afterwards.
    std::shared_ptr<const FolderSnapshot> finish(ListingStage stage, std::optional<Error> error = {});
    std::shared_ptr<const FolderSnapshot> finish(FolderRevision revision);

private:
    std::unique_ptr<FolderSnapshot> _snapshot;
};

} // namespace platform
