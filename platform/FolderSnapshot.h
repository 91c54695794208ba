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
    /// The item's logical location.
    Url url(std::size_t index) const;
    /// The extra item behind an entry; null for an item of the folder itself.
    const ExtraItem* extraItem(std::size_t index) const;

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

    Url _folder;
    ListingStage _stage = ListingStage::Complete;
    std::optional<Error> _error;
    std::string _names;
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
    void reserve(std::size_t entries, std::size_t nameBytes);
    void append(std::string_view name, FolderEntryKind kind, bool isPromise);
    void append(ExtraItem item);
    /// Ends the building; the builder is empty afterwards.
    std::shared_ptr<const FolderSnapshot> finish(ListingStage stage, std::optional<Error> error = {});

private:
    std::unique_ptr<FolderSnapshot> _snapshot;
};

} // namespace platform
