// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/DriveEntry.h"
#include "host/drive/changes/TreeWalk.h"
#include "host/drive/records/StorageSpace.h"
#include "platform/Error.h"

#include <functional>
#include <optional>
#include <string>

namespace host::drive {

/// Stores the contents behind promises, each under a name that its promise carries: a file, or a folder with
/// everything in it. Any thread; every call is
/// synchronous and may wait for a network. Errors: ENOENT for a content that does not exist, ETIMEDOUT or
/// EHOSTUNREACH for a store that cannot be reached.
class CloudStore {
public:
    enum class Continue { Yes, No };
    /// Is told how many bytes have arrived and how many there are, at least once for each MiB and for each
    /// item of a folder. Answering No ends the fetch.
    using Progress = std::function<Continue(std::uint64_t done, std::optional<std::uint64_t> total)>;

    virtual ~CloudStore() = default;

    /// Writes the whole content to an open, empty file or into an open, empty folder, or fails: EIO when the
    /// content ends early, ECANCELED when the fetch was ended, EOPNOTSUPP for a folder in place of a file and
    /// the other way round. What is in a folder is synced and has its traits; the folder itself has none.
    virtual system::SystemError fetch(
        const std::string& content, const system::FileDescriptor& into, const Progress& progress) = 0;
    /// Moves a document or a folder into the store as the content, so that its name is free afterwards. What
    /// does not have these versions by now stays or is put back (ECANCELED).
    virtual system::SystemError store(
        const DriveEntry& document, const TreeVersions& versions, const std::string& content) = 0;
    /// Is told that a promise of this content goes for good. The content stays, and can be fetched, until it
    /// is certain that no other promise names it, for another program may have copied the promise. A content
    /// that does not exist is no error.
    virtual system::SystemError release(const std::string& content) = 0;
    /// Answers whether the store has a content, or nothing when that cannot be told.
    virtual std::optional<bool> has(const std::string& content) = 0;

    /// Answers whether the store holds a content of this name that differs from an open document or folder.
    /// A content that cannot be compared counts as different.
    virtual bool holdsOtherThan(const std::string& content, const system::FileDescriptor& document) = 0;
    /// Answers the space that the store has.
    virtual platform::Result<StorageSpace> quota() = 0;
};

} // namespace host::drive
