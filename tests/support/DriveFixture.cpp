// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/support/DriveFixture.h"

#include "host/drive/records/AccountRecord.h"
#include "host/drive/records/ItemFacts.h"
#include "host/drive/records/LinkRecords.h"
#include "host/previews/DocumentThumbnails.h"
#include "host/previews/PopplerDocuments.h"
#include "host/previews/UchardetDecoder.h"
#include "host/system/coordination/LocalFileCoordinator.h"
#include "host/system/desktop/GdkPixbufImageLoader.h"
#include "host/system/desktop/MimeTypeRegistry.h"
#include "host/system/desktop/TypePreviewSupport.h"
#include "host/system/files/JsonKeyedArchiver.h"
#include "host/system/files/JsonUserDefaults.h"
#include "host/system/files/PosixFileSystem.h"
#include "host/system/listing/ThreadedFolderLister.h"
#include "host/system/search/IndexedNameSearch.h"
#include "host/system/texts/GettextLocalization.h"
#include "host/system/texts/IcuFormatters.h"
#include "host/system/texts/UnicodeCharacterData.h"
#include "host/system/texts/UserLocale.h"

#include <glib.h>
#include <sys/xattr.h>

#include <algorithm>
#include <stdexcept>

namespace testing_support {

namespace {

using host::drive::DriveLayout;
using platform::Url;

const std::shared_ptr<host::system::MimeTypeRegistry>& types()
{
    // The process has one registry, because it reads the system's type database and answers from memory.
    static const auto registry = std::make_shared<host::system::MimeTypeRegistry>();
    return registry;
}

const std::shared_ptr<host::system::GettextLocalization>& englishTexts()
{
    static const auto texts = std::make_shared<host::system::GettextLocalization>(
        "/nonexistent", host::system::UserLocale{"en", "en_US"});
    return texts;
}

} // namespace

std::string contentOf(const std::string& path)
{
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

Url writeFile(const std::string& path, std::string_view content)
{
    std::filesystem::create_directories(std::filesystem::path(path).parent_path());
    std::ofstream file(path, std::ios::binary | std::ios::trunc);
    file.write(content.data(), static_cast<std::streamsize>(content.size()));
    if (!file.flush())
        throw std::runtime_error("cannot write " + path);
    return Url::fileURL(path);
}

DriveFixture::DriveFixture()
{
    const auto layout = DriveLayout::at(_folder.at("drive"));
    writeFile(layout.account(), host::drive::AccountRecord{"account-1", "Mira", {}}.toJson());
    for (const auto& name : {"Desktop", "Documents"})
        std::filesystem::create_directories(layout.defaultContainer() + '/' + name);
    std::filesystem::create_directories(layout.trash());

    auto& set = installed;
    set.dispatch = dispatch;
    set.notificationCenter = notifications;
    // Presenters answer on queues that only this thread runs.
    fileCoordinator =
        std::make_shared<host::system::LocalFileCoordinator>(host::system::LocalFileCoordinator::Settings{
            .lockFile = layout.coordination(), .beforeWaiting = [queues = std::weak_ptr(dispatch)] {
                if (const auto all = queues.lock())
                    all->runUntilIdle();
            }});
    set.characterData = std::make_shared<host::system::UnicodeCharacterData>();
    set.formatters = std::make_shared<host::system::IcuFormatters>("en_US", "UTC");
    set.textDecoder = std::make_shared<host::previews::UchardetDecoder>();
    set.pagedDocumentOpener = std::make_shared<host::previews::PopplerDocuments>();
    set.imageLoader = std::make_shared<host::system::GdkPixbufImageLoader>();
    set.localization = englishTexts();
    set.typeRegistry = types();
    set.previewSupport = std::make_shared<host::system::TypePreviewSupport>(set.typeRegistry);
    set.folderLister = std::make_shared<host::system::ThreadedFolderLister>(dispatch, types(), "en_US");
    set.nameSearch = std::make_shared<host::system::IndexedNameSearch>(
        dispatch, types(), host::system::IndexedNameSearch::Tags{host::drive::tagsAt, {"tag:", "Etikett:"}});
    set.keyedArchiver = std::make_shared<host::system::JsonKeyedArchiver>();
    set.userDefaults = std::make_shared<host::system::JsonUserDefaults>(layout.defaults(), *dispatch);
    host::drive::DriveDependencies dependencies{
        dispatch, notifications, set.typeRegistry, set.localization, set.linkOpener, fileCoordinator};
    cloud = host::drive::LocalCloudDocumentService::create(layout, dependencies,
        {{"en"}, _folder.at("thumbnails"), std::make_shared<host::previews::DocumentThumbnails>()});
    set.cloudDocumentService = cloud;
    handOver = host::drive::LocalActivityHandOver::create(cloud->layout(), dependencies, cloud);
    set.activityHandOver = handOver;
    set.fileChanges = cloud->fileChanges();
    set.trash = cloud->trash();
    set.fileSystem = std::make_shared<host::system::PosixFileSystem>();
    set.storageOfferManager = cloud->storageOffers();
    set.keyValueStore = cloud->keyValueStore();
    set.fileCoordinator = fileCoordinator;
    platform::installServices(set);
}

DriveFixture::~DriveFixture()
{
    dispatch->end();
    platform::installServices({});
    platform::installLogSink(nullptr);
}

Url DriveFixture::url(std::string_view relativePath) const
{
    return Url::fileURL(layout().defaultContainer() + '/' + std::string(relativePath));
}

Url DriveFixture::writeDocument(std::string_view relativePath, std::string_view content) const
{
    return writeFile(url(relativePath).path(), content);
}

Url DriveFixture::makeFolder(std::string_view relativePath) const
{
    const auto location = url(relativePath);
    std::filesystem::create_directories(location.path());
    return location;
}

Url DriveFixture::writePromise(std::string_view relativePath, const host::drive::PromiseRecord& promise) const
{
    const auto location = url(relativePath);
    writeFile(host::drive::PromiseRecord::pathFor(location.path()), promise.toJson());
    return location;
}

Url DriveFixture::writeLink(std::string_view relativePath, const std::string& target) const
{
    const auto location = url(relativePath);
    std::filesystem::create_directories(std::filesystem::path(location.path()).parent_path());
    std::filesystem::create_symlink(target, location.path());
    return location;
}

Url DriveFixture::writeReference(
    std::string_view relativePath, const std::string& container, const std::string& path) const
{
    return writeDocument(relativePath, host::drive::referenceJson(container, path));
}

Url DriveFixture::writeAlias(std::string_view relativePath, const std::string& target) const
{
    return writeDocument(relativePath, host::drive::aliasJson(target));
}

Url DriveFixture::makeContainer(
    const std::string& identifier, const host::drive::ContainerRecord& description) const
{
    const auto documents = layout().containerDocuments(identifier);
    std::filesystem::create_directories(documents);
    writeFile(layout().containerDescription(identifier), description.toJson());
    return Url::fileURL(documents, platform::PathKind::Directory);
}

void DriveFixture::mark(const Url& url, const char* attribute, std::string_view value) const
{
    if (::lsetxattr(url.path().c_str(), attribute, value.data(), value.size(), 0) != 0)
        throw std::runtime_error("cannot set an attribute of " + url.path());
}

bool DriveFixture::hasTraces() const
{
    return std::ranges::any_of(
        std::filesystem::recursive_directory_iterator(layout().home()), [](const auto& entry) {
            const auto name = entry.path().filename().string();
            return name.starts_with(".trw") || name.ends_with(".place");
        });
}

void DriveFixture::signIn(const std::string& name) const
{
    writeFile(
        layout().account(), host::drive::AccountRecord{host::drive::localIdentity(name), name, {}}.toJson());
}

void DriveFixture::signOut() const
{
    std::filesystem::remove(layout().account());
}

void DriveFixture::settle() const
{
    while (g_main_context_iteration(nullptr, FALSE)) { }
    dispatch->runUntilIdle();
}

} // namespace testing_support
