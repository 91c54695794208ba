// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/FileUtils.h"

#include <vector>

namespace tarrow {

/// Says where the content of a document is.
enum class ContentPlace {
    Here, ///< on this device
    Cloud, ///< only promised
};

/// Documents that were looked for, and why some could not be.
struct FoundDocuments {
    std::vector<Url> documents; ///< logical locations, each once
    std::vector<Error> errors; ///< of folders that could not be read; each has a sentence for the user
};

/// Finds the documents whose content is in a place: the given items themselves, and those in the folders
/// among them and in the folders below. A package is one document that is here or in the cloud as a whole;
/// what it holds may be in the cloud, but does not count as here, because the package would not open without
/// it. Hidden items, links and references are left out. It ends
/// early, with what was found until then, when it is not wanted any more. Any thread but the main thread,
/// because it reads folders.
FoundDocuments findDocuments(
    const std::vector<Url>& items, ContentPlace place, const FileUtils::StillWanted& stillWanted);

} // namespace tarrow
