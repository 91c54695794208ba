// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <memory>

namespace platform {

class ActivityHandOver;
class AppRegistry;
class CharacterData;
class CloudDocumentService;
class Dispatch;
class DocumentSharing;
class FileCoordinator;
class FileSystem;
class FolderLister;
class Formatters;
class ImageLoader;
class KeyValueStore;
class KeyedArchiver;
class LinkOpener;
class Localization;
class NameSearch;
class NotificationCenter;
class PagedDocumentOpener;
class PreviewSupport;
class StorageOfferManager;
class TextDecoder;
class TypeRegistry;
class UserDefaults;

/// The installed platform services. A service that is not installed is null; main installs all of them.
struct ServiceSet {
    std::shared_ptr<ActivityHandOver> activityHandOver;
    std::shared_ptr<AppRegistry> appRegistry;
    std::shared_ptr<CharacterData> characterData;
    std::shared_ptr<CloudDocumentService> cloudDocumentService;
    std::shared_ptr<Dispatch> dispatch;
    std::shared_ptr<DocumentSharing> documentSharing;
    std::shared_ptr<FileCoordinator> fileCoordinator;
    std::shared_ptr<FileSystem> fileSystem;
    std::shared_ptr<FolderLister> folderLister;
    std::shared_ptr<Formatters> formatters;
    std::shared_ptr<ImageLoader> imageLoader;
    std::shared_ptr<KeyValueStore> keyValueStore;
    std::shared_ptr<KeyedArchiver> keyedArchiver;
    std::shared_ptr<LinkOpener> linkOpener;
    std::shared_ptr<Localization> localization;
    std::shared_ptr<NameSearch> nameSearch;
    std::shared_ptr<NotificationCenter> notificationCenter;
    std::shared_ptr<PagedDocumentOpener> pagedDocumentOpener;
    std::shared_ptr<PreviewSupport> previewSupport;
    std::shared_ptr<StorageOfferManager> storageOfferManager;
    std::shared_ptr<TextDecoder> textDecoder;
    std::shared_ptr<TypeRegistry> typeRegistry;
    std::shared_ptr<UserDefaults> userDefaults;
};

/// Access to the installed services. The references stay valid until the next installServices().
class Services {
public:
    explicit Services(ServiceSet set)
        : _set(std::move(set))
    {
    }

    ActivityHandOver& activityHandOver() const { return *_set.activityHandOver; }
    AppRegistry& appRegistry() const { return *_set.appRegistry; }
    CharacterData& characterData() const { return *_set.characterData; }
    CloudDocumentService& cloudDocumentService() const { return *_set.cloudDocumentService; }
    Dispatch& dispatch() const { return *_set.dispatch; }
    DocumentSharing& documentSharing() const { return *_set.documentSharing; }
    FileCoordinator& fileCoordinator() const { return *_set.fileCoordinator; }
    FileSystem& fileSystem() const { return *_set.fileSystem; }
    FolderLister& folderLister() const { return *_set.folderLister; }
    Formatters& formatters() const { return *_set.formatters; }
    ImageLoader& imageLoader() const { return *_set.imageLoader; }
    KeyValueStore& keyValueStore() const { return *_set.keyValueStore; }
    KeyedArchiver& keyedArchiver() const { return *_set.keyedArchiver; }
    LinkOpener& linkOpener() const { return *_set.linkOpener; }
    Localization& localization() const { return *_set.localization; }
    NameSearch& nameSearch() const { return *_set.nameSearch; }
    NotificationCenter& notificationCenter() const { return *_set.notificationCenter; }
    PagedDocumentOpener& pagedDocumentOpener() const { return *_set.pagedDocumentOpener; }
    PreviewSupport& previewSupport() const { return *_set.previewSupport; }
    StorageOfferManager& storageOfferManager() const { return *_set.storageOfferManager; }
    TextDecoder& textDecoder() const { return *_set.textDecoder; }
    TypeRegistry& typeRegistry() const { return *_set.typeRegistry; }
    UserDefaults& userDefaults() const { return *_set.userDefaults; }

private:
    ServiceSet _set;
};

/// The installed set. Install before use; main does so once, a test fixture for each test.
const Services& services();
void installServices(ServiceSet set);

} // namespace platform
