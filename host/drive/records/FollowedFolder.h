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

/// A folder of the drive that is watched for as long as this lives, also after it went away and came back, as
/// when its volume was taken off for a while. Main thread.
class FollowedFolder : public std::enable_shared_from_this<FollowedFolder> {
public:
    /// Called on the main thread with the names that changed; an empty one: anything may have.
    using Handler = std::function<void(const std::vector<std::string>& names)>;
    enum class IfMissing { Wait, Make };

    static std::shared_ptr<FollowedFolder> follow(
        std::shared_ptr<platform::Dispatch> dispatch, std::string path, IfMissing ifMissing, Handler changed);

    /// Whether it was there to be watched when it was last looked for.
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

/// Whether a name is among those that changed, or may be.
bool mayHaveChanged(const std::vector<std::string>& names, std::string_view name);

} // namespace host::drive
