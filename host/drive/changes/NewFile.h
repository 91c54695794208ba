// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/DriveEntry.h"
#include "host/drive/changes/WorkRecord.h"

#include <optional>
#include <string>

namespace host::drive {

/// A file that is being written in its final folder, under a private name until it is whole. A file that is
/// not published is removed by the destructor, or at the next start if the process was killed.
///
/// It replaces a document by exchanging the two names in one step and comparing the old document with the
/// expected version. When another program has saved meanwhile, the names are exchanged back, and nothing has
/// changed.
class NewFile {
public:
    /// Creates the empty file beside an entry.
    static system::SystemResult<NewFile> create(const DriveLayout& layout, const DriveEntry& entry);

    NewFile(NewFile&& other) noexcept;
    NewFile& operator=(NewFile&&) = delete;
    ~NewFile();

    const system::FileDescriptor& descriptor() const { return _file; }
    /// Writes a text.
    system::SystemError write(std::string_view text) const;
    /// Syncs the file and gives it its name. It never replaces a file (EEXIST). The record for the next start
    /// stays until the end.
    system::SystemError publish(const DriveEntry& entry, const std::string& name);
    /// Syncs the file and gives it the name of the `expected` version, which is removed for good. Answers the
    /// new version, or ECANCELED when another version had taken the name; after a failure nothing has
    /// changed. After a kill in between both files exist, one of them in the trash.
    system::SystemResult<platform::ItemVersion> replace(
        const DriveLayout& layout, const DriveEntry& entry, const platform::ItemVersion& expected);

private:
    NewFile() = default;
    system::SystemError takeHeldName(const DriveLayout& layout, const DriveEntry& entry);
    system::SystemError exchange(const DriveEntry& entry) const;
    /// Answers this file's version when the replaced file is `expected`, else ECANCELED.
    system::SystemResult<platform::ItemVersion> checkExchanged(const platform::ItemVersion& expected) const;
    bool isUnderPrivateName() const;

    std::optional<WorkRecord> _record;
    system::FileDescriptor _folder, _file;
    std::string _name; ///< empty once the file is published
};

} // namespace host::drive
