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

/// What a folder's list shows an item as. It is judged by the name and by the file system's type alone.
enum class FolderEntryKind : std::uint8_t {
    Document,
    Package, ///< a folder that is shown as one document
    Folder,
    Library, ///< an app library, which lies elsewhere
    Link, ///< a symbolic link, which is not followed
};

/// Whether an item of the kind shows what it holds when it is opened: a folder or a library.
constexpr bool opensAsFolder(FolderEntryKind kind)
{
    return kind == FolderEntryKind::Folder || kind == FolderEntryKind::Library;
}

/// One item of a folder as its list needs it: what is known without touching the item itself.
struct FolderEntry {
    /// The logical name, as the bytes that the file system has, valid UTF-8 or not. It lives as long as the
    /// snapshot.
    std::string_view name;
    FolderEntryKind kind;
    bool isPromise; ///< only a promise of the item is here
};

/// How far the reading of a folder was when its snapshot was made.
enum class ListingStage : std::uint8_t {
    FirstRows, ///< the first rows in their final order; the complete list follows
    Complete, ///< all rows
    Failed, ///< the folder could not be read, or not to its end; error() says why
};

class FolderSnapshot;

/// The exact difference between a snapshot of a folder and the one that it was made from, so that a list can
/// be changed row by row. The indexes of each vector rise.
struct FolderRevision {
    /// The earlier snapshot. A list that shows another one cannot use the revision.
    std::weak_ptr<const FolderSnapshot> before;
    /// The entries that went, by their indexes in the earlier snapshot.
    std::vector<std::uint32_t> removed;
    /// The entries that came, by their indexes in the new snapshot. An entry whose place changed was removed
    /// and inserted.
    std::vector<std::uint32_t> inserted;
    /// The entries that kept their places but may be another item now or hold another content, by their
    /// indexes in the new snapshot.
    std::vector<std::uint32_t> touched;
};

/// The items of one folder at one moment, sorted, and packed: each takes about 12 bytes and its name. A
/// snapshot is immutable, so any thread may use it.
class FolderSnapshot {
public:
    /// An item that lies elsewhere but shows in the folder, such as an app library at the drive's top level.
    struct ExtraItem {
        Url url; ///< where the item lies
        std::string name; ///< the name that it shows and is sorted by
        FolderEntryKind kind = FolderEntryKind::Library;
        std::string iconName; ///< in the icon theme; empty for the kind's own icon
        bool operator==(const ExtraItem&) const = default;
    };

    class Builder;

    const Url& folder() const { return _folder; }
    ListingStage stage() const { return _stage; }
    /// Why the folder could not be read; nothing unless the stage is Failed.
    const std::optional<Error>& error() const { return _error; }

    /// The number of entries. All indexes below are less than it, which is not checked.
    std::size_t count() const { return _records.size(); }
    FolderEntry entry(std::size_t index) const;
    FolderEntryKind kind(std::size_t index) const { return _records[index].kind; }
    /// The entry's logical location, made anew by every call.
    Url url(std::size_t index) const;
    /// The extra item behind an entry; null for an item of the folder itself. It lives as long as the
    /// snapshot.
    const ExtraItem* extraItem(std::size_t index) const;

    /// How this snapshot differs from the one before; nothing when the folder was read whole.
    const std::optional<FolderRevision>& revision() const { return _revision; }
    /// Whether most of the bytes that the snapshot keeps are names of items that have gone, so that reading
    /// the folder whole would save memory. It looks at every entry.
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

/// Packs entries, which are given in their final order, into a snapshot. One thread uses it, once.
class FolderSnapshot::Builder {
public:
    explicit Builder(Url folder)
        : _snapshot(new FolderSnapshot(std::move(folder)))
    {
    }
    /// Begins a revision of an earlier snapshot: their names are shared rather than copied, as far as that
    /// goes.
    explicit Builder(const FolderSnapshot& before);

    /// Takes the memory for so many entries and bytes of names at once.
    void reserve(std::size_t entries, std::size_t nameBytes);
    /// Adds an entry at the end; the name, of at most 65,535 bytes, is copied. A snapshot holds 4 GiB of
    /// names.
    void append(std::string_view name, FolderEntryKind kind, bool isPromise);
    void append(ExtraItem item);
    /// Adds entries of the earlier snapshot as they are: `count` of them, or one that is of another kind now.
    /// Only a builder that revises that snapshot may do so.
    void keep(const FolderSnapshot& before, std::size_t first, std::size_t count);
    void keep(const FolderSnapshot& before, std::size_t index, FolderEntryKind kind, bool isPromise);
    std::size_t count() const { return _snapshot->count(); }

    /// Ends the building and answers the snapshot; the builder must not be used after that. The second one
    /// makes a complete list that is a revision.
    std::shared_ptr<const FolderSnapshot> finish(ListingStage stage, std::optional<Error> error = {});
    std::shared_ptr<const FolderSnapshot> finish(FolderRevision revision);

private:
    std::unique_ptr<FolderSnapshot> _snapshot;
};

} // namespace platform
