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

/// Is told the number of bytes that are copied so far, and ends the copy by answering an error.
using CopyProgress = std::function<system::SystemError(std::uint64_t bytes)>;

/// Copies an item under a new name, a folder with everything in it: contents, links as links, traits
/// (ItemTraits) and modification dates. Every file is synced and compared with its original. Errors:
/// EOPNOTSUPP for anything but files, folders and links, ELOOP below 128 levels, EBUSY for a mount in a
/// folder.
system::SystemError copyTree(const system::FileDescriptor& folder, const std::string& name,
    const system::FileDescriptor& target, const std::string& newName);
/// Copies everything in an open folder into another open folder in the same way, but not the traits of the
/// folder itself. `copied` may be empty; it is told of each item, and after each piece of at most 64 KiB.
system::SystemError copyContents(
    const system::FileDescriptor& folder, const system::FileDescriptor& target, const CopyProgress& copied);
/// Copies what an open file or folder holds into an open empty one of the same kind, which becomes an item of
/// its own: it has the dates, the tags and the access of the original as far as others have access to what
/// the user makes, and nothing by which the drive tells items apart. The files are synced, but not compared.
/// Errors: those of copyTree(), and ECANCELED when the original changes meanwhile or holds a name that the
/// drive needs for itself.
system::SystemError copyAsNew(
    const system::FileDescriptor& from, const system::FileDescriptor& to, const CopyProgress& copied);
/// Makes a link that leads where another one does.
system::SystemError copyLink(const system::FileDescriptor& folder, const std::string& name,
    const system::FileDescriptor& target, const std::string& newName);
/// Checks whether an item could be copied with everything in it, as far as that can be told without trying,
/// and answers the bytes of all files. Errors: those of copyTree(), and EACCES for what may not be read.
system::SystemResult<std::uint64_t> checkCopyable(
    const system::FileDescriptor& folder, const std::string& name);

/// Answers whether two items, folders with everything in them, hold the same names, contents and links.
/// Attributes and dates are not compared. An item that cannot be read counts as different.
bool isSameTree(const system::FileDescriptor& folder, const std::string& name,
    const system::FileDescriptor& otherFolder, const std::string& otherName);
/// Answers the same for two open folders.
bool isSameTree(const system::FileDescriptor& folder, const system::FileDescriptor& otherFolder);

/// Copies from the current position of one file to its end. `copied` may be empty; it is told after each
/// piece of at most 64 KiB.
system::SystemError copyBytes(
    const system::FileDescriptor& from, const system::FileDescriptor& to, const CopyProgress& copied);
/// Answers no error when both files hold the same bytes from their start, and EIO when they do not.
system::SystemError compareBytes(const system::FileDescriptor& a, const system::FileDescriptor& b);

} // namespace host::drive
