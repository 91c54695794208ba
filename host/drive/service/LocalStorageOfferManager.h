// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/DriveDependencies.h"
#include "host/drive/records/DriveLayout.h"
#include "platform/Dispatch.h"
#include "platform/LinkOpener.h"
#include "platform/NotificationCenter.h"
#include "platform/StorageOffers.h"

namespace host::drive {

/// The storage offer in the account's file. Storage counts as low when the offer says so, or when less than a
/// tenth of the file system is free.
class LocalStorageOfferManager : public platform::StorageOfferManager,
                                 public std::enable_shared_from_this<LocalStorageOfferManager> {
public:
    static std::shared_ptr<LocalStorageOfferManager> create(
        const DriveLayout& layout, const DriveDependencies& dependencies);

    bool fetchOfferIfNeeded() override;
    std::shared_ptr<const platform::StorageOffer> currentOffer() const override { return _offer; }
    /// Opens a web address with the user's browser. Answers false for every other target, and for the action
    /// that the application itself performs.
    bool performDefaultAction(const platform::StorageOfferLink& link) override;

    /// Reads the offer again if it was read before.
    void accountFileChanged();

private:
    LocalStorageOfferManager(DriveLayout layout, const DriveDependencies& dependencies);

    void fetch();
    void offerRead(std::optional<platform::StorageOffer> offer);

    enum class State { NeverRead, Reading, Read };

    DriveLayout _layout;
    std::shared_ptr<platform::Dispatch> _dispatch;
    std::shared_ptr<platform::NotificationCenter> _notifications;
    std::shared_ptr<platform::LinkOpener> _linkOpener;
    std::shared_ptr<platform::Queue> _queue;
    std::shared_ptr<const platform::StorageOffer> _offer;
    State _state = State::NeverRead;
};

} // namespace host::drive
