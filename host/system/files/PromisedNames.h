// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/FileDescriptor.h"
#include "host/system/files/SystemError.h"

#include <string>
#include <string_view>

namespace host::system {

/// Answers the name of the item for which a promise stands that has this name in an open folder. The name of
/// most promises says it. A long one is read from the promise, and counts only when the promise's own name is
/// made from it. Errors: EBADMSG for what is no promise or says no such name, else the system's. Any thread.
SystemResult<std::string> promisedName(const FileDescriptor& folder, std::string_view promiseName);
/// Does so for the promise at a path.
SystemResult<std::string> promisedName(const std::string& promisePath);
/// Does so for a promise that lies at a path under another name for the moment.
SystemResult<std::string> promisedName(const std::string& path, std::string_view promiseName);

/// Lets a promise in an open folder say the name that it shall have, beside the one that it has, so that it
/// stands for its item before and after it is renamed. It is for the name of an item, and does nothing for
/// one that is not long. Errors: EOPNOTSUPP where the file system has no attributes.
SystemError addPromisedName(
    const FileDescriptor& folder, const std::string& promiseName, std::string_view newItemName);
/// Lets a promise that was renamed say only its name. A failure does no harm.
void settlePromisedName(
    const FileDescriptor& folder, const std::string& promiseName, std::string_view itemName);

} // namespace host::system
