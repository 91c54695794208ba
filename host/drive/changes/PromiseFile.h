// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/CloudStore.h"
#include "host/drive/records/PromiseRecord.h"

#include <string>

namespace host::drive {

/// Reads the promise of an entry from the disk. Errors: the system's, or CloudErrorCode::DamagedRecord.
platform::Result<PromiseRecord> readPromise(const DriveEntry& entry);

/// Answers the name of the content behind a promise file in an open folder. The name is empty when the
/// promise names none or is damaged. An error means that the file could not be read.
system::SystemResult<std::string> contentOfPromise(
    const system::FileDescriptor& folder, const std::string& promiseName);

/// Removes the promise beside a document when it adds nothing: when it has no content, or the same content as
/// the document. Any other promise stays, because it is an item that the document hides and nobody has seen
/// since.
void dropRedundantPromise(const DriveEntry& entry, CloudStore& store);

} // namespace host::drive
