// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/FileDescriptor.h"
#include "host/system/files/SystemError.h"

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>

namespace host::drive {

/// Copies an item under a new name, a folder with everything in it: contents, links as links, traits
/// (ItemTraits) and modification dates. Every file is synced and compared with its original. Errors:
/// EOPNOTSUPP for anything but files, folders and links, ELOOP below 128 levels, EBUSY for a mount in a
/// folder.
system::SystemError copyTree(const system::FileDescriptor& folder, const std::string& name,
    const system::FileDescriptor& target, const std::string& newName);

/// Answers whether two items, folders with everything in them, hold the same names, contents and links.
/// Attributes and dates are not compared. An item that cannot be read counts as different.
bool isSameTree(const system::FileDescriptor& folder, const std::string& name,
    const system::FileDescriptor& otherFolder, const std::string& otherName);

/// Copies from the current position of one file to its end. `copied` may be empty. It is told the number of
/// bytes so far after each piece of at most 64 KiB, and ends the copy by answering an error.
system::SystemError copyBytes(const system::FileDescriptor& from, const system::FileDescriptor& to,
    const std::function<system::SystemError(std::uint64_t)>& copied);
/// Answers no error when both files hold the same bytes from their start, and EIO when they do not.
system::SystemError compareBytes(const system::FileDescriptor& a, const system::FileDescriptor& b);

} // namespace host::drive
