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
class FileChanges;
class FileCoordinator;
class FileSystem;
class FolderLister;
class Formatters;
class ImageLoader;
class KeyValueStore;
class KeyedArchiver;
class LauncherShortcuts;
class LinkOpener;
class Localization;
class NameSearch;
class NotificationCenter;
class PagedDocumentOpener;
class PreviewSupport;
class StorageOfferManager;
class TextDecoder;
class Trash;
class TypeRegistry;
class UserDefaults;

/// The platform's services, each behind the abstract class of its header. A service that is not installed is
/// null: main installs all of them, and a test only those that it needs.
struct ServiceSet {
    /// What the account's devices show, so that another can continue it.
    std::shared_ptr<ActivityHandOver> activityHandOver;
    /// The apps of this machine and the documents that they open.
    std::shared_ptr<AppRegistry> appRegistry;
    /// Classes of characters, for names.
    std::shared_ptr<CharacterData> characterData;
    /// The drive: its account, its items and its containers.
    std::shared_ptr<CloudDocumentService> cloudDocumentService;
    /// Queues, timers and the clock.
    std::shared_ptr<Dispatch> dispatch;
    /// Clipboard, mail, file manager, file chooser and printer.
    std::shared_ptr<DocumentSharing> documentSharing;
    /// Changes of the drive's items.
    std::shared_ptr<FileChanges> fileChanges;
    /// Turns of readers and writers, within the process and between processes.
    std::shared_ptr<FileCoordinator> fileCoordinator;
    /// Questions to the file system.
    std::shared_ptr<FileSystem> fileSystem;
    /// Sorted lists of folders that follow their changes.
    std::shared_ptr<FolderLister> folderLister;
    /// Numbers, sizes and dates for people.
    std::shared_ptr<Formatters> formatters;
    /// Decoding of picture files.
    std::shared_ptr<ImageLoader> imageLoader;
    /// Small values that the account's devices share.
    std::shared_ptr<KeyValueStore> keyValueStore;
    /// Values as data that can be stored.
    std::shared_ptr<KeyedArchiver> keyedArchiver;
    /// What the launcher offers of this program.
    std::shared_ptr<LauncherShortcuts> launcherShortcuts;
    /// The person's web browser.
    std::shared_ptr<LinkOpener> linkOpener;
    /// Texts in the user's language.
    std::shared_ptr<Localization> localization;
    /// The search through the names of the drive.
    std::shared_ptr<NameSearch> nameSearch;
    /// Notices that any part of the program may observe.
    std::shared_ptr<NotificationCenter> notificationCenter;
    /// Documents of pages, to be read and changed.
    std::shared_ptr<PagedDocumentOpener> pagedDocumentOpener;
    /// Which documents the quick preview can show.
    std::shared_ptr<PreviewSupport> previewSupport;
    /// Offers of more storage for the account.
    std::shared_ptr<StorageOfferManager> storageOfferManager;
    /// Texts in the encodings from before Unicode.
    std::shared_ptr<TextDecoder> textDecoder;
    /// What was removed and can come back.
    std::shared_ptr<Trash> trash;
    /// The types of documents.
    std::shared_ptr<TypeRegistry> typeRegistry;
    /// Small values that this device keeps.
    std::shared_ptr<UserDefaults> userDefaults;
};

/// Gives access to the installed services. The references stay valid until the next installServices(). Asking
/// for a service that is not installed is a programming error.
class Services {
public:
    /// Takes over a set; only installServices() needs this.
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
    FileChanges& fileChanges() const { return *_set.fileChanges; }
    FileCoordinator& fileCoordinator() const { return *_set.fileCoordinator; }
    FileSystem& fileSystem() const { return *_set.fileSystem; }
    FolderLister& folderLister() const { return *_set.folderLister; }
    Formatters& formatters() const { return *_set.formatters; }
    ImageLoader& imageLoader() const { return *_set.imageLoader; }
    KeyValueStore& keyValueStore() const { return *_set.keyValueStore; }
    KeyedArchiver& keyedArchiver() const { return *_set.keyedArchiver; }
    LauncherShortcuts& launcherShortcuts() const { return *_set.launcherShortcuts; }
    LinkOpener& linkOpener() const { return *_set.linkOpener; }
    Localization& localization() const { return *_set.localization; }
    NameSearch& nameSearch() const { return *_set.nameSearch; }
    NotificationCenter& notificationCenter() const { return *_set.notificationCenter; }
    PagedDocumentOpener& pagedDocumentOpener() const { return *_set.pagedDocumentOpener; }
    PreviewSupport& previewSupport() const { return *_set.previewSupport; }
    StorageOfferManager& storageOfferManager() const { return *_set.storageOfferManager; }
    TextDecoder& textDecoder() const { return *_set.textDecoder; }
    Trash& trash() const { return *_set.trash; }
    TypeRegistry& typeRegistry() const { return *_set.typeRegistry; }
    UserDefaults& userDefaults() const { return *_set.userDefaults; }

private:
    ServiceSet _set;
};

/// The installed services, for every part of the program. Any thread may ask, and use each service as its
/// header says.
const Services& services();
/// Installs a set in place of the one before. It must be called while nothing else uses the services: main
/// does so once before the loop runs, a test fixture before and after each test.
void installServices(ServiceSet set);

} // namespace platform
