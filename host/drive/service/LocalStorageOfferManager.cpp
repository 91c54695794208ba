// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/service/LocalStorageOfferManager.h"

#include "host/drive/records/AccountRecord.h"
#include "host/drive/records/StorageSpace.h"
#include "platform/Log.h"
#include "platform/Url.h"
#include "platform/Weakly.h"

#include <utility>

namespace host::drive {

namespace {

using platform::StorageOffer;
using platform::weakly;

std::optional<StorageOffer> readOffer(const DriveLayout& layout)
{
    const auto account = AccountRecord::read(layout);
    auto offer = account ? account->storageOffer : std::nullopt;
    if (!offer || offer->storageIsLow)
        return offer;
    const auto space = StorageSpace::of(layout.home());
    offer->storageIsLow = space && space->isLow();
    return offer;
}

} // namespace

std::shared_ptr<LocalStorageOfferManager> LocalStorageOfferManager::create(
    const DriveLayout& layout, const DriveDependencies& dependencies)
{
    return std::shared_ptr<LocalStorageOfferManager>(new LocalStorageOfferManager(layout, dependencies));
}

LocalStorageOfferManager::LocalStorageOfferManager(DriveLayout layout, const DriveDependencies& dependencies)
    : _layout(std::move(layout))
    , _dispatch(dependencies.dispatch)
    , _notifications(dependencies.notificationCenter)
    , _linkOpener(dependencies.linkOpener)
    , _queue(_dispatch->makeSerialQueue("TarrowDriveAppID.storageoffer"))
{
}

bool LocalStorageOfferManager::fetchOfferIfNeeded()
{
    if (_state == State::Read)
        return false;
    if (_state == State::NeverRead)
        fetch();
    return true;
}

void LocalStorageOfferManager::accountFileChanged()
{
    if (_state != State::NeverRead)
        fetch();
}

void LocalStorageOfferManager::fetch()
{
    if (_state == State::NeverRead)
        _state = State::Reading;
    _queue->async([weak = weak_from_this(), layout = _layout, main = _dispatch->mainQueue()] {
        main->async(weakly(weak, &LocalStorageOfferManager::offerRead, readOffer(layout)));
    });
}

void LocalStorageOfferManager::offerRead(std::optional<StorageOffer> offer)
{
    _state = State::Read;
    if (offer ? _offer && *_offer == *offer : !_offer)
        return;
    _offer = offer ? std::make_shared<const StorageOffer>(std::move(*offer)) : nullptr;
    _notifications->post(platform::Notification::StorageOfferDidChange);
}

bool LocalStorageOfferManager::performDefaultAction(const platform::StorageOfferLink& link)
{
    static constexpr platform::Operation op{"-[LocalStorageOfferManager performDefaultAction:]"};
    const auto target = platform::Url::parse(link.target);
    const bool isPage = target && (target->scheme() == "https" || target->scheme() == "http");
    if (link.action == platform::StorageOfferLink::actionUpgradeInApplication || !isPage || !_linkOpener)
        return false;
    _linkOpener->openLink(link.target, [text = link.target](const std::optional<platform::Error>& error) {
        if (error)
            op.error("Cannot open %@: %@", text, *error);
    });
    return true;
}

} // namespace host::drive
