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

/// An activity of another device of the account that the person may continue on this device.
struct ActivityOffer {
    /// Tells the device from the account's other devices; it is made of letters, digits and hyphens.
    std::string deviceIdentifier;
    /// The name by which the device's user knows it.
    std::string deviceName;
    /// What the device is doing. Only texts of its user information travel between devices.
    UserActivity activity;
    /// Names the activity's document on this device, which is here or promised.
    Url document;
    /// When the device last announced the activity, by that device's clock, in whole seconds.
    Date time;

    bool operator==(const ActivityOffer&) const = default;
};

/// Hands activities over between the devices of the account: what one device shows can be continued on
/// another.
class ActivityHandOver {
public:
    virtual ~ActivityHandOver() = default;

    /// Makes an activity this device's current one, in place of the one before. The other devices hear of it
    /// only when it is eligible for hand-off, and stop offering the one before. Any thread may call; the call
    /// never waits for the disk, and a failure to write is logged and not answered.
    virtual void becomeCurrent(const std::shared_ptr<const UserActivity>& activity) = 0;
    /// Withdraws the activity, so that the other devices stop offering it. The call does nothing when another
    /// object is the current activity by now. Any thread may call.
    virtual void resignCurrent(const std::shared_ptr<const UserActivity>& activity) = 0;

    /// Answers what the other devices offer now, the latest first; the list is empty when nobody is signed
    /// in. An activity is offered only while its document is on this device (here or promised) and is not
    /// what this device shows itself, and only while its device keeps renewing it: a device that was silent
    /// for 15 minutes is taken to be off. The answer is kept in memory and costs nothing;
    /// Notification::ActivityOffersDidChange is posted after every change of it. Main thread only.
    virtual std::vector<ActivityOffer> offers() const = 0;
};

} // namespace platform
