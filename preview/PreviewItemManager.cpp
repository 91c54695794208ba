#include "preview/PreviewItemManager.h"

#include "items/DRItem.h"
#include "platform/FileSystem.h"
#include "platform/Log.h"
#include "platform/Services.h"
#include "platform/ui/SearchPresentation.h"
#include "preview/LookwellItemController.h"

#include <utility>

namespace tarrow {

using platform::Notification;
using platform::Operation;
using platform::services;
using platform::Url;
using platform::components::DocumentListController;
using platform::ui::NavigationController;
using platform::ui::SearchPresentation;
using platform::ui::ViewController;

namespace {

std::optional<Url> urlOf(const std::shared_ptr<DRItem>& item)
{
    return item ? std::optional(item->url()) : std::nullopt;
}

bool hasSomethingToShow(const std::shared_ptr<DRItem>& item)
{
    return item && (item->isSymlink() || item->resolvedURL());
}

bool fileExists(const DRItem& item)
{
    return item.resolvedURL() && services().fileSystem().typeOfItem(item.resolvedURL()->path()).has_value();
}

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
    const auto manager = std::make_shared<PreviewItemManager>();
    manager->observeApplication();
    LookwellItemController::defaultController();
    return manager;
}

PreviewItemManager::PreviewItemManager() = default;

PreviewItemManager::~PreviewItemManager()
{
    unregisterAsFilePresenter();
}

void PreviewItemManager::setNavigationController(std::weak_ptr<NavigationController> navigationController)
{
    _navigationController = std::move(navigationController);
}

void PreviewItemManager::observeApplication()
{
    auto& notices = services().notificationCenter();
    _observations.push_back(
        notices.observe(Notification::ApplicationDidBecomeActive, [weak = weak_from_this()](const auto&) {
            if (const auto self = weak.lock())
                self->didBecomeActiveNotification();
        }));
    _observations.push_back(
        notices.observe(Notification::ApplicationWillResignActive, [weak = weak_from_this()](const auto&) {
            if (const auto self = weak.lock())
                self->willResignActiveNotification();
        }));
}

void PreviewItemManager::didBecomeActiveNotification()
{
    static constexpr Operation op{"-[PreviewItemManager didBecomeActiveNotification:]"};
    op.debug("Becoming active for %@", urlOf(_item));
    registerAsFilePresenter();
}

void PreviewItemManager::willResignActiveNotification()
{
    static constexpr Operation op{"-[PreviewItemManager willResignActiveNotification:]"};
    op.debug("Resigning active for %@", urlOf(_item));
    unregisterAsFilePresenter();
}

void PreviewItemManager::registerAsFilePresenter()
{
    _filePresenterRegistered = true;
}

void PreviewItemManager::unregisterAsFilePresenter()
{
    _filePresenterRegistered = false;
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
    op.debug("Previewing %@", urlOf(item));
    if (!item || !updatePreview) {
        _item = item;
        return;
    }
    if (const auto screen = prepareToPreviewItem(item))
        replaceLastViewController(screen);
}

std::shared_ptr<ViewController> PreviewItemManager::prepareToPreviewItem(const std::shared_ptr<DRItem>& item)
{
    static constexpr Operation op{"-[PreviewItemManager prepareToPreviewItem:]"};
    if (!item || !_item || item->url() != _item->url())
        unregisterAsFilePresenter();
    _item = item;
    if (!hasSomethingToShow(item)) {
        op.warning("no preview URL, nothing to show");
        return nullptr;
    }
    _modifiedDate = item->contentModificationDate();
    registerAsFilePresenter();
    const bool exists = fileExists(*item);
    const auto screen = createLookwellController();
    op.debug("Preview: Using %{public}@, %{public}@", "LookwellItemController",
        exists ? "File Exists" : "File doesn't exist");
    return screen;
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

bool PreviewItemManager::isPreviewControllerDisplayed(const std::shared_ptr<ViewController>& screen) const
{
    return std::dynamic_pointer_cast<LookwellItemController>(screen) != nullptr;
}

void PreviewItemManager::replaceLastViewController(const std::shared_ptr<ViewController>& screen)
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
    const auto push = [weak = std::weak_ptr(navigation), screen] {
        if (const auto controller = weak.lock())
            controller->pushViewController(screen, true);
    };
    if (std::dynamic_pointer_cast<SearchPresentation>(navigation->presentedViewController()))
        navigation->dismissViewController(true, push);
    else
        push();
}

std::optional<PreviewItemManager::ListStack> PreviewItemManager::dlcStackForURL(const Url& url)
{
    static constexpr Operation op{"+[PreviewItemManager dlcStackForURL:]"};
    auto folder = url;
    auto item = DRItem::initWithURL(folder);
    if (item && !item->isDirectory()) {
        folder = url.deletingLastPathComponent();
        item = DRItem::initWithURL(folder);
    }
    if (!item || !item->isDirectory()) {
        op.error("Can't build DLC stack, can't get directory: %@", folder);
        return std::nullopt;
    }
    auto lists = DocumentListController::hierarchyForURL(folder);
    if (!lists.empty())
        return lists;
    op.error(": Couldn't build DLC stack for %@.", folder);
    return std::nullopt;
}

bool PreviewItemManager::warpToNewURL(const Url& url)
{
    static constexpr Operation op{"-[PreviewItemManager warpToNewURL:]"};
    const auto lists = dlcStackForURL(url);
    if (!lists)
        return false;
    std::vector<std::shared_ptr<ViewController>> stack(lists->begin(), lists->end());
    op.debug("New VC stack of DLCs: %@", *lists);
    unregisterAsFilePresenter();
    const auto item = DRItem::initWithURL(url);
    if (item && !item->isDirectory()) {
        if (const auto screen = prepareToPreviewItem(item))
            stack.push_back(screen);
    }
    if (const auto navigation = navigationController()) {
        navigation->dismissViewController(false);
        navigation->setViewControllers(std::move(stack), true);
    }
    setItemUpdatePreview(item, false);
    return true;
}

} // namespace tarrow
