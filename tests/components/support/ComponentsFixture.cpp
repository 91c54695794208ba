#include "tests/components/support/ComponentsFixture.h"

#include "host/system/GdkPixbufImageLoader.h"
#include "host/system/GettextLocalization.h"
#include "host/system/IcuFormatters.h"
#include "host/system/TypePreviewSupport.h"
#include "host/system/UserLocale.h"
#include "platform/ui/ListView.h"

#include <utility>

namespace testing_support {

using platform::Url;
using platform::components::DocumentListController;

namespace {

/// A service of a set that somebody else keeps.
template <typename T>
std::shared_ptr<T> borrowed(T& service)
{
    return std::shared_ptr<T>(std::shared_ptr<void>(), &service);
}

} // namespace

std::optional<platform::Error> CountingCoordinator::coordinateReading(
    const Url& url, platform::ReadingOptions options, const Accessor& accessor)
{
    _names.push_back(url.lastPathComponent());
    return _real.coordinateReading(url, options, accessor);
}

std::vector<std::string> CountingCoordinator::takeReads()
{
    return std::exchange(_names, {});
}

void RecordingListDelegate::documentListControllerDidSelectContainerWithViewController(
    const List&, const List& container)
{
    _lines.push_back("folder " + container->title() + " " + container->presentedURL()->lastPathComponent());
}

void RecordingListDelegate::documentListControllerDidSelectItemAtURL(const List&, const Url& url)
{
    _lines.push_back("item " + url.lastPathComponent());
}

void RecordingListDelegate::documentListControllerItemsChanged(const List& list)
{
    _lines.push_back("changed " + std::to_string(list->containedItemCount()) + " selected "
        + std::to_string(list->selectedItemCount()));
}

void RecordingListDelegate::documentListControllerURLWasRemoved(const List& list)
{
    _lines.push_back("removed " + list->title());
}

void RecordingListDelegate::documentListControllerPerformActionURLOriginatingViewCompletion(
    const List&, int action, const Url& url, const std::shared_ptr<platform::ui::View>&, const Completion&)
{
    _lines.push_back("action " + std::to_string(action) + " " + url.lastPathComponent());
}

std::vector<std::string> RecordingListDelegate::take()
{
    return std::exchange(_lines, {});
}

ComponentsFixture::ComponentsFixture()
{
    coordinator = std::make_shared<CountingCoordinator>(_driveServices.fileCoordinator());
    platform::ServiceSet set;
    set.cloudDocumentService = drive.cloud;
    set.dispatch = drive.dispatch;
    set.fileCoordinator = coordinator;
    set.fileSystem = borrowed(_driveServices.fileSystem());
    set.folderLister = lister;
    set.formatters = std::make_shared<host::system::IcuFormatters>("en_US", "UTC");
    set.imageLoader = std::make_shared<host::system::GdkPixbufImageLoader>();
    set.linkOpener = links;
    set.localization = std::make_shared<host::system::GettextLocalization>(
        TRW_LOCALE_FOLDER, host::system::UserLocale{"en", "en_US"});
    set.notificationCenter = drive.notifications;
    set.storageOfferManager = borrowed(_driveServices.storageOfferManager());
    set.typeRegistry = borrowed(_driveServices.typeRegistry());
    set.previewSupport = std::make_shared<host::system::TypePreviewSupport>(set.typeRegistry);
    platform::installServices(std::move(set));
}

ComponentsFixture::List ComponentsFixture::shownList(const Url& folder)
{
    const auto list = DocumentListController::initWithURL(folder);
    list->setDelegate(delegate);
    list->view()->setFrame({0, 0, 360, 600});
    list->view()->layoutIfNeeded();
    list->beginAppearance(true, false);
    list->endAppearance();
    return list;
}

void ComponentsFixture::deliver(
    const List& list, const HandLister::Entries& entries, platform::ListingStage stage)
{
    lister->deliver(*list->presentedURL(), entries, stage);
    drive.dispatch->runUntilIdle();
}

std::vector<std::string> ComponentsFixture::titles(const List& list) const
{
    std::vector<std::string> found;
    for (std::size_t row = 0; row < list->listView()->rowCount(); ++row)
        found.push_back(list->listView()->row(row).title);
    return found;
}

} // namespace testing_support
