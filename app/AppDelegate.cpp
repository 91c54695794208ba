// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "app/AppDelegate.h"

#include "app/SchemeEntry.h"
#include "browser/NavController.h"
#include "items/AccountSession.h"
#include "items/DocumentID.h"
#include "items/Settings.h"
#include "items/UrlResolution.h"
#include "kit/controllers/Window.h"
#include "kit/values/Screen.h"
#include "platform/CloudDocumentService.h"
#include "platform/Dispatch.h"
#include "platform/Localization.h"
#include "platform/Log.h"
#include "platform/Services.h"
#include "platform/UserDefaults.h"
#include "platform/Weakly.h"
#include "preview/PreviewMode.h"
#include "screens/DisplayName.h"

namespace tarrow {

using kit::Window;
using platform::Application;
using platform::ShortcutItem;
using platform::UserActivity;
using platform::weakly;

namespace {

std::optional<std::string> textAt(const PropertyDictionary& information, std::string_view key)
{
    const auto* value = platform::find(information, key);
    const auto* text = value ? value->get<std::string>() : nullptr;
    return text ? std::optional(*text) : std::nullopt;
}

/// Answers the URL whose archive is stored under a key.
std::optional<Url> archivedURL(const PropertyDictionary& information, std::string_view key)
{
    const auto* value = platform::find(information, key);
    const auto* data = value ? value->get<platform::Data>() : nullptr;
    const auto unarchived = data ? services().keyedArchiver().unarchive(*data) : std::nullopt;
    const auto* url = unarchived ? unarchived->get<Url>() : nullptr;
    return url ? std::optional(*url) : std::nullopt;
}

bool isNumber(const PropertyValue& value)
{
    return value.get<std::int64_t>() || value.get<std::uint64_t>() || value.get<double>();
}

std::optional<Url> documentWithNumber(const PropertyValue& number)
{
    const auto identifier = number.asUnsigned();
    return identifier ? trw_URLFromDocumentID(std::to_string(*identifier)) : std::nullopt;
}

/// Answers the location that a shortcut to a recent document means. An identifier decides even when it leads
/// nowhere, because another document may long have taken the plain location.
std::optional<Url> recentDocument(const PropertyDictionary& information)
{
    if (auto alias = archivedURL(information, platform::RecentDocumentAliasURLKey))
        return alias;
    const auto* number = platform::find(information, platform::RecentDocumentDocIDKey);
    if (number && isNumber(*number))
        return documentWithNumber(*number);
    return archivedURL(information, platform::RecentDocumentURLKey);
}

/// Says why a location from outside opened nothing.
std::string refusal(const Url& target)
{
    const auto& items = services().cloudDocumentService().items();
    const auto name = screens::displayName(target.lastPathComponent());
    if (!items.isInDocumentsArea(target))
        return platform::localized("“%@” lies outside the drive.", {name});
    return items.isInTrash(target) ? platform::localized("“%@” was deleted", {name})
                                   : platform::localized("“%@” is no longer there.", {name});
}

} // namespace

std::shared_ptr<NavController> AppDelegate::browser() const
{
    return _rootWindow ? std::dynamic_pointer_cast<NavController>(_rootWindow->rootViewController())
                       : nullptr;
}

bool AppDelegate::isSignedIn() const
{
    const auto root = browser();
    return root && root->checkTarrowState();
}

bool AppDelegate::warpTo(const std::optional<Url>& url, int previewMode)
{
    const auto root = browser();
    return root && root->warpToNewURLPreviewMode(url, previewMode);
}

void AppDelegate::tell(const std::string& notice) const
{
    // While nobody is signed in, the screen says enough.
    if (isSignedIn())
        _rootWindow->showNotice(notice);
}

void AppDelegate::warpLater(const Url& url)
{
    services().dispatch().mainQueue()->async(weakly(this, &AppDelegate::warpTo, url, PreviewModeQuick));
}

bool AppDelegate::applicationWillFinishLaunchingWithOptions(
    Application& application, const platform::LaunchOptions& options)
{
    static constexpr Operation op{"-[AppDelegate application:willFinishLaunchingWithOptions:]"};
    const auto& screen = kit::Screen::main();
    _rootWindow = std::make_shared<Window>(screen ? screen->bounds : platform::Rect{});
    _rootWindow->setBackground(platform::Color::white());
    const auto root = std::make_shared<NavController>();
    _rootWindow->setRootViewController(root);
    root->setRestorationIdentifier("Root");
    _rootWindow->makeKeyAndVisible();
    if (!options.shortcutItem)
        return true;
    op.info("Launched with shortcut: %{public}@", options.shortcutItem->type);
    applicationPerformActionForShortcutItemCompletionHandler(application, *options.shortcutItem, {});
    return false;
}

bool AppDelegate::applicationDidFinishLaunchingWithOptions(Application&, const platform::LaunchOptions&)
{
    return true;
}

void AppDelegate::applicationWillResignActive(Application&)
{
    dumpWindowInfo();
}

void AppDelegate::dumpWindowInfo() const { }

bool AppDelegate::applicationShouldSaveApplicationState(Application&, platform::StateCoder&)
{
    // The state is saved whenever the keyboard leaves the window, so the account is not read again.
    return browser() && AccountSession().isCurrent();
}

bool AppDelegate::applicationShouldRestoreApplicationState(Application&, platform::StateCoder&)
{
    return isSignedIn();
}

bool AppDelegate::applicationOpenURLOptions(
    Application&, const std::string& url, const PropertyDictionary& options)
{
    static constexpr Operation op{"-[AppDelegate application:openURL:options:]"};
    op.userAction("AppDelegate: openURL");
    op.info("openURL: %@, options %{public}@, app %{public}@", url, options, "Tarrow Drive");
    const auto entry = SchemeEntry::parse(url);
    const bool isShown = entry && warpTo(entry->target, entry->previewMode);
    const bool hasTarget = entry && entry->target;
    if (!isShown)
        tell(hasTarget ? refusal(*entry->target) : platform::localized("This address cannot be opened."));
    return isShown;
}

void AppDelegate::applicationPerformActionForShortcutItemCompletionHandler(
    Application&, const ShortcutItem& shortcut, const ShortcutCompletion&)
{
    static constexpr Operation op{
        "-[AppDelegate application:performActionForShortcutItem:completionHandler:]"};
    op.info("Shortcut action: %{public}@", shortcut.type);
    if (shortcut.type == platform::ShortcutTypeSearch) {
        op.userAction("Firmtap: Search");
        if (const auto root = browser())
            root->startSearch("");
    } else if (shortcut.type == platform::ShortcutTypeRecentDocument) {
        op.userAction("Firmtap: Recent Document");
        openRecentDocument(shortcut.userInfo);
    }
}

void AppDelegate::openRecentDocument(const PropertyDictionary& information)
{
    static constexpr Operation op{
        "-[AppDelegate application:performActionForShortcutItem:completionHandler:]"};
    const auto url = recentDocument(information);
    if (!url) {
        tell(platform::localized("There is no recent document."));
        return;
    }
    op.info("Shortcut recent document: %@", *url);
    if (!warpTo(url, PreviewModeQuick))
        tell(refusal(*url));
}

bool AppDelegate::applicationWillContinueUserActivityWithType(Application&, const std::string& type)
{
    static constexpr Operation op{"-[AppDelegate application:willContinueUserActivityWithType:]"};
    op.info("%s: activity type is %{public}@", op.name(), type);
    return true;
}

bool AppDelegate::applicationContinueUserActivityRestorationHandler(
    Application&, const UserActivity& activity, const RestorationHandler&)
{
    static constexpr Operation op{"-[AppDelegate application:continueUserActivity:restorationHandler:]"};
    if (activity.type == platform::activityType::queryContinuation) {
        op.userAction("CoreGlimmer: Search Continuation");
        continueSearch(activity);
    } else if (activity.type == platform::activityType::searchableItem) {
        op.userAction("CoreGlimmer: Open Search Result");
        openSearchResult(activity);
    } else if (activity.type == Settings::batonneTarrowActivityType()) {
        op.userAction("Batonne: Open Document");
        openHandedOverDocument(activity);
    } else {
        op.error("Invalid user activity type %{public}@", activity.type);
        return false;
    }
    return true;
}

void AppDelegate::continueSearch(const UserActivity& activity)
{
    static constexpr Operation op{"-[AppDelegate application:continueUserActivity:restorationHandler:]"};
    const auto query = textAt(activity.userInfo, platform::activityKey::searchQuery);
    op.info("CoreGlimmer Search Continuation: \"%@\"", query);
    const auto root = browser();
    if (query && root)
        root->startSearch(*query);
}

void AppDelegate::openSearchResult(const UserActivity& activity)
{
    static constexpr Operation op{"-[AppDelegate application:continueUserActivity:restorationHandler:]"};
    const auto identifier = textAt(activity.userInfo, platform::activityKey::searchableItemIdentifier);
    op.info("CoreGlimmer Search Result: open documentID \"%{public}@\"", identifier);
    const auto document = trw_URLFromDocumentID(identifier);
    if (!document) {
        op.error("Can't get URL for DocumentID: %{public}@", identifier);
        return;
    }
    const auto url = trw_URLByResolvingPromise(*document);
    op.info("CoreGlimmer documentID %{public}@ is URL: %@", identifier, url);
    warpLater(url);
}

void AppDelegate::openHandedOverDocument(const UserActivity& activity)
{
    static constexpr Operation op{"-[AppDelegate application:continueUserActivity:restorationHandler:]"};
    const auto bookmark = textAt(activity.userInfo, platform::activityKey::documentURL);
    op.info("Batonne document bookmark: %{public}@", bookmark);
    services().cloudDocumentService().items().decodeBookmark(
        bookmark.value_or(""), [weak = weak_from_this()](const Result<Url>& result) {
            if (result.error || !result.value) {
                op.error("Batonne failed to decode bookmark: %{public}@", result.error);
                return;
            }
            if (weak.expired())
                return;
            op.info("Batonne document URL: %@", *result.value);
            // The delegate is locked only on the main queue, so that it is never destroyed on this thread.
            services().dispatch().mainQueue()->async(
                weakly(weak, &AppDelegate::warpTo, *result.value, PreviewModeQuick));
        });
}

void AppDelegate::applicationDidFailToContinueUserActivityWithTypeError(
    Application&, const std::string& type, const Error& error)
{
    static constexpr Operation op{"-[AppDelegate application:didFailToContinueUserActivityWithType:error:]"};
    op.error("%s: activity type is %{public}@: Error %{public}@", op.name(), type, error);
}

void _TarrowDriveLogTest() // NOLINT(bugprone-reserved-identifier)
{
    static constexpr Operation op{"_TarrowDriveLogTest"};
    op.debug("LOG_DEBUG");
    op.info("LOG_INFO");
    op.warning("LOG_WARNING");
    op.error("LOG_ERR");
}

} // namespace tarrow
