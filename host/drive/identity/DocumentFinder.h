// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/identity/DocumentIndex.h"
#include "host/drive/records/DriveLayout.h"

namespace host::drive {

/// Looks through the drive for what carries document identifiers. Nothing is opened for long and no link
/// followed; where two items carry one identifier (a copy with its attributes), the older one counts.
class DocumentFinder {
public:
    /// How many names one search looks at.
    enum class Effort : std::size_t {
        Unnoticed = 10'000, ///< some ten milliseconds: for the main thread
        Whole = 100'000'000,
    };

    explicit DocumentFinder(DriveLayout layout)
        : _layout(std::move(layout))
    {
    }

    /// Where the item lies that carries an identifier. The one at the known inode counts before others; then
    /// the search ends at once. `isExhaustive`: whether everything was looked at, as far as it can be read.
    struct Finding {
        std::optional<DocumentPlace> place;
        bool isExhaustive = true;
    };
    Finding findInFolderOf(const IdentifiedPlace& known, Effort effort) const;
    Finding findInDrive(const IdentifiedPlace& known, Effort effort) const;

    /// Everything with an identifier.
    std::vector<IdentifiedPlace> findAll() const;

private:
    enum class Depth : std::uint8_t { Folder, Everything };
    Finding find(const std::string& folder, Depth depth, const IdentifiedPlace& known, Effort effort) const;

    DriveLayout _layout;
};

} // namespace host::drive
