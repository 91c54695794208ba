// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "browser/NavController.h"
#include "items/DRItem.h"
#include "items/LaunchUtils.h"
#include "preview/PreviewItemManager.h"
#include "screens/FolderPlaces.h"

// What the browser finds out about items on the queue of looks, before it opens or shows them.

namespace tarrow {

/// The facts about an item that was tapped.
struct NavController::PickedItem {
    std::shared_ptr<DRItem> item; ///< null: it is gone
    std::shared_ptr<DRItem> target; ///< the item itself, or where a link leads; null: nowhere in the drive
    std::string refusal; ///< says why a link cannot be followed
    LaunchUtils::DocumentFacts launch;
    std::vector<screens::TitledFolder> folders; ///< that lead to it, where they are needed
};

/// The facts about an item that a peek shows.
struct NavController::PeekedItem {
    Url url;
    std::shared_ptr<DRItem> document; ///< null: no document, or gone
    std::optional<std::string> folderTitle; ///< absent: no folder
};

/// Answers whether the item is a folder that is promised as a whole, which cannot be entered before it is
/// downloaded.
inline bool isFolderInCloud(const DRItem& item)
{
    return item.isDirectory() && item.isPromise();
}

/// Answers lists as what lies on a stack of screens.
inline std::vector<NavController::Screen> asStack(const PreviewItemManager::ListStack& lists)
{
    return {lists.begin(), lists.end()};
}

} // namespace tarrow
