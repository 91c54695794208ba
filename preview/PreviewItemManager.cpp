// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file chooses the screen of an item and puts it on the stack. The presenter, the actions and the
// hand-over have sources of their own.

#include "preview/PreviewItemManager.h"

#include "items/DRItem.h"
#include "kit/controllers/SearchPresentation.h"
#include "platform/Dispatch.h"
#include "platform/Log.h"
#include "platform/Services.h"
#include "platform/Weakly.h"
#include "preview/LookwellItemController.h"
#include "preview/PreviewDetailsViewController.h"
#include "screens/DocumentInteractionSheet.h"
#include "screens/EndPresented.h"

#include <thread>
#include <utility>

namespace tarrow {

using kit::NavigationController;
using kit::SearchPresentation;
using kit::ViewController;
using platform::Notification;
using platform::Operation;
using platform::services;
using platform::Url;
using platform::weakly;
using screens::DocumentListController;

namespace {

bool hasSomethingToShow(const std::shared_ptr<DRItem>& item)
{
    return item && (item->isSymlink() || item->resolvedURL());
}

/// Answers whether the item was here when it was read, without another look at the disk.
bool fileExisted(const DRItem& item)
{
    return item.resolvedURL() && !item.isPromise();
}

/// Deletes a manager on the main thread. The coordinator holds its presenters while it calls them, so any
/// thread may release the last reference, but the manager's observations and screens belong to the main
/// thread.
class EndOnMainThread {
public:
    EndOnMainThread()
        : _main(services().dispatch().mainQueue())
    {
    }
    void operator()(PreviewItemManager* manager) const
    {
        std::shared_ptr<PreviewItemManager> last(manager);
        if (std::this_thread::get_id() != _mainThread)
            _main->async([last = std::move(last)] {});
    }

private:
    std::shared_ptr<platform::Queue> _main;
    std::thread::id _mainThread = std::this_thread::get_id();
};

} // namespace

std::shared_ptr<PreviewItemManager> PreviewItemManager::newItemManagerWithModeNavController(
    int mode, const std::shared_ptr<NavigationController>& navigationController)
{
    const auto manager = init();
    manager->setNavigationController(navigationController);
    manager->setMode(mode);
    return manager;
}

std::shared_ptr<PreviewItemManager> PreviewItemManager::init()
{
    const std::shared_ptr<PreviewItemManager> manager(
        std::make_unique<PreviewItemManager>().release(), EndOnMainThread());
    manager->observeApplication();
    LookwellItemController::defaultController();
    return manager;
}

PreviewItemManager::PreviewItemManager()
    : _fcQueue(services().dispatch().makeOperationQueue(
        "TarrowDriveAppID.previewitem", platform::QualityOfService::UserInitiated))
{
}

PreviewItemManager::~PreviewItemManager()
{
    unregisterAsFilePresenter();
}

void PreviewItemManager::setNavigationController(std::weak_ptr<NavigationController> navigationController)
{
    _navigationController = std::move(navigationController);
}

void PreviewItemManager::setDocumentInteractionController(
    std::shared_ptr<screens::DocumentInteractionSheet> sheet)
{
    _documentInteractionController = std::move(sheet);
}

std::shared_ptr<DRItem> PreviewItemManager::item() const
{
    const std::lock_guard lock(_mutex);
    return _item;
}

std::optional<Url> PreviewItemManager::itemURL() const
{
    const auto shown = item();
    return shown ? std::optional(shown->url()) : std::nullopt;
}

void PreviewItemManager::keepItem(const std::shared_ptr<DRItem>& item)
{
    const std::lock_guard lock(_mutex);
    _item = item;
}

void PreviewItemManager::observeApplication()
{
    const auto observe = [this](Notification notification, void (PreviewItemManager::*handle)()) {
        _observations.push_back(services().notificationCenter().observe(notification, weakly(this, handle)));
    };
    observe(Notification::ApplicationDidBecomeActive, &PreviewItemManager::didBecomeActiveNotification);
    observe(Notification::ApplicationWillResignActive, &PreviewItemManager::willResignActiveNotification);
}

void PreviewItemManager::didBecomeActiveNotification()
{
    static constexpr Operation op{"-[PreviewItemManager didBecomeActiveNotification:]"};
    op.debug("Becoming active for %@", itemURL());
    const bool hasFollowed = filePresenterRegistered();
    registerAsFilePresenter();
    if (!hasFollowed)
        lookAgain();
}

void PreviewItemManager::willResignActiveNotification()
{
    static constexpr Operation op{"-[PreviewItemManager willResignActiveNotification:]"};
    op.debug("Resigning active for %@", itemURL());
    unregisterAsFilePresenter();
}

void PreviewItemManager::previewItem(const std::shared_ptr<DRItem>& item)
{
    setItemUpdatePreview(item, true);
}

void PreviewItemManager::setItem(const std::shared_ptr<DRItem>& item)
{
    setItemUpdatePreview(item, true);
}

void PreviewItemManager::setItemUpdatePreview(const std::shared_ptr<DRItem>& item, bool updatePreview)
{
    static constexpr Operation op{"-[PreviewItemManager setItem:updatePreview:]"};
    op.debug("Previewing %@", item ? std::optional(item->url()) : std::nullopt);
    if (!item || !updatePreview)
        return keepItem(item);
    if (const auto screen = prepareToPreviewItem(item))
        replaceLastViewController(screen);
}

PreviewItemManager::Screen PreviewItemManager::prepareToPreviewItem(const std::shared_ptr<DRItem>& item)
{
    static constexpr Operation op{"-[PreviewItemManager prepareToPreviewItem:]"};
    if (!item || item->url() != itemURL())
        unregisterAsFilePresenter();
    keepItem(item);
    if (!hasSomethingToShow(item)) {
        op.warning("no preview URL, nothing to show");
        return nullptr;
    }
    _modifiedDate = item->contentModificationDate();
    registerAsFilePresenter();
    const bool exists = fileExisted(*item);
    _detailsViewController = nullptr;
    const bool isQuick = _mode == PreviewModeQuick;
    const auto screen = isQuick ? Screen(createLookwellController()) : Screen(createDetailsViewController());
    op.debug("Preview: Using %{public}@, %{public}@",
        isQuick ? "LookwellItemController" : "PreviewDetailsViewController",
        exists ? "File Exists" : "File doesn't exist");
    return screen;
}

std::shared_ptr<PreviewDetailsViewController> PreviewItemManager::createDetailsViewController()
{
    _detailsViewController = std::make_shared<PreviewDetailsViewController>();
    _detailsViewController->setMode(_mode);
    _detailsViewController->setItemManager(shared_from_this());
    return _detailsViewController;
}

std::shared_ptr<LookwellItemController> PreviewItemManager::createLookwellController()
{
    const auto controller = LookwellItemController::defaultController();
    controller->lookwellNewItem(shared_from_this());
    return controller;
}

std::shared_ptr<LookwellItemController> PreviewItemManager::currentLookwellController() const
{
    return LookwellItemController::defaultController();
}

bool PreviewItemManager::isPreviewControllerDisplayed(const Screen& screen) const
{
    return std::dynamic_pointer_cast<PreviewBaseViewController>(screen)
        || std::dynamic_pointer_cast<LookwellItemController>(screen);
}

void PreviewItemManager::viewControllerWillDisappear(const ViewController& screen)
{
    if (_detailsViewController.get() == &screen)
        _detailsViewController = nullptr;
}

void PreviewItemManager::replaceLastViewController(const Screen& screen)
{
    const auto navigation = navigationController();
    if (!navigation)
        return;
    auto stack = navigation->viewControllers();
    if (!stack.empty() && isPreviewControllerDisplayed(stack.back())) {
        stack.back() = screen;
        navigation->setViewControllers(std::move(stack), false);
        return;
    }
    const auto push = weakly(navigation, &NavigationController::pushViewController, screen, true);
    if (std::dynamic_pointer_cast<SearchPresentation>(navigation->presentedViewController()))
        navigation->dismissViewController(true, push);
    else
        push();
}

std::optional<PreviewItemManager::ListStack> PreviewItemManager::dlcStackForURL(const Url& url)
{
    const auto folders = foldersForURL(url);
    return folders.empty() ? std::nullopt : std::optional(DocumentListController::listsOf(folders));
}

std::vector<screens::TitledFolder> PreviewItemManager::foldersForURL(const Url& url)
{
    static constexpr Operation op{"+[PreviewItemManager dlcStackForURL:]"};
    auto folder = url;
    auto item = DRItem::initWithURL(folder);
    // A folder that is promised as a whole is shown in its place, because nobody can enter it.
    if (item && (!item->isDirectory() || item->isPromise())) {
        folder = url.deletingLastPathComponent();
        item = DRItem::initWithURL(folder);
    }
    if (!item || !item->isDirectory()) {
        op.error("Can't build DLC stack, can't get directory: %@", folder);
        return {};
    }
    auto folders = screens::titledFoldersDownTo(folder);
    if (folders.empty())
        op.error(": Couldn't build DLC stack for %@.", folder);
    return folders;
}

bool PreviewItemManager::warpToNewURL(const Url& url)
{
    static constexpr Operation op{"-[PreviewItemManager warpToNewURL:]"};
    const auto lists = dlcStackForURL(url);
    if (!lists)
        return false;
    std::vector<Screen> stack(lists->begin(), lists->end());
    op.debug("New VC stack of DLCs: %@", *lists);
    unregisterAsFilePresenter();
    const auto item = DRItem::initWithURL(url);
    if (item && !item->isDirectory()) {
        if (const auto screen = prepareToPreviewItem(item))
            stack.push_back(screen);
    }
    if (const auto navigation = navigationController()) {
        screens::endPresented(*navigation);
        navigation->setViewControllers(std::move(stack), true);
    }
    setItemUpdatePreview(item, false);
    return true;
}

} // namespace tarrow
