// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/views/Button.h"
#include "platform/StorageOffers.h"
#include "screens/PlatformNames.h"

#include <memory>

namespace screens {

/// The target of a storage upgrade button.
class StorageUpgradeLink {
public:
    explicit StorageUpgradeLink(StorageOfferLink link)
        : _link(std::move(link))
    {
    }

    /// The value StorageOfferLink::actionUpgradeInApplication leaves the upgrade to the application.
    int action() const { return _link.action; }
    /// Performs the link's default action. Answers false when the link has none.
    bool performDefaultAction() const;

private:
    StorageOfferLink _link;
};

/// A button that leads to an offer of more storage. Main thread only.
class StorageUpgradeButton : public kit::Button {
public:
    static std::shared_ptr<StorageUpgradeButton> createButton();
    /// Answers whether the button should be shown for an offer, which is so when storage is running low.
    static bool shouldShowForOffer(const std::shared_ptr<const StorageOffer>& offer);

    StorageUpgradeButton();

    const std::shared_ptr<const StorageOffer>& offer() const { return _offer; }
    /// Sets the offer. Without one (null) the button has its plain title.
    void setOffer(std::shared_ptr<const StorageOffer> offer);
    /// Answers the offer's link, or a link that does nothing when there is no offer.
    StorageUpgradeLink link() const;

private:
    std::shared_ptr<const StorageOffer> _offer;
};

} // namespace screens
