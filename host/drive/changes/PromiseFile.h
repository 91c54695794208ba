// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/CloudStore.h"
#include "host/drive/records/PromiseRecord.h"

#include <string>

namespace host::drive {

/// The promise of an entry as it lies on the disk. Errors: the system's, or CloudErrorCode::DamagedRecord.
platform::Result<PromiseRecord> readPromise(const DriveEntry& entry);

/// The name of the content behind a promise file of an open folder; it is empty when the promise names none
/// or is damaged. It fails with what could not be read.
system::SystemResult<std::string> contentOfPromise(
    const system::FileDescriptor& folder, const std::string& promiseName);

/// Removes the promise beside a document when it adds nothing: nothing lies behind it, or what the document
/// holds as well. Any other is an item that nobody has seen since the document hides it, and stays.
void dropRedundantPromise(const DriveEntry& entry, CloudStore& store);

} // namespace host::drive
