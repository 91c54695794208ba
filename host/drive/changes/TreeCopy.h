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

/// Copies an item under a new name, a folder with everything in it: contents, links as links, access, user
/// attributes and modification dates. Every file is synced and compared with what it was copied from. Errors:
/// EOPNOTSUPP for what is no file, folder or link, ELOOP below 128 levels, EBUSY for what is mounted in a
/// folder.
system::SystemError copyTree(const system::FileDescriptor& folder, const std::string& name,
    const system::FileDescriptor& target, const std::string& newName);

/// Copies the user attributes of a file, but for one of this name.
system::SystemError copyAttributes(
    const system::FileDescriptor& from, const system::FileDescriptor& to, std::string_view except = {});

/// Whether two items, folders with everything in them, hold the same names, contents and links. Attributes
/// and dates are not compared; what cannot be read is not the same.
bool isSameTree(const system::FileDescriptor& folder, const std::string& name,
    const system::FileDescriptor& otherFolder, const std::string& otherName);

/// Copies from where one file is to the end. `copied`, which may be empty, hears after each piece of at most
/// 64 KiB how much there is now, and ends the copy with the failure that it answers.
system::SystemError copyBytes(const system::FileDescriptor& from, const system::FileDescriptor& to,
    const std::function<system::SystemError(std::uint64_t)>& copied);
/// Nothing when both hold the same bytes from their start, EIO when they do not.
system::SystemError compareBytes(const system::FileDescriptor& a, const system::FileDescriptor& b);

} // namespace host::drive
