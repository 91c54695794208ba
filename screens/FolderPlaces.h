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

/// Answers the documents folder of the default container, which is the drive's top level, or nothing when
/// there is none.
std::optional<Url> rootFolder();

/// Answers whether this is that folder. It looks at the disk only for the top folder of a container.
bool isRootFolder(const Url& folder);

/// Answers the title of a folder's list. A container's documents folder has the container's name.
std::string folderTitle(const Url& folder);

/// Answers the place of an item in words: the titles of the folders that lead to it. The drive's top level is
/// left out, except for items that lie directly in it.
std::string placeText(const Url& item);

/// Answers the folders that a search looks through, which are the documents folders of all containers.
std::vector<Url> searchableFolders();

/// Answers the items that a folder's list shows beside the folder's own ones. At the drive's top level these
/// are the app libraries.
std::vector<FolderSnapshot::ExtraItem> extraItemsOf(const Url& folder);

/// Answers the folders from the drive's top level down to a folder, that folder included. On the way through
/// a library, its documents folder comes second. Answers nothing when the folder lies neither in the default
/// container nor in a library.
std::vector<Url> foldersDownTo(const Url& folder);

/// A folder and the title of its list.
struct TitledFolder {
    Url folder;
    std::string title;
};
/// Answers these folders with their titles.
std::vector<TitledFolder> titledFoldersDownTo(const Url& folder);

/// Answers the folders for a known top level and a known documents folder of the folder's container, without
/// a look at the disk.
std::vector<Url> foldersBetween(const Url& root, const Url& documents, const Url& folder);

} // namespace screens
