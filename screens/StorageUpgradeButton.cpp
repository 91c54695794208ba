// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/StorageUpgradeButton.h"

#include "platform/Localization.h"
#include "platform/Services.h"

#include <utility>

namespace screens {

bool StorageUpgradeLink::performDefaultAction() const
{
    return services().storageOfferManager().performDefaultAction(_link);
}

std::shared_ptr<StorageUpgradeButton> StorageUpgradeButton::createButton()
{
    return std::make_shared<StorageUpgradeButton>();
}

bool StorageUpgradeButton::shouldShowForOffer(const std::shared_ptr<const StorageOffer>& offer)
{
    return offer && offer->storageIsLow;
}

StorageUpgradeButton::StorageUpgradeButton()
    : kit::Button(localized("Upgrade Storage"))
{
    setTitleFont(kit::Font::preferred(kit::TextStyle::Caption2));
}

void StorageUpgradeButton::setOffer(std::shared_ptr<const StorageOffer> offer)
{
    _offer = std::move(offer);
    const bool hasTitle = _offer && !_offer->buttonTitle.empty();
    setTitle(hasTitle ? _offer->buttonTitle : localized("Upgrade Storage"));
}

StorageUpgradeLink StorageUpgradeButton::link() const
{
    return StorageUpgradeLink(_offer ? _offer->link : StorageOfferLink());
}

} // namespace screens
