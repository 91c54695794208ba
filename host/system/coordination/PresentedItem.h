// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/FileDescriptor.h"
#include "host/system/files/SystemError.h"
#include "platform/FileChanges.h"

#include <string>

namespace host::system {

/// One item, here or promised, as of the last look. It is held by a descriptor that reads nothing, so that
/// the item can be found wherever on its file system it was moved.
class PresentedItem {
public:
    enum class Finding {
        Same, ///< unchanged, still missing, or not accessible now
        Changed, ///< written, replaced, downloaded, evicted, or back again
        Moved, ///< its place is empty, and the item is elsewhere
        Gone, ///< its place is empty, and the item was removed
    };

    explicit PresentedItem(std::string path)
        : _path(std::move(path))
    {
    }

    const std::string& path() const { return _path; }
    bool isFolder() const { return _isFolder; }
    bool isKnown() const { return static_cast<bool>(_file); }

    /// Looks at the item's place. The item that is there is known from then on.
    Finding look();
    /// Answers the current path of the known item, for a promise the path of its item. The error is ENOENT
    /// when it was removed or is being removed; any other says nothing about that.
    SystemResult<std::string> whereabouts() const;
    /// Says that the item belongs to another place from now on.
    void setPath(std::string path) { _path = std::move(path); }
    /// Says that the item was removed, so nothing is known any more.
    void forget();

private:
    std::string _path;
    FileDescriptor _file;
    platform::ItemVersion _version;
    bool _isFolder = false;
};

} // namespace host::system
