// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/FileDescriptor.h"

#include <string>

namespace host::drive {

class CloudStore;

/// Whether an item could be removed with everything in it, as far as that can be told without trying: answers
/// 0, EACCES or EPERM for what may not be removed, EBUSY for what is mounted in a folder, or another errno.
int checkRemovable(const system::FileDescriptor& folder, const std::string& name);

/// How much of an item is gone.
enum class Discarded { Nothing, Something, Everything };

/// Removes an item with everything in it and, where a store is given, the contents behind its promises. It
/// goes on after a failure, and answers how far it came and in `failure` the first errno.
Discarded discardTree(
    const system::FileDescriptor& folder, const std::string& name, CloudStore* store, int& failure);

} // namespace host::drive
