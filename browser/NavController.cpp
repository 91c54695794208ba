// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "browser/NavController.h"

#include "browser/ListLogging.h"
#include "items/DRItem.h"
#include "items/Downloads.h"
#include "items/UndoHistory.h"
#include "kit/views/View.h"
#include "platform/CloudDocumentService.h"
#include "platform/Dispatch.h"
#include "platform/Formatters.h"
#include "platform/Localization.h"
#include "platform/Log.h"
#include "platform/Services.h"
#include "platform/StateCoder.h"
#include "platform/StorageOffers.h"
#include "platform/UserDefaults.h"
#include "platform/Weakly.h"
#include "preview/PreviewItemManager.h"
#include "prompts/UIUtils.h"
#include "screens/UnavailableScreen.h"
#include "screens/UpgradeFlow.h"
#include "screens/list/DocumentListController.h"

namespace tarrow {

using platform::Notification;
using platform::weakly;
using screens::DocumentListController;
using screens::UnavailableScreen;
using screens::UpgradeFlow;

namespace {

constexpr auto tokenKey = "TarrowDriveAppID.UbiquityIdentityToken";
constexpr double quotaInterval = 300.0; // seconds
constexpr auto stateURLKey = "url";
constexpr auto stateModeKey = "PreviewMode";

std::optional<PropertyValue> currentToken()
{
    return services().cloudDocumentService().account().identityToken();
}

std::string levelText(const std::shared_ptr<const platform::StorageOffer>& offer)
{
    return offer ? std::to_string(offer->level) : "not set";
}

} // namespace

NavController::~NavController() = default;

std::shared_ptr<NavController> NavController::self()
{
    return std::static_pointer_cast<NavController>(shared_from_this());
}

void NavController::viewDidLoad()
{
    static constexpr Operation op{"-[NavController viewDidLoad]"};
    setDelegate(self());
    beginUndoHistory();
    beginDownloads();
    observeAccount();
    setupInitialViewController();
    NavigationController::viewDidLoad();
    _observations.push_back(services().notificationCenter().observe(
        Notification::StorageOfferDidChange, weakly(this, &NavController::offerChangedNotification)));
    auto& offers = services().storageOfferManager();
    if (!offers.fetchOfferIfNeeded())
        _upgradeOffer = offers.currentOffer();
    op.info("Quota Offer level is %{public}@", levelText(_upgradeOffer));
}

void NavController::observeAccount()
{
    auto& center = services().notificationCenter();
    _observations.push_back(center.observe(
        Notification::ApplicationDidBecomeActive, weakly(this, &NavController::didBecomeActiveNotification)));
    _observations.push_back(
        center.observe(Notification::TrashDidChange, weakly(this, &NavController::countTrash)));
    _observations.push_back(
        center.observe(Notification::PuttingRightDidChange, weakly(this, &NavController::driveIsPutRight)));
    _observations.push_back(center.observe(Notification::CloudIdentityDidChange,
        weakly(this, &NavController::tarrowAccountAvailabilityChanged)));
}

bool NavController::checkTarrowState() const
{
    return currentToken().has_value();
}

void NavController::setupInitialViewController()
{
    static constexpr Operation op{"-[NavController setupInitialViewController]"};
    _pickerIsAlive = false;
    if (checkTarrowState()) {
        op.debug("Tarrow is enabled");
        setupDrive();
    } else {
        op.warning("Tarrow is not enabled");
        setupUnavailableScreen();
    }
    op.debug("%{public}@ viewDidLoad", "NavController");
}

void NavController::setupDrive()
{
    static constexpr Operation op{"-[NavController setupInitialViewController]"};
    setToolbarHidden(false);
    const auto root = DocumentListController::createRootList();
    _trashCount = 0;
    op.debug("Contained items: %@", ContainedItems{root});
    if (root) {
        initNewListController(root);
        setViewControllers({root}, false);
    } else {
        op.error("_FolderListScreen creation failed");
        setToolbarHidden(true);
        setViewControllers({UnavailableScreen::createForMissingDrive(
                               weakly(this, &NavController::setupInitialViewController))},
            false);
    }
    _quotaFetcher = QuotaFetcher::init();
    _quotaFetcher->setDelegate(self());
    _quotaFetcher->runWithInterval(quotaInterval);
    removeOldTrash();
}

void NavController::setupUnavailableScreen()
{
    static constexpr Operation op{"-[NavController setupInitialViewController]"};
    if (const auto screen = UnavailableScreen::create()) {
        setViewControllers({screen}, false);
    } else {
        op.error("_DriveUnavailableScreen creation failed");
        // This runs later, so that the alert comes after the caller's own changes of the stack.
        services().dispatch().mainQueue()->async(weakly(this, [](NavController& self) {
            UIUtils::showAlertMessageParentViewController(
                {}, platform::localized("Tarrow is not enabled"), self.self());
        }));
    }
    dropItemManager();
    setToolbarHidden(true);
    _quotaFetcher = nullptr;
    _quotaBytes = 0;
}

void NavController::didBecomeActiveNotification()
{
    static constexpr Operation op{"-[NavController didBecomeActiveNotification:]"};
    op.info("Got HostDidActivateEvent (nav)");
    // The account that is known already is followed at once, so that a URL that comes next finds its
    // account's drive.
    if (storedToken() != services().cloudDocumentService().account().knownIdentityToken())
        return handleAccountChanges();
    // The account is read on another thread, because its file may be slow and a window is activated often.
    auto& dispatch = services().dispatch();
    const auto queue = dispatch.makeSerialQueue("TarrowDriveAppID.activation");
    queue->async(
        [queue, main = dispatch.mainQueue(), compare = weakly(this, &NavController::compareAccount)] {
            main->async([compare, token = currentToken()] { compare(token); });
        });
}

void NavController::compareAccount(const std::optional<PropertyValue>& token)
{
    static constexpr Operation op{"-[NavController handleAccountChanges]"};
    if (storedToken() == token)
        op.debug("Tarrow Token Matches");
    else
        handleAccountChanges();
}

void NavController::tarrowAccountAvailabilityChanged()
{
    static constexpr Operation op{"-[NavController tarrowAccountAvailabilityChanged:]"};
    op.info("Tarrow account availability changed");
    handleAccountChanges();
}

void NavController::handleAccountChanges()
{
    static constexpr Operation op{"-[NavController handleAccountChanges]"};
    const auto token = currentToken();
    if (storedToken() == token) {
        op.debug("Tarrow Token Matches");
        return;
    }
    op.info("Tarrow Token Changed, enabled=%{public}@, reinitializing view", token ? "YES" : "NO");
    saveTarrowToken(token);
    RecentDocument::forget();
    _undoHistory->forget();
    _downloads->forget();
    endEverythingPresented();
    _editMode = false;
    setupInitialViewController();
}

std::optional<PropertyValue> NavController::storedToken() const
{
    const auto data = services().userDefaults().data(tokenKey);
    return data ? services().keyedArchiver().unarchive(*data) : std::nullopt;
}

void NavController::saveTarrowToken(const std::optional<PropertyValue>& token)
{
    if (token)
        services().userDefaults().setData(tokenKey, services().keyedArchiver().archive(*token));
    else
        services().userDefaults().remove(tokenKey);
}

void NavController::quotaFetcherDidUpdateValue(QuotaFetcher&, std::uint64_t freeBytes)
{
    static constexpr Operation op{"-[NavController quotaFetcher:didUpdateValue:]"};
    _quotaBytes = freeBytes;
    _lastQuotaFetch = services().dispatch().now();
    op.debug("updated quota at %{public}@: %{public}@ bytes avail", *_lastQuotaFetch, freeBytes);
    updateStatusUI(nullptr);
}

void NavController::offerChangedNotification()
{
    static constexpr Operation op{"-[NavController offerChangedNotification:]"};
    _upgradeOffer = services().storageOfferManager().currentOffer();
    op.info("Quota Offer Changed, offer level is %{public}@", levelText(_upgradeOffer));
    updateStatusUI(nullptr);
    for (const auto& screen : viewControllers()) {
        const auto list = std::dynamic_pointer_cast<DocumentListController>(screen);
        if (const auto bar = list ? statusBar(*list) : nullptr)
            bar->showUpgradeOffer(_upgradeOffer);
    }
    // Storage that the user just bought appears in the quota with some delay.
    for (const int seconds : {1, 5, 20})
        fetchQuotaAfter(seconds);
}

void NavController::fetchQuotaAfter(int seconds)
{
    auto& dispatch = services().dispatch();
    dispatch.after(std::chrono::seconds(seconds), dispatch.mainQueue(), weakly(this, [](NavController& self) {
        if (self.quotaFetcher())
            self.quotaFetcher()->fetchNow();
    }));
}

void NavController::upgradeStorageButtonPressed()
{
    static constexpr Operation op{"-[NavController upgradeStorageButtonPressed]"};
    _upgradeFlowMgr = UpgradeFlow::initWithOffer(_upgradeOffer);
    if (!_upgradeOffer) {
        op.info("UpgradeStorage: No upgrade offer");
        return;
    }
    op.info("UpgradeStorage: presenting view controller");
    _upgradeFlowMgr->beginWithPresentingViewController(topViewController());
}

void NavController::encodeRestorableStateWithCoder(platform::StateCoder& coder)
{
    NavigationController::encodeRestorableStateWithCoder(coder);
    if (!_itemManager || !_itemManager->item())
        return;
    coder.encode(stateURLKey, _itemManager->item()->url());
    coder.encode(stateModeKey, _itemManager->mode());
}

void NavController::decodeRestorableStateWithCoder(const platform::StateCoder& coder)
{
    NavigationController::decodeRestorableStateWithCoder(coder);
    const auto* value = coder.decode(stateURLKey);
    const auto* url = value ? value->get<Url>() : nullptr;
    const auto item = url ? DRItem::initWithURL(*url) : nullptr;
    if (!item || item->isDirectory())
        return;
    // The folder comes first, so that going back from the preview leads to it.
    warpToFolderForURL(*url);
    const auto* mode = coder.decode(stateModeKey);
    const auto integer = mode ? mode->asInteger() : std::nullopt;
    showPreviewPreviewMode(item, static_cast<int>(integer.value_or(PreviewModeQuick)));
}

void NavController::logContainerURL() const
{
    static constexpr Operation op{"-[NavController logContainerURL]"};
    if (const auto url = services().cloudDocumentService().containers().defaultContainerURL())
        op.debug("Tarrow container is at %{public}@", *url);
    else
        op.debug("Tarrow is not available");
}

} // namespace tarrow
