// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/DriveEntry.h"
#include "host/drive/records/StorageSpace.h"
#include "platform/Error.h"

#include <functional>
#include <optional>
#include <string>

namespace host::drive {

/// Stores the contents behind promises, each under a name that its promise carries. Any thread; every call is
/// synchronous and may wait for a network. Errors: ENOENT for a content that does not exist, ETIMEDOUT or
/// EHOSTUNREACH for a store that cannot be reached.
class CloudStore {
public:
    enum class Continue { Yes, No };
    /// Is told how many bytes have arrived and how many there are, at least once for each MiB. Answering No
    /// ends the fetch.
    using Progress = std::function<Continue(std::uint64_t done, std::optional<std::uint64_t> total)>;

    virtual ~CloudStore() = default;

    /// Writes the whole content to an open, empty file, or fails: EIO when the content ends early, ECANCELED
    /// when the fetch was ended.
    virtual system::SystemError fetch(
        const std::string& content, const system::FileDescriptor& into, const Progress& progress) = 0;
    /// Moves a document into the store as the content, so that its name is free afterwards. A document that
    /// is another version by now stays or is put back (ECANCELED).
    virtual system::SystemError store(
        const DriveEntry& document, const platform::ItemVersion& version, const std::string& content) = 0;
    /// Is told that a promise of this content goes for good. The content stays, and can be fetched, until it
    /// is certain that no other promise names it, for another program may have copied the promise. A content
    /// that does not exist is no error.
    virtual system::SystemError release(const std::string& content) = 0;
    /// Answers whether the store has a content, or nothing when that cannot be told.
    virtual std::optional<bool> has(const std::string& content) = 0;

    /// Answers whether the store holds a content of this name that differs from an open document. A content
    /// that cannot be compared counts as different.
    virtual bool holdsOtherThan(const std::string& content, const system::FileDescriptor& document) = 0;
    /// Answers the space that the store has.
    virtual platform::Result<StorageSpace> quota() = 0;
};

} // namespace host::drive
