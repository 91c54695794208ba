// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/LaunchUtils.h"

#include "items/FileUtils.h"
#include "items/UrlResolution.h"
#include "screens/list/DocumentListController.h"

#include <algorithm>

namespace tarrow {

using platform::AppHandle;
using screens::DocumentInteractionSheet;
using screens::DocumentListController;

namespace {

constexpr Operation defaultAppOperation{"+[LaunchUtils defaultAppForDocument:requireOpenIn:]"};

const platform::DocumentContainers& containers()
{
    return services().cloudDocumentService().containers();
}

bool isOwn(const AppHandle& app)
{
    return app.bundleIdentifier == services().appRegistry().ownBundleIdentifier();
}

void logApp(const Url& url, const AppHandle& app)
{
    defaultAppOperation.debug("App for %@: %@, %@, %@, %@, %@, %@, %@, %@, %@, %@, %@", url, app.itemName,
        app.localizedName, app.localizedShortName, app.shortVersion, app.vendorName, app.bundleIdentifier,
        app.executableName, app.bundleContainerURL, app.isInstalled, app.itemIdentifier, app.description);
}

std::optional<AppHandle> appInDefaultContainer(const Url& url, bool requireOpenIn)
{
    constexpr const auto& op = defaultAppOperation;
    if (FileUtils::isAudioVideoImageFile(url)) {
        op.debug("Preferring LW due to file type, over default app to open %@", url);
        return std::nullopt;
    }
    const auto apps = LaunchUtils::availableAppsForDoc({url});
    if (apps.empty()) {
        op.debug("No default app to open %@", url);
        return std::nullopt;
    }
    const auto& app = apps.front();
    logApp(url, app);
    if (requireOpenIn && !app.supportsOpenInPlace) {
        op.debug("App %@ does not support open in place. Ignoring", app);
        return std::nullopt;
    }
    if (isOwn(app)) {
        op.debug("Ignoring %@ as default app", app.bundleIdentifier);
        return std::nullopt;
    }
    return app;
}

/// Answers the app that opens a document when `owner` owns the container; `available` are the document's
/// apps.
std::optional<AppHandle> appBesideOwner(
    const std::string& containerName, const AppHandle& owner, const std::vector<AppHandle>& available)
{
    constexpr const auto& op = defaultAppOperation;
    op.debug("Container %@: Default app (%@) supports open in place", containerName, owner.bundleIdentifier);
    if (std::ranges::find(available, owner) != available.end())
        return owner;
    op.debug("Container %@: Default app does NOT support/own this document type.", containerName);
    const auto fallback = std::ranges::find_if(available, &AppHandle::supportsOpenInPlace);
    if (fallback == available.end()) {
        op.debug("No fallback app, using Lookwell");
        return std::nullopt;
    }
    op.debug("Falling back to default open-in-place app instead: %@", *fallback);
    return *fallback;
}

std::optional<AppHandle> appInLibrary(const DocumentContainer& container, const Url& url)
{
    constexpr const auto& op = defaultAppOperation;
    auto available = LaunchUtils::availableAppsForDoc({url});
    std::erase_if(available, isOwn);
    for (const auto& identifier : container.owningApps) {
        const auto owner = services().appRegistry().appWithBundleIdentifier(identifier);
        if (!owner || !owner->supportsOpenInPlace) {
            op.debug("Container %@: Default app (%@) %@", container.localizedName, identifier,
                owner && owner->isInstalled ? "doesn't support open in place" : "not installed");
        } else if (auto app = appBesideOwner(container.localizedName, *owner, available)) {
            return app;
        }
    }
    return std::nullopt;
}

std::optional<AppHandle> defaultApp(const LaunchUtils::DocumentFacts& facts, bool requireOpenIn)
{
    if (!facts.exists)
        defaultAppOperation.debug("Assuming apps can open a promised document...");
    if (!facts.resolved)
        return std::nullopt;
    if (facts.isInDefaultContainer)
        return appInDefaultContainer(*facts.resolved, requireOpenIn);
    return facts.library ? appInLibrary(*facts.library, *facts.resolved) : std::nullopt;
}

} // namespace

bool LaunchUtils::isUrlInDefaultContainer(const Url& url)
{
    return containers().containerIdentifierInURL(url) == containers().defaultContainerIdentifier();
}

std::vector<AppHandle> LaunchUtils::availableAppsForDoc(const platform::DocumentHandle& document)
{
    static constexpr Operation op{"+[LaunchUtils availableAppsForDoc:]"};
    const auto type = FileUtils::fileUTI(document.url);
    std::vector<AppHandle> fit;
    for (const auto& [rank, apps] : services().appRegistry().availableApps(document)) {
        for (const auto& app : apps) {
            if (rank != platform::ownerRank) {
                op.debug("UTI %{public}@: Found non-Owner '%{public}@' app %{public}@", type, rank, app);
            } else if (!app.supportsOpenInPlace) {
                op.debug("UTI %{public}@: Found non-OpenInPlace app %{public}@", type, app);
            } else {
                op.debug("UTI %{public}@: Found *perfect* app: %{public}@", type, app);
                fit.push_back(app);
            }
        }
    }
    return fit;
}

LaunchUtils::DocumentFacts LaunchUtils::factsOf(const Url& url)
{
    DocumentFacts facts{
        FileUtils::exists(url), trw_URLByResolvingBookmark(url), isUrlInDefaultContainer(url), {}, {}};
    if (facts.resolved)
        facts.target = DocumentInteractionSheet::lookUp(*facts.resolved);
    const auto identifier =
        facts.isInDefaultContainer ? std::nullopt : containers().containerIdentifierInURL(url);
    if (identifier)
        facts.library = containers().containerWithIdentifier(*identifier);
    return facts;
}

LaunchUtils::SharedItem LaunchUtils::sharedItemAt(const Url& url)
{
    const auto resolved = trw_URLByResolvingBookmark(url).value_or(url);
    return {resolved, DocumentInteractionSheet::lookUp(resolved)};
}

std::optional<AppHandle> LaunchUtils::defaultAppForDocumentRequireOpenIn(const Url& url, bool requireOpenIn)
{
    return defaultApp(factsOf(url), requireOpenIn);
}

std::optional<std::string> LaunchUtils::defaultAppNameForDocumentRequireOpenIn(
    const Url& url, bool requireOpenIn)
{
    return defaultAppNameForDocumentFactsRequireOpenIn(factsOf(url), requireOpenIn);
}

std::optional<std::string> LaunchUtils::defaultAppNameForDocumentFactsRequireOpenIn(
    const DocumentFacts& facts, bool requireOpenIn)
{
    const auto app = defaultApp(facts, requireOpenIn);
    return app ? std::optional(app->localizedName) : std::nullopt;
}

bool LaunchUtils::openInDefaultAppViewControllerRequireOpenIn(
    const Url& url, const std::shared_ptr<kit::ViewController>& viewController, bool requireOpenIn)
{
    return openInDefaultAppFactsViewControllerRequireOpenIn(url, factsOf(url), viewController, requireOpenIn);
}

bool LaunchUtils::openInDefaultAppFactsViewControllerRequireOpenIn(const Url& url, const DocumentFacts& facts,
    const std::shared_ptr<kit::ViewController>& viewController, bool requireOpenIn)
{
    static constexpr Operation op{"+[LaunchUtils openInDefaultApp:viewController:requireOpenIn:]"};
    op.info("Opening document %@ in default app", url);
    const auto app = defaultApp(facts, requireOpenIn);
    if (!app)
        return false;
    // The flag is shared, because the action may run after this call has returned.
    const auto opened = std::make_shared<bool>(false);
    const auto& resolved = *facts.resolved;
    DocumentListController::openOutOfDriveViewControllerAction(resolved, viewController, [=] {
        const auto sheet =
            DocumentInteractionSheet::interactionControllerWithURLFacts(resolved, facts.target);
        *opened = sheet->openDocumentInPlaceInApp(*app);
    });
    return *opened;
}

} // namespace tarrow
