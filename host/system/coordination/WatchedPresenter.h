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

/// One presenter and the folders that are watched for it: its item's folder, the folders above that one up to
/// the drive, and a presented folder itself. Events only mark the presenter; a look at the disk then decides
/// what it is told.
class WatchedPresenter {
public:
    /// A call to a presenter, which runs when none of our locks is held.
    using Notice = std::function<void(PresenterNotices&)>;
    /// Answers whether this process is writing a path, because it then tells its presenters itself.
    using IsOwn = std::function<bool(const std::string& path)>;

    /// `root` is the drive's documents area. Nothing above it moves an item.
    WatchedPresenter(std::weak_ptr<platform::FilePresenter> presenter, std::string path, std::string root);

    const std::weak_ptr<platform::FilePresenter>& presenter() const { return _presenter; }
    const PresentedItem& item() const { return _item; }
    /// The path that the presenter answered last. It may be older than the item's place.
    const std::string& askedPath() const { return _askedPath; }
    void setAskedPath(std::string path) { _askedPath = std::move(path); }
    bool isDue() const { return _isDue; }
    /// Answers whether a folder could not be watched, so that changes must be polled for.
    bool isBlind() const { return _isBlind; }

    /// Begins to watch, and takes the current state as known.
    void start(FolderWatches& watches);
    void stop(FolderWatches& watches);
    void mark(const Inotify::Event& event, const IsOwn& isOwn);
    void markDue() { _isDue = true; }

    /// Looks at the item and adds the notices for its presenter. A missing item is reported at the second
    /// look, so that a program that saves in several steps has finished them.
    void look(FolderWatches& watches, std::vector<Notice>& notices);

    enum class Ending { MayBeThere, WasDeleted };
    /// A write of this process has ended, of which the presenter is told otherwise, so the current state is
    /// taken as known.
    void absorb(FolderWatches& watches, Ending ending);
    /// This process moved the item.
    void follow(std::string path) { _item.setPath(std::move(path)); }

private:
    struct Link {
        int watch;
        std::string name; ///< the name in the watched folder that leads to the item
    };
    void link(FolderWatches& watches);
    /// Answers the watch of a folder, or -1.
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
    std::set<std::string> _appeared; ///< names that appeared in the folder since the last look
    std::map<std::string, std::uint32_t> _vanished; ///< names that left the folder, with the cookie of a move
    bool _isDue = false, _isBlind = false, _isInsideChanged = false, _wasMissing = false;
};

} // namespace host::system
