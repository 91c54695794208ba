// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/Menu.h"
#include "screens/list/RowItem.h"

#include <functional>
#include <vector>

namespace screens {

/// What a screen asks its owner to do with the contents of items. What has no function is not offered.
struct DownloadVerbs {
    /// Download what is in the cloud, and remove the downloads of what is here, also in folders.
    std::function<void(const std::vector<Url>&items)> download, remove;
    /// Shows what is being downloaded.
    std::function<void()> showRunning;
};

/// Adds those entries to a menu that apply to one of the items at least. Nobody knows what a folder holds
/// before it is read, so both apply to a folder. A single item that is being downloaded gets the entry that
/// cancels this.
void addDownloadEntries(kit::Menu& menu, const DownloadVerbs& verbs, const std::vector<RowItem>& items);

} // namespace screens
