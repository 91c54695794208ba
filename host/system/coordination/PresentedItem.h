// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/FileDescriptor.h"
#include "platform/FileChanges.h"

#include <optional>
#include <string>

namespace host::system {

/// One item as it was seen last, here or promised. It is held by an open descriptor that reads nothing, so
/// that it is found again wherever on its storage it was moved.
class PresentedItem {
public:
    enum class Finding {
        Same, ///< unchanged; or still missing; or it cannot be looked at now
        Changed, ///< written, replaced, downloaded, evicted, or there again
        Moved, ///< its place is empty, and it is elsewhere
        Gone, ///< its place is empty, and it was removed
    };

    explicit PresentedItem(std::string path)
        : _path(std::move(path))
    {
    }

    const std::string& path() const { return _path; }
    bool isFolder() const { return _isFolder; }
    bool isKnown() const { return static_cast<bool>(_file); }

    /// Looks at the item's place. What is there is known from then on.
    Finding look();
    /// Where the known item is now, the item's own name for a promise; nothing when it was removed or is
    /// being removed.
    std::optional<std::string> whereabouts() const;
    /// It belongs there from now on.
    void setPath(std::string path) { _path = std::move(path); }
    /// It was removed; nothing is known any more.
    void forget();

private:
    std::string _path;
    FileDescriptor _file;
    platform::ItemVersion _version;
    bool _isFolder = false;
};

} // namespace host::system
