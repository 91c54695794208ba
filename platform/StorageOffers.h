// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <memory>
#include <optional>
#include <string>

namespace platform {

/// What a storage offer's button leads to.
struct StorageOfferLink {
    /// The action code that leaves the upgrade flow to the application.
    static constexpr int actionUpgradeInApplication = 3;

    int action = 0;
    std::string target; ///< a URL
};

/// An offer of more storage for the account.
struct StorageOffer {
    int level = 0;
    bool storageIsLow = false;
    std::string buttonTitle;
    StorageOfferLink link;
    bool operator==(const StorageOffer& other) const
    {
        return level == other.level && storageIsLow == other.storageIsLow && buttonTitle == other.buttonTitle
            && link.action == other.link.action && link.target == other.link.target;
    }
};

/// The account's storage offer. Main thread. Notification::StorageOfferDidChange is posted when it changed.
class StorageOfferManager {
public:
    virtual ~StorageOfferManager() = default;
    /// True when it started to fetch the offer; it then arrives with the notification.
    virtual bool fetchOfferIfNeeded() = 0;
    virtual std::shared_ptr<const StorageOffer> currentOffer() const = 0;
    /// Performs a link's own default action; whether it had one.
    virtual bool performDefaultAction(const StorageOfferLink& link) = 0;
};

} // namespace platform
