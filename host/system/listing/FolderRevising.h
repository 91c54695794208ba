// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/listing/FolderReading.h"

#include <memory>
#include <span>
#include <string>

namespace host::system {

/// Whether a name can stand for anything that a folder's list shows, so that a notice of it matters.
bool mayBeListed(std::string_view name);

/// Makes a folder's next list of the one before by looking again at some names alone: at what they stand for,
/// be it here or promised. Costs a few system calls for each name, its place among the others, and one quick
/// pass over the list before. Answers the list before when the names say nothing new. Any thread.
std::shared_ptr<const platform::FolderSnapshot> revisedList(const ListingTools& tools,
    platform::FolderGrouping grouping, const FileDescriptor& folder,
    const std::shared_ptr<const platform::FolderSnapshot>& before, std::span<const std::string> names);

} // namespace host::system
