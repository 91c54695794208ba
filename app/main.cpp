// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "app/AppDelegate.h"
#include "app/BuildDate.h"
#include "host/drive/records/ItemFacts.h"
#include "host/drive/service/LocalActivityHandOver.h"
#include "host/drive/service/LocalCloudDocumentService.h"
#include "host/gtk/app/DesktopSharing.h"
#include "host/gtk/app/DesktopShortcuts.h"
#include "host/gtk/app/LaunchContext.h"
#include "host/gtk/app/MakeApplication.h"
#include "host/gtk/preview/PreviewModule.h"
#include "host/system/coordination/LocalFileCoordinator.h"
#include "host/system/desktop/GdkPixbufImageLoader.h"
#include "host/system/desktop/GioAppRegistry.h"
#include "host/system/desktop/GioLinkOpener.h"
#include "host/system/desktop/JournalLogSink.h"
#include "host/system/desktop/MimeTypeRegistry.h"
#include "host/system/desktop/TypePreviewSupport.h"
#include "host/system/drawing/CairoImageContext.h"
#include "host/system/files/JsonKeyedArchiver.h"
#include "host/system/files/JsonUserDefaults.h"
#include "host/system/files/PosixFileSystem.h"
#include "host/system/listing/ThreadedFolderLister.h"
#include "host/system/queues/GLibDispatch.h"
#include "host/system/search/IndexedNameSearch.h"
#include "host/system/texts/GettextLocalization.h"
#include "host/system/texts/IcuFormatters.h"
#include "host/system/texts/Translate.h"
#include "host/system/texts/UnicodeCharacterData.h"
#include "host/system/texts/UserLocale.h"
#include "items/FileUtils.h"
#include "kit/values/ImageContext.h"
#include "platform/Log.h"
#include "platform/NotificationCenter.h"
#include "platform/Services.h"

#include <filesystem>
#include <memory>
#include <string>
#include <system_error>

namespace {

using host::drive::DriveLayout;
using host::drive::LocalActivityHandOver;
using host::drive::LocalCloudDocumentService;
using host::system::UserLocale;
using platform::ServiceSet;

/// Answers the program's own file, also when it was started by its bare name.
std::string executablePath(const char* firstArgument)
{
    std::error_code problem;
    const auto path = std::filesystem::read_symlink("/proc/self/exe", problem);
    return problem ? std::string(firstArgument ? firstArgument : "") : path.string();
}

/// Answers the folder of the catalogues: beside the program in the build tree, else where they are installed.
std::string localeFolder(const std::filesystem::path& executable)
{
    const auto built = executable.parent_path() / "po" / "locale";
    std::error_code problem;
    return std::filesystem::exists(built, problem) ? built
                                                   : executable.parent_path().parent_path() / "share/locale";
}

/// The module's name holds the version, because a module of another version has other classes than this
/// program.
constexpr auto moduleName = "previews-" TRW_VERSION ".so";

/// Answers the file of the preview module: in the build tree, else where it is installed.
std::string previewModule(const std::filesystem::path& executable)
{
    const auto built = executable.parent_path() / "modules" / moduleName;
    std::error_code problem;
    return std::filesystem::exists(built, problem)
        ? built
        : executable.parent_path().parent_path() / TRW_MODULE_FOLDER / moduleName;
}

/// Answers the services that need nothing of the drive.
ServiceSet systemServices(const std::string& executable, const UserLocale& locale,
    const std::shared_ptr<host::gtk::PreviewModule>& previews)
{
    ServiceSet set;
    set.localization = std::make_shared<host::system::GettextLocalization>(localeFolder(executable), locale);
    set.formatters = std::make_shared<host::system::IcuFormatters>(locale.formats);
    set.characterData = std::make_shared<host::system::UnicodeCharacterData>();
    set.dispatch = std::make_shared<host::system::GLibDispatch>();
    set.notificationCenter = std::make_shared<platform::NotificationCenter>();
    const auto types = std::make_shared<host::system::MimeTypeRegistry>();
    set.typeRegistry = types;
    set.appRegistry = std::make_shared<host::system::GioAppRegistry>(
        types, "app.tarrow.Drive", host::gtk::makeLaunchContext);
    set.documentSharing = std::make_shared<host::gtk::DesktopSharing>(types, previews);
    set.folderLister =
        std::make_shared<host::system::ThreadedFolderLister>(set.dispatch, types, locale.formats);
    set.nameSearch = std::make_shared<host::system::IndexedNameSearch>(set.dispatch, types,
        host::system::IndexedNameSearch::Tags{
            host::drive::tagsAt, {"tag:", set.localization->text(host::system::textKey("tag:"))}});
    set.previewSupport = std::make_shared<host::system::TypePreviewSupport>(types);
    set.imageLoader = std::make_shared<host::system::GdkPixbufImageLoader>();
    set.pagedDocumentOpener = previews;
    set.textDecoder = previews;
    set.linkOpener = std::make_shared<host::system::GioLinkOpener>();
    set.keyedArchiver = std::make_shared<host::system::JsonKeyedArchiver>();
    return set;
}

/// Adds the services that work on the drive's folder, and answers the drive's layout.
DriveLayout addDriveServices(ServiceSet& set, const UserLocale& locale,
    const std::shared_ptr<const platform::ThumbnailMaker>& thumbnailMaker)
{
    const auto layout = DriveLayout::fromEnvironment().prepare();
    set.fileCoordinator =
        std::make_shared<host::system::LocalFileCoordinator>(host::system::LocalFileCoordinator::Settings{
            .lockFile = layout.coordination(), .root = layout.documents(), .dispatch = set.dispatch});
    const host::drive::DriveDependencies dependencies{set.dispatch, set.notificationCenter, set.typeRegistry,
        set.localization, set.linkOpener, set.fileCoordinator};
    const auto cloud = LocalCloudDocumentService::create(layout, dependencies,
        {.languages = locale.languageList(),
            .thumbnailMaker = thumbnailMaker,
            .putRight = LocalCloudDocumentService::Settings::PutRight::Beside});
    set.cloudDocumentService = cloud;
    set.activityHandOver = LocalActivityHandOver::create(cloud->layout(), dependencies, cloud);
    set.fileChanges = cloud->fileChanges();
    set.trash = cloud->trash();
    set.fileSystem = std::make_shared<host::system::PosixFileSystem>();
    set.launcherShortcuts =
        std::make_shared<host::gtk::DesktopShortcuts>(host::gtk::DesktopShortcuts::Settings{
            cloud->layout().recentDocument(), host::gtk::DesktopShortcuts::sharedRecentFiles(),
            set.dispatch->makeSerialQueue("TarrowDriveAppID.launcher")});
    set.storageOfferManager = cloud->storageOffers();
    set.keyValueStore = cloud->keyValueStore();
    set.userDefaults =
        std::make_shared<host::system::JsonUserDefaults>(cloud->layout().defaults(), *set.dispatch);
    return cloud->layout();
}

} // namespace

int main(int argc, char** argv)
{
    static constexpr platform::Operation op{"main"};
    host::system::installSystemLog();
    const auto executable = executablePath(argc > 0 ? argv[0] : nullptr);
    op.debug("-------------------------------------------------------");
    op.info("Running %s", executable);
    op.info("Built (main) on %s", buildDate);

    // The locale is read once, because setting up the message catalogues changes the environment variables
    // that it is read from.
    const auto locale = UserLocale::fromEnvironment();
    const auto previews = host::gtk::PreviewModule::inFile(previewModule(executable));
    auto set = systemServices(executable, locale, previews);
    const auto layout = addDriveServices(set, locale, previews);
    // The queues are destroyed last, because other services may still post work to them while they are
    // destroyed.
    const auto dispatch = std::static_pointer_cast<host::system::GLibDispatch>(set.dispatch);
    platform::installServices(std::move(set));
    kit::ImageContext::install(host::system::openImageContext);
    tarrow::FileUtils::logFileAttributes(executable);

    auto application = host::gtk::makeApplication({.version = TRW_VERSION,
        .stateFile = layout.interfaceState(),
        .dispatch = dispatch,
        .previews = previews,
        .onFirstList = [previews] { previews->whenLoaded([](const auto&) {}); }});
    const int status = application->run(argc, argv, [] { return std::make_shared<tarrow::AppDelegate>(); });
    application.reset();
    // The work on other threads asks for services, so it ends before they go.
    dispatch->stopWorkers();
    platform::installServices({});
    return status;
}
