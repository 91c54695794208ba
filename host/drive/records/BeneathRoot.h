// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/FileDescriptor.h"
#include "host/system/files/SystemError.h"

#include <string>

namespace host::drive {

/// Opens a path below a folder without following any link on the way or at the end, so that nothing leads
/// outside. `flags` are those of open(2). Errors: EXDEV for a path that leads outside, ELOOP for a link, else
/// the system's.
host::system::SystemResult<host::system::FileDescriptor> openBeneath(
    const std::string& root, const std::string& relativePath, int flags);

/// Opens a folder by its name in an open folder, to read its names. It enters neither a link (ELOOP) nor a
/// mount (EBUSY).
host::system::SystemResult<host::system::FileDescriptor> openSubfolder(
    const host::system::FileDescriptor& parent, const std::string& name);

/// Answers the path under which the kernel shows an open descriptor.
std::string descriptorPath(const host::system::FileDescriptor& descriptor);
/// Answers the present path of an open item, or an empty text with errno when it cannot be told.
std::string pathOf(const host::system::FileDescriptor& item);

} // namespace host::drive
