// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/FolderSnapshot.h"
#include "platform/Url.h"
#include "screens/PlatformNames.h"

#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace screens {

/// Answers the questions of FolderPlaces from memory, as they were answered at one moment. A screen that is
/// about to appear is given one, so that it need not look at the disk. Immutable; any thread.
class DrivePlaces {
public:
    /// Looks at the disk: for the containers, and for the titles of these folders and of the ones that lead
    /// to them.
    static std::shared_ptr<const DrivePlaces> lookUp(const std::vector<Url>& folders);

    const std::optional<Url>& rootFolder() const { return _root; }
    std::vector<Url> foldersDownTo(const Url& folder) const;
    const std::vector<FolderSnapshot::ExtraItem>& extraItemsOf(const Url& folder) const;
    /// Answers nothing for a folder whose title was not looked up.
    std::optional<std::string> folderTitle(const Url& folder) const;

private:
    std::optional<Url> _root;
    std::map<std::string, Url> _documentsOfContainers; ///< by the containers' identifiers
    std::map<std::string, std::string> _titles; ///< by the folders' paths
    std::vector<FolderSnapshot::ExtraItem> _libraries;
};

} // namespace screens
