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

    int action = 0; ///< the service's number for what the button does
    std::string target; ///< the URL of the page that the action concerns; it need not be valid
};

/// An offer of more storage for the account.
struct StorageOffer {
    int level = 0; ///< the service's own number for what it offers; only the log shows it
    bool storageIsLow = false; ///< the offer says so, or less than a tenth of the space is free
    std::string buttonTitle; ///< in the user's language
    StorageOfferLink link;
    bool operator==(const StorageOffer& other) const
    {
        return level == other.level && storageIsLow == other.storageIsLow && buttonTitle == other.buttonTitle
            && link.action == other.link.action && link.target == other.link.target;
    }
};

/// The account's storage offer. Main thread only. Notification::StorageOfferDidChange is posted on the main
/// thread when there is another offer than before, or none any more.
class StorageOfferManager {
public:
    virtual ~StorageOfferManager() = default;
    /// Fetches the offer in the background, unless it was fetched already. It answers true while a fetch is
    /// under way: the offer then arrives with the notification, which does not come when there is none. It
    /// answers false when currentOffer() is up to date.
    virtual bool fetchOfferIfNeeded() = 0;
    /// Answers the offer that was fetched last; null before that, and when the account has none.
    virtual std::shared_ptr<const StorageOffer> currentOffer() const = 0;
    /// Performs a link's own default action, opening its page in the web browser, and answers whether the
    /// link has one. It answers false for actionUpgradeInApplication and for a target that is no web page.
    /// Whether the page opens is not waited for; a failure is logged.
    virtual bool performDefaultAction(const StorageOfferLink& link) = 0;
};

} // namespace platform
