// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/views/Button.h"
#include "platform/StorageOffers.h"
#include "screens/PlatformNames.h"

#include <memory>

namespace screens {

/// Where a storage upgrade button leads.
class StorageUpgradeLink {
public:
    explicit StorageUpgradeLink(StorageOfferLink link)
        : _link(std::move(link))
    {
    }

    /// StorageOfferLink::actionUpgradeInApplication leaves the upgrade to the application.
    int action() const { return _link.action; }
    /// Performs what the link does by itself; false when it does nothing by itself.
    bool performDefaultAction() const;

private:
    StorageOfferLink _link;
};

/// The button that leads to more storage. Main thread only.
class StorageUpgradeButton : public kit::Button {
public:
    static std::shared_ptr<StorageUpgradeButton> createButton();
    /// Whether the button should be shown for an offer: when storage is running low.
    static bool shouldShowForOffer(const std::shared_ptr<const StorageOffer>& offer);

    StorageUpgradeButton();

    const std::shared_ptr<const StorageOffer>& offer() const { return _offer; }
    /// Null: no offer, the button has its plain title.
    void setOffer(std::shared_ptr<const StorageOffer> offer);
    /// The offer's link; without an offer, one that does nothing.
    StorageUpgradeLink link() const;

private:
    std::shared_ptr<const StorageOffer> _offer;
};

} // namespace screens
