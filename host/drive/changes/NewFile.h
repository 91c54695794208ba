// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/DriveEntry.h"
#include "host/drive/changes/WorkRecord.h"

#include <optional>
#include <string>

namespace host::drive {

/// A file in the making, in the folder where it will lie, under a private name until it is whole. What is not
/// published goes at the end, and at the next start when the process was killed meanwhile.
///
/// It replaces a document by exchanging the two names in one step and comparing what came out with what was
/// expected: when another program has saved meanwhile, the names are exchanged again, and nothing has
/// changed.
class NewFile {
public:
    /// Makes it, empty, beside an entry.
    static system::SystemResult<NewFile> create(const DriveLayout& layout, const DriveEntry& entry);

    NewFile(NewFile&& other) noexcept;
    NewFile& operator=(NewFile&&) = delete;
    ~NewFile();

    const system::FileDescriptor& descriptor() const { return _file; }
    /// Writes a text.
    system::SystemError write(std::string_view text) const;
    /// Syncs the file and gives it its name; nothing is replaced (EEXIST). The record for the next
    /// start stays until the end.
    system::SystemError publish(const DriveEntry& entry, const std::string& name);
    /// Syncs the file and gives it the name of one that is `expected`, which goes for good. Answers
    /// the version that lies there now, ECANCELED when another one had taken its place; after a failure
    /// nothing has changed. After a kill in between, both are there: one of them in the trash.
    system::SystemResult<platform::ItemVersion> replace(
        const DriveLayout& layout, const DriveEntry& entry, const platform::ItemVersion& expected);

private:
    NewFile() = default;
    system::SystemError takeHeldName(const DriveLayout& layout, const DriveEntry& entry);
    system::SystemError exchange(const DriveEntry& entry) const;
    /// This file's version, when what was taken out is `expected`; else ECANCELED.
    system::SystemResult<platform::ItemVersion> checkExchanged(const platform::ItemVersion& expected) const;
    bool isUnderPrivateName() const;

    std::optional<WorkRecord> _record;
    system::FileDescriptor _folder, _file;
    std::string _name; ///< empty once it is published
};

} // namespace host::drive
