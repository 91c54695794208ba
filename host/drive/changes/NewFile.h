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
    /// Makes it, empty, beside an entry; answers 0 or the errno.
    static int create(const DriveLayout& layout, const DriveEntry& entry, std::optional<NewFile>& file);

    NewFile(NewFile&& other) noexcept;
    NewFile& operator=(NewFile&&) = delete;
    ~NewFile();

    const system::FileDescriptor& descriptor() const { return _file; }
    /// Writes a text; answers 0 or the errno.
    int write(std::string_view text) const;
    /// Syncs the file and gives it its name; nothing is replaced (EEXIST). Answers 0 or the errno. The record
    /// for the next start stays until the end.
    int publish(const DriveEntry& entry, const std::string& name);
    /// Syncs the file and gives it the name of one that is `expected`, which goes for good. Answers 0,
    /// ECANCELED when another version lies there by now, or the errno; nothing has changed then. After a kill
    /// in between, both are there: one of them in the trash. `written` is the version that lies there now.
    int replace(const DriveLayout& layout, const DriveEntry& entry, const platform::ItemVersion& expected,
        platform::ItemVersion& written);

private:
    NewFile() = default;
    system::SystemError takeHeldName(const DriveLayout& layout, const DriveEntry& entry);
    int exchange(const DriveEntry& entry) const;
    /// 0 when what was taken out is `expected`.
    int checkExchanged(const platform::ItemVersion& expected, platform::ItemVersion& written) const;
    bool isUnderPrivateName() const;

    std::optional<WorkRecord> _record;
    system::FileDescriptor _folder, _file;
    std::string _name; ///< empty once it is published
};

} // namespace host::drive
