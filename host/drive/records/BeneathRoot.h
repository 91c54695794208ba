// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/FileDescriptor.h"
#include "host/system/files/SystemError.h"

#include <string>

namespace host::drive {

/// Opens a path below a folder without following any link on the way or at the end; nothing can lead outside.
/// `flags` are open(2)'s. Errors: EXDEV for a way out, ELOOP for a link.
host::system::SystemResult<host::system::FileDescriptor> openBeneath(
    const std::string& root, const std::string& relativePath, int flags);

/// Opens a folder by its name in an open one, for reading its names. Neither a link nor a mount is entered
/// (ELOOP, EBUSY).
host::system::SystemResult<host::system::FileDescriptor> openSubfolder(
    const host::system::FileDescriptor& parent, const std::string& name);

/// The path by which the kernel lets one name an open descriptor.
std::string descriptorPath(const host::system::FileDescriptor& descriptor);

} // namespace host::drive
