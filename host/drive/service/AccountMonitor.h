// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/DriveDependencies.h"
#include "host/drive/records/DriveLayout.h"
#include "host/drive/records/FollowedFile.h"
#include "platform/NotificationCenter.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace host::drive {

/// Watches the account's file and posts Notification::CloudIdentityDidChange when another account (or none)
/// is signed in. Writing the file again with the same identity is no change. Main thread; the file is read on
/// a queue of its own.
class AccountMonitor : public std::enable_shared_from_this<AccountMonitor> {
public:
    static std::shared_ptr<AccountMonitor> start(
        const DriveLayout& layout, const DriveDependencies& dependencies);

    /// The handler is called on the main thread after each change of the file, whatever changed in it.
    void onFileChanged(std::function<void()> handler) { _fileChanged = std::move(handler); }

    /// Reads the file and compares the identity, as after a change.
    void check() { _file->readAgain(); }

private:
    AccountMonitor(DriveLayout layout, const DriveDependencies& dependencies);

    void begin(const DriveDependencies& dependencies);
    void identityRead(std::optional<std::string> identity);

    DriveLayout _layout;
    std::shared_ptr<platform::NotificationCenter> _notifications;
    std::shared_ptr<FollowedFile> _file;
    std::function<void()> _fileChanged;
    std::optional<std::string> _identity;
};

} // namespace host::drive
