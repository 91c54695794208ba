// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/browser/support/BrowserFixture.h"

#include "host/system/desktop/MimeTypeRegistry.h"
#include "host/system/desktop/TypePreviewSupport.h"
#include "host/system/listing/ThreadedFolderLister.h"
#include "host/system/texts/GettextLocalization.h"
#include "host/system/texts/IcuFormatters.h"
#include "host/system/texts/UserLocale.h"
#include "kit/controllers/AlertController.h"
#include "kit/controllers/Window.h"
#include "platform/Localization.h"
#include "preview/LookwellItemController.h"
#include "preview/PreviewDetailsViewController.h"
#include "screens/list/DocumentListController.h"
#include "tests/support/RecordingSharing.h"

namespace testing_support {

using kit::Window;
using screens::DocumentListController;

namespace {

std::shared_ptr<platform::Localization> englishTexts()
{
    return std::make_shared<host::system::GettextLocalization>(
        TRW_LOCALE_FOLDER, host::system::UserLocale{"en", "en_US"});
}

/// Answers a service of a set without owning it.
template <typename T>
std::shared_ptr<T> borrowed(T& service)
{
    return std::shared_ptr<T>(std::shared_ptr<void>(), &service);
}

} // namespace

BrowserFixture::BrowserFixture()
{
    cloud = std::make_shared<SimulatedCloud>(drive.cloud);
    const auto types = std::make_shared<host::system::MimeTypeRegistry>();
    platform::ServiceSet set;
    set.activityHandOver = drive.handOver;
    set.appRegistry = apps;
    set.characterData = borrowed(_driveServices.characterData());
    set.cloudDocumentService = cloud;
    set.dispatch = drive.dispatch;
    set.documentSharing = std::make_shared<RecordingSharing>();
    set.fileChanges = borrowed(_driveServices.fileChanges());
    set.fileCoordinator = borrowed(_driveServices.fileCoordinator());
    set.fileSystem = borrowed(_driveServices.fileSystem());
    set.folderLister = std::make_shared<host::system::ThreadedFolderLister>(drive.dispatch, types, "en_US");
    set.formatters = std::make_shared<host::system::IcuFormatters>("en_US", "UTC");
    set.imageLoader = borrowed(_driveServices.imageLoader());
    set.pagedDocumentOpener = borrowed(_driveServices.pagedDocumentOpener());
    set.textDecoder = borrowed(_driveServices.textDecoder());
    set.keyValueStore = borrowed(_driveServices.keyValueStore());
    set.keyedArchiver = borrowed(_driveServices.keyedArchiver());
    set.localization = englishTexts();
    set.nameSearch = borrowed(_driveServices.nameSearch());
    set.notificationCenter = drive.notifications;
    set.previewSupport = std::make_shared<host::system::TypePreviewSupport>(types);
    set.storageOfferManager = offers;
    set.typeRegistry = types;
    set.userDefaults = borrowed(_driveServices.userDefaults());
    platform::installServices(std::move(set));
}

BrowserFixture::~BrowserFixture()
{
    browser = nullptr;
    window = nullptr;
}

void BrowserFixture::launchWithoutListing()
{
    browser = std::make_shared<tarrow::NavController>();
    window = std::make_shared<Window>(platform::Rect{0, 0, 400, 800});
    window->setRootViewController(browser);
    window->makeKeyAndVisible();
}

void BrowserFixture::launch()
{
    launchWithoutListing();
    settle();
}

void BrowserFixture::post(platform::Notification notice)
{
    drive.notifications->post(notice);
    settle();
}

std::vector<std::string> BrowserFixture::stack() const
{
    std::vector<std::string> names;
    for (const auto& screen : browser->viewControllers()) {
        const auto list = std::dynamic_pointer_cast<DocumentListController>(screen);
        if (list)
            names.push_back(list->presentedURL() ? list->presentedURL()->lastPathComponent() : "");
        else if (std::dynamic_pointer_cast<tarrow::PreviewDetailsViewController>(screen))
            names.emplace_back("i");
        else
            names.emplace_back(std::dynamic_pointer_cast<tarrow::LookwellItemController>(screen) ? "*" : "-");
    }
    return names;
}

std::shared_ptr<kit::AlertController> BrowserFixture::alert() const
{
    return std::dynamic_pointer_cast<kit::AlertController>(browser->presentedViewController());
}

std::string BrowserFixture::itemsText(std::size_t count)
{
    return platform::localizedPlural(".DICT.ITEMS.%d", {static_cast<std::int64_t>(count)});
}

} // namespace testing_support
