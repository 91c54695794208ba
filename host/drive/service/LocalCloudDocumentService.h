// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/LocalCloudStore.h"
#include "host/drive/records/DriveDependencies.h"
#include "host/drive/service/AccountMonitor.h"
#include "host/drive/service/DriveUpkeep.h"
#include "host/drive/service/IndexedItemChanges.h"
#include "host/drive/service/IndexedTrash.h"
#include "host/drive/service/LocalAccount.h"
#include "host/drive/service/LocalCloudItems.h"
#include "host/drive/service/LocalContainers.h"
#include "host/drive/service/LocalKeyValueStore.h"
#include "host/drive/service/LocalPromisedItems.h"
#include "host/drive/service/LocalStorageOfferManager.h"
#include "host/drive/service/ThumbnailCache.h"
#include "platform/CloudDocumentService.h"

namespace host::drive {

/// The cloud document service for a folder on this machine. Make and destroy it on the main thread.
class LocalCloudDocumentService : public platform::CloudDocumentService,
                                  public platform::SecurityScopedAccess {
public:
    struct Settings {
        std::vector<std::string> languages; ///< of the containers' names, the preferred language first
        std::string thumbnailFolder = ThumbnailCache::sharedFolder();
        std::shared_ptr<const platform::ThumbnailMaker> thumbnailMaker = {}; ///< null: only pictures get one
        /// Says when the drive is put right after programs that were killed: before create() answers, or in
        /// the background, so that nothing waits for it.
        enum class PutRight : std::uint8_t { First, Beside } putRight = PutRight::First;
    };

    /// Creates the drive's home folder when it is missing, and begins to watch the account.
    static std::shared_ptr<LocalCloudDocumentService> create(
        const DriveLayout& layout, const DriveDependencies& dependencies, const Settings& settings);

    const DriveLayout& layout() const { return _layout; }
    /// Answers the part that changes the drive's items.
    std::shared_ptr<platform::FileChanges> fileChanges() const { return _itemChanges; }
    /// Answers the drive's trash.
    std::shared_ptr<platform::Trash> trash() const { return _trash; }
    /// The account's storage offer, which is read from the account's file as well.
    const std::shared_ptr<LocalStorageOfferManager>& storageOffers() const { return _storageOffers; }
    /// The values that the account's devices share.
    const std::shared_ptr<LocalKeyValueStore>& keyValueStore() const { return _keyValueStore; }

    platform::CloudAccount& account() override { return _account; }
    platform::PromisedItems& promisedItems() override { return _promisedItems; }
    platform::DocumentContainers& containers() override { return *_containers; }
    platform::CloudItems& items() override { return _items; }
    platform::DocumentIdentifiers& documentIdentifiers() override { return *_identifiers; }
    platform::SecurityScopedAccess& securityScopedAccess() override { return *this; }
    bool isPuttingRight() const override { return _upkeep->isPuttingRight(); }

    // The user may access everything of the local store at any time, so no permission has to be requested.
    bool startAccessing(const platform::Url&) override { return false; }
    void stopAccessing(const platform::Url&) override { }

private:
    LocalCloudDocumentService(
        const DriveLayout& layout, const DriveDependencies& dependencies, const Settings& settings);

    DriveLayout _layout;
    LocalAccount _account;
    std::shared_ptr<LocalCloudStore> _store;
    std::shared_ptr<DriveUpkeep> _upkeep;
    std::shared_ptr<LocalDocumentIdentifiers> _identifiers;
    std::shared_ptr<IndexedItemChanges> _itemChanges;
    std::shared_ptr<IndexedTrash> _trash;
    std::shared_ptr<LocalContainers> _containers;
    LocalPromisedItems _promisedItems;
    LocalCloudItems _items;
    std::shared_ptr<LocalStorageOfferManager> _storageOffers;
    std::shared_ptr<LocalKeyValueStore> _keyValueStore;
    std::shared_ptr<AccountMonitor> _monitor;
};

} // namespace host::drive
