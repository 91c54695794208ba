// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/DriveLayout.h"
#include "platform/Dispatch.h"
#include "platform/UserActivity.h"

#include <memory>
#include <mutex>
#include <string>

namespace host::drive {

/// Keeps the file that tells the account's other devices of this one's activity. The file is written when an
/// activity becomes current, renewed while it is, and removed when it is not. Any thread.
class ActivityPublication : public std::enable_shared_from_this<ActivityPublication> {
public:
    using Activity = std::shared_ptr<const platform::UserActivity>;

    /// The file is renewed so often. A file that was not renewed for three times as long belongs to a device
    /// that ended without removing it.
    static constexpr platform::Duration renewal = std::chrono::minutes(5);
    static constexpr platform::Duration longestSilence = 3 * renewal;

    ActivityPublication(DriveLayout layout, std::shared_ptr<platform::Dispatch> dispatch);
    /// Removes the file at once.
    ~ActivityPublication();

    void becomeCurrent(const Activity& activity);
    /// Does nothing when another activity is current.
    void resignCurrent(const Activity& activity);

private:
    void set(const Activity& activity);
    void bringUpToDate();
    void write(const platform::UserActivity& activity);
    void removeFile();

    DriveLayout _layout;
    std::shared_ptr<platform::Dispatch> _dispatch;
    std::shared_ptr<platform::Queue> _queue;
    std::mutex _mutex; ///< guards the two fields below
    Activity _current;
    std::unique_ptr<platform::Timer> _renewal;
    std::mutex _fileMutex; ///< guards the file and the field below
    std::string _written; ///< the file that this process wrote; empty: none
};

} // namespace host::drive
