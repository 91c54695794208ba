// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/identity/DocumentIndex.h"
#include "host/drive/records/DriveLayout.h"

namespace host::drive {

/// Searches the drive for items that carry document identifiers. It keeps no file open for long and follows
/// no link. When two items carry one identifier (a copy with its attributes), the older one counts.
class DocumentFinder {
public:
    /// Limits the number of names that one search reads.
    enum class Effort : std::size_t {
        Unnoticed = 10'000, ///< takes some ten milliseconds, for the main thread
        Whole = 100'000'000,
    };

    explicit DocumentFinder(DriveLayout layout)
        : _layout(std::move(layout))
    {
    }

    /// Finds the item that carries an identifier. The item at the known inode counts before others, and the
    /// search then ends at once. `isExhaustive` says whether everything was read, as far as it can be read.
    struct Finding {
        std::optional<DocumentPlace> place;
        bool isExhaustive = true;
    };
    Finding findInFolderOf(const IdentifiedPlace& known, Effort effort) const;
    Finding findInDrive(const IdentifiedPlace& known, Effort effort) const;

    /// Answers whether any item of the drive, in its trash, in the cloud or in work carries an identifier, or
    /// nothing when that cannot be told, because something could not be read or was moved meanwhile.
    std::optional<bool> isCarried(std::uint32_t identifier) const;

    /// Answers every item with an identifier.
    std::vector<IdentifiedPlace> findAll() const;

private:
    enum class Depth : std::uint8_t { Folder, Everything };
    Finding find(const std::string& folder, Depth depth, const IdentifiedPlace& known, Effort effort) const;

    DriveLayout _layout;
};

} // namespace host::drive
