// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/DriveEntry.h"
#include "host/drive/changes/WorkRecord.h"

#include <optional>
#include <string>

namespace host::drive {

class CloudStore;

/// An item that was taken out of its folder under a name that nobody else uses, so that what is looked at is
/// what is then removed. It is put back at the end unless it was removed, and at the next start when the
/// process was killed meanwhile (Recovery).
///
/// Removing it is all or nothing, for a folder too. Whether everything in it may be removed is asked first
/// (Discarding); then it gets the name of a removal that is decided. Until its first part is gone any failure
/// puts the whole back.
class HeldItem {
public:
    /// Takes the item away; `name` is its own or its promise's. `copy` is where a whole copy of it lies, if
    /// it is removed because it was copied.
    static system::SystemResult<HeldItem> take(const DriveLayout& layout, const DriveEntry& entry,
        const std::string& name, const std::string& copy = {});

    HeldItem(HeldItem&& other) noexcept;
    HeldItem& operator=(HeldItem&&) = delete;
    ~HeldItem();

    /// Where it is now.
    const system::FileDescriptor& folder() const { return _isAside ? _aside : _origin; }
    const std::string& name() const { return _name; }

    /// Removes it for good, with the contents behind its promises where a store is given. All or nothing:
    /// after a failure it is put back whole. What cannot be removed once the first part is gone is
    /// removed at the next start; the item counts as removed then.
    system::SystemError remove(CloudStore* store);

private:
    HeldItem() = default;
    system::SystemError decide(const char* prefix);
    void putBack();

    system::FileDescriptor _origin, _aside; ///< its folder; the private one
    std::optional<WorkRecord> _record;
    std::string _originName, _name, _path;
    bool _isAside = false; ///< in the private folder; else beside its old name, on another file system
    bool _isThere = false;
};

} // namespace host::drive
