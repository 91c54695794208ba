// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/FolderSnapshot.h"
#include "platform/Url.h"
#include "screens/PlatformNames.h"

#include <optional>
#include <string>
#include <vector>

namespace screens {

/// The documents folder of the default container, the drive's top level; nothing when there is none.
std::optional<Url> rootFolder();

/// What a folder's list is called: a container's documents folder after its container.
std::string folderTitle(const Url& folder);

/// Where an item lies, in words: the titles of the folders that lead to it, the drive's top level left out
/// but for items that lie right there.
std::string placeText(const Url& item);

/// The folders that a search looks through: the documents folders of all containers.
std::vector<Url> searchableFolders();

/// What a folder's list shows beside the folder's own items: at the drive's top level the app libraries.
std::vector<FolderSnapshot::ExtraItem> extraItemsOf(const Url& folder);

/// The folders from the drive's top level down to a folder, that one included; through a library its
/// documents folder comes second. Empty when the folder lies neither in the default container nor in a
/// library.
std::vector<Url> foldersDownTo(const Url& folder);

} // namespace screens
