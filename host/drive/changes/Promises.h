// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/DriveEntry.h"
#include "host/drive/changes/HeldItem.h"
#include "host/drive/records/PromiseFile.h"

#include <string>

namespace host::drive {

class CloudStore;

/// A promise file that is open, so that its marks can be read again wherever another program moves it.
struct OpenPromise {
    system::FileDescriptor file;
    PromiseRecord record;

    /// Opens the promise file of this name in an open folder. Errors: ENOENT, EBADMSG for a file that holds
    /// no promise, else the system's.
    static system::SystemResult<OpenPromise> open(
        const system::FileDescriptor& folder, const std::string& promiseName);
    /// Opens the promise of an entry.
    static system::SystemResult<OpenPromise> open(const DriveEntry& entry)
    {
        return open(entry.folder, entry.promiseName());
    }
};

/// Answers the promise of an open document of this name, whose content gets the name `content`. That of a
/// folder is a package's, and says no size.
PromiseRecord promiseFor(
    const system::FileDescriptor& document, const std::string& name, const std::string& content);

/// Answers the name of the content behind a promise file in an open folder. The name is empty when the
/// promise names none or is damaged. An error means that the file could not be read.
system::SystemResult<std::string> contentOfPromise(
    const system::FileDescriptor& folder, const std::string& promiseName);

/// Takes the promise of an entry away from its place if it names this content, so that it can be removed.
/// Errors: ENOENT when there is none, ESTALE when it names another content, which then stays in its place.
system::SystemResult<HeldItem> takePromise(
    const DriveLayout& layout, const DriveEntry& entry, const std::string& content);

/// Removes the promise beside a document when it adds nothing: when its content is not in the store, or is
/// the same as the document's. Any other promise stays, because it is an item that the document hides and
/// nobody has seen since. Whoever calls this keeps other writers of the item out. An error means that nothing
/// was removed.
system::SystemError settleTwin(const DriveLayout& layout, const DriveEntry& entry, CloudStore& store);

/// Removes a promise that names this content when the store does not have it, because the document never came
/// there. Errors: ENOENT when there is no promise, ESTALE when it names another content, EEXIST when the
/// store has it.
system::SystemError withdrawPromise(
    const DriveLayout& layout, const DriveEntry& entry, CloudStore& store, const std::string& content);

} // namespace host::drive
