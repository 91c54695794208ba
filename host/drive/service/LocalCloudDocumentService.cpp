// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/service/LocalCloudDocumentService.h"

#include "platform/NotificationCenter.h"
#include "platform/TypeRegistry.h"
#include "platform/Url.h"
#include "platform/Weakly.h"

namespace host::drive {

namespace {

/// Answers the function that says whether a folder's name is a package's.
LocalItemChanges::IsPackage isPackageBy(const std::shared_ptr<platform::TypeRegistry>& types)
{
    return [types](const std::string& name) {
        const auto type = types->typeForExtension(platform::Url::fileURL('/' + name).pathExtension());
        return type && types->conformsTo(*type, platform::typeIdentifier::package);
    };
}

} // namespace

std::shared_ptr<LocalCloudDocumentService> LocalCloudDocumentService::create(
    const DriveLayout& layout, const DriveDependencies& dependencies, const Settings& settings)
{
    return std::shared_ptr<LocalCloudDocumentService>(
        new LocalCloudDocumentService(layout.prepare(), dependencies, settings));
}

LocalCloudDocumentService::LocalCloudDocumentService(
    const DriveLayout& layout, const DriveDependencies& dependencies, const Settings& settings)
    : _layout(layout)
    , _account(layout)
    , _store(std::make_shared<LocalCloudStore>(layout))
    , _upkeep(std::make_shared<DriveUpkeep>(layout, _store, dependencies.dispatch))
    , _identifiers(LocalDocumentIdentifiers::create(layout, dependencies.dispatch))
    , _itemChanges(std::make_shared<IndexedItemChanges>(
          layout, _store, _identifiers, isPackageBy(dependencies.typeRegistry)))
    , _trash(IndexedTrash::create(layout, _itemChanges, _store, _identifiers, dependencies))
    , _containers(std::make_shared<LocalContainers>(layout, settings.languages, _itemChanges))
    , _promisedItems(layout,
          ItemAttributes(dependencies.typeRegistry, _containers, dependencies.localization,
              layout.defaultContainerURL()),
          std::make_shared<ThumbnailCache>(settings.thumbnailFolder, settings.thumbnailMaker), _identifiers)
    , _items(layout, _identifiers, _store, dependencies)
    , _storageOffers(LocalStorageOfferManager::create(layout, dependencies))
    , _keyValueStore(LocalKeyValueStore::create(layout, dependencies))
    , _monitor(AccountMonitor::start(layout, dependencies))
{
    _store->onRelease(platform::weakly(_upkeep, &DriveUpkeep::contentReleased));
    _upkeep->onPuttingRight([center = dependencies.notificationCenter] {
        center->post(platform::Notification::PuttingRightDidChange);
    });
    if (settings.putRight == Settings::PutRight::Beside)
        _upkeep->putRightBeside();
    else
        _upkeep->putRight();
    _monitor->onFileChanged(platform::weakly(_storageOffers, &LocalStorageOfferManager::accountFileChanged));
}

} // namespace host::drive
