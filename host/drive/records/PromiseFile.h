// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/PromiseRecord.h"
#include "host/system/files/FileDescriptor.h"
#include "host/system/files/SystemError.h"
#include "platform/Error.h"

#include <string>

namespace host::drive {

/// Reads the promise in the file at a path, following no link at its end. A promise is a file with the
/// attribute itemMark::promise, which is its short form, or a JSON object. Its marks are the same attributes
/// that a document has, and each counts before the same member of the JSON. Errors:
/// FileErrorCode::NoSuchItem, CloudErrorCode::DamagedRecord for a file that holds no promise, else the
/// system's. Any thread.
platform::Result<PromiseRecord> readPromise(const std::string& path);
/// Reads the promise in a file that is open for reading. Errors: EBADMSG for a file that holds no promise,
/// else the system's.
system::SystemResult<PromiseRecord> readPromise(const system::FileDescriptor& file);

/// Writes a promise into an empty file that is open for writing: attributes where the file system has any,
/// else the JSON.
system::SystemError writePromise(const system::FileDescriptor& file, const PromiseRecord& promise);
/// Writes another identifier into a promise that is open.
system::SystemError writeIdentifier(const system::FileDescriptor& file, std::uint32_t identifier);
/// Writes what the promise says beside its short form, as attributes of a file: the promise's own or the
/// document's that takes its place.
system::SystemError writeMarks(const system::FileDescriptor& file, const PromiseRecord& promise);

} // namespace host::drive
