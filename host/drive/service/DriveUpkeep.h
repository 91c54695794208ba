// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/CloudStore.h"
#include "host/drive/records/DriveLayout.h"
#include "platform/Dispatch.h"

#include <atomic>
#include <functional>
#include <memory>

namespace host::drive {

class Recovery;

/// Keeps the drive in order on a queue of its own: puts right what killed programs left (Recovery), and
/// removes released contents (ContentCollection). Any thread may call.
class DriveUpkeep : public std::enable_shared_from_this<DriveUpkeep> {
public:
    DriveUpkeep(DriveLayout layout, std::shared_ptr<CloudStore> store,
        const std::shared_ptr<platform::Dispatch>& dispatch);

    /// Puts the drive right before it answers, as far as records tell what has to be done.
    void putRight();
    /// Puts the drive right in the background, and searches the whole drive for what no record tells.
    void putRightBeside();
    /// Answers whether the work that records tell has taken more than half a second and goes on, so that a
    /// person is told. Main thread.
    bool isPuttingRight() const { return _isTold; }
    /// Calls `changed` on the main thread whenever isPuttingRight() changes.
    void onPuttingRight(std::function<void()> changed) { _changed = std::move(changed); }
    /// Looks for contents to remove, some seconds later. Calls meanwhile count as one.
    void contentReleased();

private:
    void putAllRight();
    void settleRecords(Recovery& recovery);
    void tell();
    void collect();
    void collectAfter(platform::Duration delay);

    const DriveLayout _layout;
    const std::shared_ptr<CloudStore> _store;
    const std::shared_ptr<platform::Dispatch> _dispatch;
    const std::shared_ptr<platform::Queue> _queue;
    std::function<void()> _changed;
    bool _isTold = false; ///< main thread
    std::atomic<bool> _isSettling = false;
    std::atomic<bool> _isCollectionDue = false;
};

} // namespace host::drive
