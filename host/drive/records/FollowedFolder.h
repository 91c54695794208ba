// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/listing/FolderWatcher.h"
#include "platform/Dispatch.h"

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace host::drive {

/// Watches a folder of the drive for as long as this lives. It also finds the folder again when that
/// disappears and comes back, for instance with its volume. Main thread.
class FollowedFolder : public std::enable_shared_from_this<FollowedFolder> {
public:
    /// Called on the main thread with the names that changed. An empty list means that anything may have
    /// changed.
    using Handler = std::function<void(const std::vector<std::string>& names)>;
    enum class IfMissing { Wait, Make };

    static std::shared_ptr<FollowedFolder> follow(
        std::shared_ptr<platform::Dispatch> dispatch, std::string path, IfMissing ifMissing, Handler changed);

    /// Answers whether the folder existed at the last look, so that it is watched.
    bool isWatched() const { return _isWatched; }

private:
    FollowedFolder(
        std::shared_ptr<platform::Dispatch> dispatch, std::string path, IfMissing ifMissing, Handler changed);

    void watch();
    void watchLater();
    void namesChanged(const std::vector<std::string>& names);

    const std::shared_ptr<platform::Dispatch> _dispatch;
    const std::string _path;
    const IfMissing _ifMissing;
    const Handler _changed;
    std::unique_ptr<host::system::FolderWatcher> _watcher;
    bool _isWatched = false;
};

/// Answers whether a name changed or may have changed.
bool mayHaveChanged(const std::vector<std::string>& names, std::string_view name);

} // namespace host::drive
