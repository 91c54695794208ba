// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/DriveLayout.h"
#include "platform/Error.h"

namespace host::drive::sample {

/// The outcome of making a sample drive.
struct Outcome {
    int written = 0; ///< the number of items that did not exist before
    std::optional<platform::Error> error; ///< the reason why it ended early
};

/// Fills a drive with a household's documents and signs its owner in: every kind of document that the preview
/// shows, app libraries, promises, links, references, shared items, tags, names in several scripts. Existing
/// items stay as they are, so it can be run again.
Outcome makeSampleDrive(const DriveLayout& wanted);

/// The folder of the sample with a thousand items, and their number.
inline constexpr const char* largeFolder = "BrindleDefault/Documents/Household/Receipts";
inline constexpr int largeFolderCount = 1000;
/// The folder that may not be read.
inline constexpr const char* lockedFolder = "BrindleDefault/Documents/Locked drawer";

} // namespace host::drive::sample
