// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/PlatformNames.h"

#include <cstddef>
#include <functional>
#include <memory>
#include <vector>

namespace screens {
class DocumentListController;
}

namespace tarrow {

/// Decides which changes the browser offers for a list's selection and folder. The rules keep the structure
/// of the drive: the top folders of containers and the two special folders stay in their places, and folders
/// stay within the depth that a container declares. When the container cannot be found, nothing is offered.
/// Main thread.
class MenuEnableChecks {
public:
    using List = screens::DocumentListController;

    MenuEnableChecks() = delete;

    /// Looks up on another thread what the first five questions need to know of a list's folder, keeps it
    /// with the list, and calls `done`. Without it they look at the disk themselves.
    static void lookUpPlaceOf(const std::shared_ptr<List>& list, std::function<void()> done);
    /// Answers whether that is known, so that the questions are answered from memory.
    static bool isPlaceKnown(const List& list);

    /// Answers whether the selection holds an item that may be moved. In a container that limits its folders,
    /// only files may be moved.
    static bool canShowMoveForSelectedItems(const List& list);
    /// Answers whether the selection may be deleted: it must hold ordinary items only, or containers only.
    static bool canShowDeleteForSelectedItems(const List& list);
    /// Answers whether a new folder may be made in the list's folder. The selection does not matter.
    static bool canEnableNewFolderForSelectedItems(const List& list);
    /// Answers whether files may be copied into the list's folder; folders may be when the container supports
    /// any depth.
    static bool canAddItems(const List& list);
    /// Answers whether the container of the list's folder allows folders within folders.
    static bool containerSupportsAnyDepth(const List& list);

    /// Answers whether the container that holds an item has a folder (packages and hidden ones aside) into
    /// which something could be moved. Answers true when that container cannot be found. It reads the top of
    /// the container's documents.
    static bool containerHasSubfolders(const Url& url);

    /// Answers how many of these are top folders of containers.
    static std::size_t numContainersInURLArray(const std::vector<Url>& urls);
    /// Answers 1 when one of these is a folder and not a package, else 0. It reads the items up to the first
    /// folder.
    static std::size_t numFoldersInURLArray(const std::vector<Url>& urls);
    /// Answers whether one of these is a special folder, see trw_isDesktopOrDocumentsFolder().
    static bool isDesktopOrDocumentsInURLArray(const std::vector<Url>& urls);
};

} // namespace tarrow
