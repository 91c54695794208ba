// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/ActivityRecord.h"
#include "host/drive/records/DriveDependencies.h"
#include "host/drive/records/DriveLayout.h"
#include "host/drive/records/FollowedFolder.h"
#include "host/drive/service/ActivityPublication.h"
#include "platform/ActivityHandOver.h"
#include "platform/Error.h"
#include "platform/NotificationCenter.h"

#include <memory>
#include <vector>

namespace platform {
class CloudDocumentService;
}

namespace host::drive {

/// Hands activities over by small files in the account's folder, one for each device. ActivityPublication
/// keeps this device's file. The activity in another device's file is offered while it is recent, belongs to
/// the same account, and its document exists here. Make and destroy it on the main thread.
class LocalActivityHandOver : public platform::ActivityHandOver,
                              public std::enable_shared_from_this<LocalActivityHandOver> {
public:
    using Activity = ActivityPublication::Activity;

    /// At most so many devices' files are read.
    static constexpr std::size_t mostDevices = 64;

    /// `cloud` finds the documents of the offers.
    static std::shared_ptr<LocalActivityHandOver> create(const DriveLayout& layout,
        const DriveDependencies& dependencies, std::shared_ptr<platform::CloudDocumentService> cloud);

    void becomeCurrent(const Activity& activity) override { _publication->becomeCurrent(activity); }
    void resignCurrent(const Activity& activity) override { _publication->resignCurrent(activity); }
    std::vector<platform::ActivityOffer> offers() const override { return _offers; }

private:
    using Records = std::vector<ActivityRecord>;

    LocalActivityHandOver(const DriveLayout& layout, const DriveDependencies& dependencies,
        std::shared_ptr<platform::CloudDocumentService> cloud);

    void begin();
    void readAgain();
    void recordsRead(const Records& records);
    void documentDecided(
        unsigned reading, const ActivityRecord& record, const platform::Result<platform::Url>& document);
    void readingEnded();
    void readAgainWhenOneIsOld();

    DriveLayout _layout;
    std::shared_ptr<platform::Dispatch> _dispatch;
    std::shared_ptr<platform::NotificationCenter> _notifications;
    std::shared_ptr<platform::CloudDocumentService> _cloud;
    std::shared_ptr<platform::Queue> _queue;
    std::shared_ptr<ActivityPublication> _publication;
    std::shared_ptr<FollowedFolder> _folder;
    platform::Observation _identity;
    std::vector<platform::ActivityOffer> _offers, _found;
    std::size_t _undecided = 0; ///< records of the latest reading whose documents are still being looked up
    unsigned _reading = 0; ///< number of the latest reading; results of an older one are dropped
    bool _readingWaits = false, _readAgain = false;
};

} // namespace host::drive
