// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/coordination/WatchedPresenter.h"
#include "platform/Dispatch.h"

#include <atomic>
#include <memory>
#include <mutex>
#include <span>
#include <string>
#include <vector>

namespace host::system {

/// Tells presenters of the changes that other processes made to their items, coordinated or not. Any thread.
///
/// Events of inotify only mark the presenters that must look. The notices come from a look at the disk 50 ms
/// after the first event, so that one save leads to one notice. Each presented item is held by a descriptor
/// that reads nothing, so the kernel tells where the item is when its place is empty; a quarter of a second
/// later that is reported as a move or as a deletion. The item at the place counts: a save that replaces the
/// file, a save that leaves a backup, and an eviction are changes. A drive that disappears as a whole has
/// deleted nothing. Writes of this process are left out, because their results are taken as known at their
/// end, inside their locks. When the kernel has lost events every presenter looks. When the system has no
/// watches left the presenters look every five seconds, and one line is logged.
class PresenterWatch : public std::enable_shared_from_this<PresenterWatch> {
public:
    struct OwnWrite {
        std::string path;
        bool isDeletion;
    };

    /// `root` is the drive's documents area.
    static std::shared_ptr<PresenterWatch> create(std::shared_ptr<PresenterNotices> notices,
        std::shared_ptr<platform::Dispatch> dispatch, std::string root);

    /// A presenter was added or removed, or presents another item, so the presenters are asked soon.
    void presentersChanged();
    /// Stops the watch. No presenter is told anything afterwards.
    void stop();

    /// Call these around each write of this process, inside its locks. The presenters are told of such a
    /// write otherwise.
    void beginOwnWrite(std::span<const OwnWrite> writes);
    void endOwnWrite(std::span<const OwnWrite> writes);
    /// Says inside such a write that the item was moved.
    void ownMove(const std::string& from, const std::string& to);

private:
    PresenterWatch(std::shared_ptr<PresenterNotices> notices, std::shared_ptr<platform::Dispatch> dispatch,
        std::string root);

    struct Asked {
        std::weak_ptr<platform::FilePresenter> presenter;
        std::string path;
    };
    std::vector<Asked> askPresenters() const;
    std::unique_ptr<FolderWatches> makeWatches();

    // These are steps that run on the queue.
    void askAgain();
    void readEvents();
    void look();
    void poll();

    // These are called with the mutex locked.
    void update(const std::vector<Asked>& asked);
    void markEvents();
    void lookLater(platform::Duration delay);
    bool isOwn(const std::string& path) const;
    bool mustLook(const WatchedPresenter& presenter) const;
    void absorb(WatchedPresenter& presenter, std::span<const OwnWrite> writes);

    const std::shared_ptr<PresenterNotices> _notices;
    const std::shared_ptr<platform::Dispatch> _dispatch;
    const std::shared_ptr<platform::Queue> _queue;
    const std::string _root;
    std::atomic_bool _isReading = false, _isStopped = false;

    std::mutex _mutex; ///< guards everything below; locked while the disk is read
    std::unique_ptr<FolderWatches> _watches;
    std::vector<WatchedPresenter> _presenters;
    std::vector<std::string> _ownPaths; ///< the paths that this process is writing now
    bool _isLookComing = false, _isPollComing = false;
};

} // namespace host::system
