// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/listing/FolderReading.h"

#include <memory>
#include <span>
#include <string>

namespace host::system {

/// Answers whether a name can stand for an item that a folder's list shows, so that a notice of it matters.
bool mayBeListed(std::string_view name);

/// Makes a folder's next list from the previous one by looking only at the items of some names, here or
/// promised. It costs a few system calls and a binary search for each name, and one quick pass over the
/// previous list. Answers the previous list when nothing has changed. Any thread.
std::shared_ptr<const platform::FolderSnapshot> revisedList(const ListingTools& tools,
    platform::FolderGrouping grouping, const FileDescriptor& folder,
    const std::shared_ptr<const platform::FolderSnapshot>& before, std::span<const std::string> names);

} // namespace host::system
