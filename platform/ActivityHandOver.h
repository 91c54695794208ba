// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Date.h"
#include "platform/Url.h"
#include "platform/UserActivity.h"

#include <memory>
#include <string>
#include <vector>

namespace platform {

/// What another device of the account is doing and may be gone on with here.
struct ActivityOffer {
    std::string deviceIdentifier;
    std::string deviceName; ///< as its user knows it
    UserActivity activity;
    Url document; ///< where the activity's document lies on this device
    Date time; ///< when the device last said so

    bool operator==(const ActivityOffer&) const = default;
};

/// Hands activities over between the devices of the account.
class ActivityHandOver {
public:
    virtual ~ActivityHandOver() = default;

    /// Makes an activity this device's current one, in place of the one before. Other devices are told of it
    /// when it is eligible. Any thread; never waits for the disk.
    virtual void becomeCurrent(const std::shared_ptr<const UserActivity>& activity) = 0;
    /// Takes the activity back; nothing when it is not the current one. Any thread.
    virtual void resignCurrent(const std::shared_ptr<const UserActivity>& activity) = 0;

    /// What the other devices offer now, the latest first; only documents that are on this device, and
    /// nothing that its device did not renew for long. Notification::ActivityOffersDidChange tells of every
    /// change. Main thread.
    virtual std::vector<ActivityOffer> offers() const = 0;
};

} // namespace platform
