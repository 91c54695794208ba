// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/FollowedFolder.h"

#include "platform/Weakly.h"

#include <sys/stat.h>

#include <algorithm>
#include <chrono>
#include <utility>

namespace host::drive {

namespace {

constexpr platform::Duration retryDelay = std::chrono::seconds(2);

} // namespace

std::shared_ptr<FollowedFolder> FollowedFolder::follow(
    std::shared_ptr<platform::Dispatch> dispatch, std::string path, IfMissing ifMissing, Handler changed)
{
    std::shared_ptr<FollowedFolder> folder(
        new FollowedFolder(std::move(dispatch), std::move(path), ifMissing, std::move(changed)));
    folder->watch();
    return folder;
}

FollowedFolder::FollowedFolder(
    std::shared_ptr<platform::Dispatch> dispatch, std::string path, IfMissing ifMissing, Handler changed)
    : _dispatch(std::move(dispatch))
    , _path(std::move(path))
    , _ifMissing(ifMissing)
    , _changed(std::move(changed))
{
}

void FollowedFolder::watch()
{
    if (_ifMissing == IfMissing::Make)
        ::mkdir(_path.c_str(), 0700); // the watch reports a failure
    _watcher =
        std::make_unique<host::system::FolderWatcher>(platform::weakly(this, &FollowedFolder::namesChanged));
    _isWatched = _watcher->watch(_path);
    if (!_isWatched)
        watchLater();
}

void FollowedFolder::watchLater()
{
    _dispatch->after(retryDelay, _dispatch->mainQueue(), platform::weakly(this, [](FollowedFolder& self) {
        self.watch();
        if (self._isWatched)
            self._changed({std::string()});
    }));
}

void FollowedFolder::namesChanged(const std::vector<std::string>& names)
{
    if (std::ranges::find(names, std::string()) != names.end())
        watch();
    _changed(names);
}

bool mayHaveChanged(const std::vector<std::string>& names, std::string_view name)
{
    return std::ranges::any_of(
        names, [name](const std::string& changed) { return changed.empty() || changed == name; });
}

} // namespace host::drive
