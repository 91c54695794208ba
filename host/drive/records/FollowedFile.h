// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/FollowedFolder.h"
#include "platform/Dispatch.h"

#include <atomic>
#include <functional>
#include <memory>
#include <string>

namespace host::drive {

/// Follows a small file: reads it again, off the main thread, whenever it changes. The folder is watched and
/// not the file, so that the file's creation and its replacement are seen. Main thread.
class FollowedFile : public std::enable_shared_from_this<FollowedFile> {
public:
    /// Delivers the result of a reading; called on the main thread.
    using Deliver = std::function<void()>;
    /// Reads the file on a queue of its own, and answers the function that delivers the result. It must hold
    /// no reference to objects that belong to the main thread.
    using Read = std::function<Deliver()>;

    /// Follows the file at a path; `queueName` names the queue.
    static std::shared_ptr<FollowedFile> follow(std::shared_ptr<platform::Dispatch> dispatch,
        std::string path, const std::string& queueName, Read read);

    /// Reads the file as after a change. Calls while a reading is waiting count as one, and a change during a
    /// reading leads to another one.
    void readAgain();

private:
    FollowedFile(std::shared_ptr<platform::Dispatch> dispatch, std::string path, const std::string& queueName,
        Read read);
    void begin();

    const std::shared_ptr<platform::Dispatch> _dispatch;
    const std::string _path;
    const Read _read;
    const std::shared_ptr<platform::Queue> _queue;
    const std::shared_ptr<std::atomic_bool> _readingWaits = std::make_shared<std::atomic_bool>(false);
    std::shared_ptr<FollowedFolder> _folder;
};

} // namespace host::drive
