// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/PlatformNames.h"

#include <cstddef>
#include <vector>

namespace screens {
class DocumentListController;
}

namespace tarrow {

/// Which changes the browser offers for a list's selection and folder. The rules keep the structure of the
/// drive: the top folders of containers and the two special folders stay where they are, and a container's
/// declared depth of folders is kept. Where the container cannot be found nothing is offered. Main thread.
class MenuEnableChecks {
public:
    using List = screens::DocumentListController;

    MenuEnableChecks() = delete;

    /// Something is selected that may be moved. In a container that limits its folders only files may.
    static bool canShowMoveForSelectedItems(const List& list);
    /// Something is selected that may be deleted: ordinary items only, or containers only.
    static bool canShowDeleteForSelectedItems(const List& list);
    /// Whether the list's folder may have a new folder; the selection does not matter.
    static bool canEnableNewFolderForSelectedItems(const List& list);
    /// Whether the container of the list's folder takes folders within folders.
    static bool containerSupportsAnyDepth(const List& list);

    /// Whether the container that holds an item has a folder (packages and hidden ones aside) to move
    /// something into; true when that container cannot be found. Reads the top of the container's documents.
    static bool containerHasSubfolders(const Url& url);

    /// How many of these are top folders of containers.
    static std::size_t numContainersInURLArray(const std::vector<Url>& urls);
    /// 1 when one of these is a folder and no package, else 0. Reads the items up to the first folder.
    static std::size_t numFoldersInURLArray(const std::vector<Url>& urls);
    /// Whether one of these is a special folder, see trw_isDesktopOrDocumentsFolder().
    static bool isDesktopOrDocumentsInURLArray(const std::vector<Url>& urls);
};

} // namespace tarrow
