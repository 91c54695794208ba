// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/coordination/FolderWatches.h"
#include "host/system/coordination/PresentedItem.h"

#include <functional>
#include <map>
#include <memory>
#include <set>
#include <string>
#include <utility>
#include <vector>

namespace platform {
class FilePresenter;
class Url;
} // namespace platform

namespace host::system {

class PresenterNotices;

/// One presenter and what is watched for it: its item's folder, the folders above that one up to the drive,
/// and a presented folder itself. Events only mark it; a look at the disk then decides what is told.
class WatchedPresenter {
public:
    /// What a presenter is to be told, once nothing of ours is locked.
    using Notice = std::function<void(PresenterNotices&)>;
    /// Whether a path is being written by this process, which tells its presenters itself.
    using IsOwn = std::function<bool(const std::string& path)>;

    /// `root` is the drive's documents area; nothing above it moves an item.
    WatchedPresenter(std::weak_ptr<platform::FilePresenter> presenter, std::string path, std::string root);

    const std::weak_ptr<platform::FilePresenter>& presenter() const { return _presenter; }
    const PresentedItem& item() const { return _item; }
    /// What the presenter answered when it was asked last; it may lag behind where the item is.
    const std::string& askedPath() const { return _askedPath; }
    void setAskedPath(std::string path) { _askedPath = std::move(path); }
    bool isDue() const { return _isDue; }
    /// Whether a folder could not be watched, so that changes must be looked for.
    bool isBlind() const { return _isBlind; }

    /// Begins to watch, and takes what is there as known.
    void start(FolderWatches& watches);
    void stop(FolderWatches& watches);
    void mark(const Inotify::Event& event, const IsOwn& isOwn);
    void markDue() { _isDue = true; }

    /// Looks at the item and adds what its presenter is to be told. One that is missing is told of at the
    /// second look, so that a program which saves in several steps is through with them.
    void look(FolderWatches& watches, std::vector<Notice>& notices);

    enum class Ending { MayBeThere, WasDeleted };
    /// A write of this process ended, of which the presenter hears otherwise: what is there is known.
    void absorb(FolderWatches& watches, Ending ending);
    /// The item was moved by this process.
    void follow(std::string path) { _item.setPath(std::move(path)); }

private:
    struct Link {
        int watch;
        std::string name; ///< the one in the watched folder that leads to the item
    };
    void link(FolderWatches& watches);
    /// The watch of a folder, or -1.
    int hold(FolderWatches& watches, const std::string& folder);
    PresentedItem::Finding see();
    void markMissed();
    void markInside(const Inotify::Event& event, const IsOwn& isOwn);
    void tellMissing(FolderWatches& watches, std::vector<Notice>& notices);
    void tellPresent(bool hasChanged, std::vector<Notice>& notices);
    bool isOnDrive() const;

    std::weak_ptr<platform::FilePresenter> _presenter;
    PresentedItem _item;
    std::string _root, _askedPath;
    std::pair<std::uint64_t, std::uint64_t> _rootIdentity; ///< device and inode
    std::vector<Link> _links; ///< the item's own folder first
    int _inside = -1; ///< the watch of a presented folder
    std::set<std::string> _appeared; ///< names that came into it since the last look
    std::map<std::string, std::uint32_t> _vanished; ///< names that left it, with the cookie of a move
    bool _isDue = false, _isBlind = false, _isInsideChanged = false, _wasMissing = false;
};

} // namespace host::system
