// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/DriveEntry.h"
#include "host/drive/records/StorageSpace.h"
#include "platform/Date.h"

#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace host::drive {

/// Where the contents behind promises are kept, each under a name of its own that promises carry. Any thread;
/// every call is synchronous and may wait for a network. Errors: ENOENT for a content that is not there,
/// ETIMEDOUT or EHOSTUNREACH for a store that cannot be reached.
class CloudStore {
public:
    enum class Continue { Yes, No };
    /// Hears how many bytes have arrived and how many there are, at least once for each MiB. Answering No
    /// ends the fetch.
    using Progress = std::function<Continue(std::uint64_t done, std::optional<std::uint64_t> total)>;

    virtual ~CloudStore() = default;

    /// Writes a content to an open, empty file. Whole, or it fails: EIO for one that ends short, ECANCELED
    /// for one that was ended.
    virtual system::SystemError fetch(
        const std::string& content, const system::FileDescriptor& into, const Progress& progress) = 0;
    /// Takes a document over as the content: its name is free then. One that is another version by now stays,
    /// or comes back (ECANCELED).
    virtual system::SystemError store(
        const DriveEntry& document, const platform::ItemVersion& version, const std::string& content) = 0;
    /// Removes a content for good. One that is not there is no error.
    virtual system::SystemError remove(const std::string& content) = 0;
    /// Gives a content another name; none is replaced (EEXIST).
    virtual system::SystemError move(const std::string& content, const std::string& newContent) = 0;

    /// Whether something that differs from an open document is kept under the name. What cannot be compared
    /// differs.
    virtual bool holdsOtherThan(const std::string& content, const system::FileDescriptor& document) = 0;
    /// The names of the contents that were stored or changed since a moment, in no order.
    virtual platform::Result<std::vector<std::string>> listChanges(platform::Date since) = 0;
    /// The space that the store has.
    virtual platform::Result<StorageSpace> quota() = 0;
};

} // namespace host::drive
