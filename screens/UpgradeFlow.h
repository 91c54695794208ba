// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/StorageOffers.h"
#include "screens/PlatformNames.h"

#include <memory>

namespace kit {
class ViewController;
} // namespace kit

namespace screens {

/// Leads from a storage offer to the page where the user can accept it. Main thread only.
class UpgradeFlow : public std::enable_shared_from_this<UpgradeFlow> {
public:
    /// Without an offer the flow does nothing.
    static std::shared_ptr<UpgradeFlow> initWithOffer(std::shared_ptr<const StorageOffer> offer);

    explicit UpgradeFlow(std::shared_ptr<const StorageOffer> offer)
        : _offer(std::move(offer))
    {
    }

    /// Shows the offer over a screen. The caller keeps the flow alive until the offer is dismissed.
    void beginWithPresentingViewController(const std::shared_ptr<kit::ViewController>& presenter);

private:
    void openPage(kit::ViewController& presenter);

    std::shared_ptr<const StorageOffer> _offer;
};

} // namespace screens
