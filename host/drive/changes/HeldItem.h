// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/DriveEntry.h"
#include "host/drive/changes/WorkRecord.h"

#include <optional>
#include <string>

namespace host::drive {

class CloudStore;

/// An item that was renamed out of its folder to a private name, so that the item that is checked is the one
/// that is then removed. The destructor puts it back unless it was removed. If the process is killed, the
/// next start puts it back (Recovery).
///
/// Removing it is all or nothing, for a folder too. First it is checked whether everything in it may be
/// removed (Discarding); then it gets the name of a decided removal. Until its first part is removed, any
/// failure puts the whole item back.
class HeldItem {
public:
    /// Renames the item away; `name` is its own or its promise's. `copy` is the path of a whole copy of it,
    /// if it is removed because it was copied.
    static system::SystemResult<HeldItem> take(const DriveLayout& layout, const DriveEntry& entry,
        const std::string& name, const std::string& copy = {});

    HeldItem(HeldItem&& other) noexcept;
    HeldItem& operator=(HeldItem&&) = delete;
    ~HeldItem();

    /// The folder and the name under which it is held.
    const system::FileDescriptor& folder() const { return _isAside ? _aside : _origin; }
    const std::string& name() const { return _name; }

    /// Removes it for good and, when a store is given, the contents behind its promises. It is all or
    /// nothing: after a failure the whole item was put back. Parts that cannot be removed after the first one
    /// was are removed at the next start; the item counts as removed then.
    system::SystemError remove(CloudStore* store);

    /// Removes a promise whose document is here, and releases the content. Nothing is synced, because a
    /// promise that came back after a power cut would be settled with its document. After a failure it was
    /// put back.
    system::SystemError removePromise(CloudStore& store);

private:
    HeldItem() = default;
    system::SystemError decide(const char* prefix);
    void putBack();

    system::FileDescriptor _origin, _aside; ///< the item's folder; the private folder
    std::optional<WorkRecord> _record;
    std::string _originName, _name, _path;
    bool _isAside =
        false; ///< held in the private folder; else beside its old name, because it is on another file system
    bool _isThere = false;
};

} // namespace host::drive
