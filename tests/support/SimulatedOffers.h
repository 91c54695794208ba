// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/StorageOffers.h"

namespace testing_support {

/// Storage offers that the test chooses.
class SimulatedOffers : public platform::StorageOfferManager {
public:
    bool fetchStarts = false; ///< whether a request for the offer starts a fetch
    std::shared_ptr<const platform::StorageOffer> offer;
    bool hasDefaultAction = false;

    bool fetchOfferIfNeeded() override { return fetchStarts; }
    std::shared_ptr<const platform::StorageOffer> currentOffer() const override { return offer; }
    bool performDefaultAction(const platform::StorageOfferLink&) override { return hasDefaultAction; }

    static std::shared_ptr<platform::StorageOffer> make(int level, bool storageIsLow, int action = 3)
    {
        auto made = std::make_shared<platform::StorageOffer>();
        made->level = level;
        made->storageIsLow = storageIsLow;
        made->buttonTitle = "Upgrade";
        made->link.action = action;
        return made;
    }
};

} // namespace testing_support
