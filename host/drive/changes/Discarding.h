// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/FileDescriptor.h"
#include "host/system/files/SystemError.h"

#include <string>

namespace host::drive {

class CloudStore;

/// Checks whether an item could be removed with everything in it, as far as that can be told without trying.
/// Errors: EACCES or EPERM for an item that may not be removed, EBUSY for a mount in a folder.
system::SystemError checkRemovable(const system::FileDescriptor& folder, const std::string& name);

/// Says how much of an item was removed.
struct Discarded {
    enum class Part { Nothing, Something, Everything };
    Part part;
    system::SystemError failure; ///< the first one; none when everything is gone
};

/// Removes an item with everything in it and, when a store is given, the contents behind its promises. After
/// a failure it goes on only if something was already removed.
Discarded discardTree(const system::FileDescriptor& folder, const std::string& name, CloudStore* store);

} // namespace host::drive
