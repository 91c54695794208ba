// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/app/GtkApplicationLoop.h"

#include "host/gtk/app/BroadwayServer.h"
#include "host/gtk/app/RemoteInstance.h"
#include "host/gtk/screens/HandOverToasts.h"
#include "kit/controllers/AlertController.h"
#include "kit/controllers/InterfaceState.h"
#include "kit/controllers/ViewController.h"
#include "platform/DocumentSharing.h"
#include "platform/LauncherShortcuts.h"
#include "platform/Localization.h"
#include "platform/NotificationCenter.h"
#include "platform/Services.h"
#include "platform/UserDefaults.h"

#include <glib-unix.h>

#include <csignal>
#include <iostream>
#include <sysexits.h>
#include <utility>

namespace host::gtk {

using platform::Notification;
using platform::PropertyDictionary;
using platform::ShortcutItem;
using platform::UserActivity;

namespace {

namespace StateKey {
constexpr const char* interface = "interface";
constexpr const char* application = "application";
constexpr const char* width = "width";
constexpr const char* height = "height";
constexpr const char* maximized = "maximized";
constexpr const char* window = "window";
} // namespace StateKey

/// A stored window size is limited to this, so that a damaged file cannot make the window unusable.
constexpr std::int64_t largestSide = 16384;

PropertyDictionary dictionaryAt(const PropertyDictionary& values, std::string_view key)
{
    const auto* value = platform::find(values, key);
    const auto* dictionary = value ? value->get<PropertyDictionary>() : nullptr;
    return dictionary ? *dictionary : PropertyDictionary();
}

WindowSize storedSize(const StateFile& file)
{
    const auto stored = dictionaryAt(file.values(), StateKey::window);
    WindowSize size;
    const auto read = [&](const char* key, int& side, int least) {
        const auto* value = platform::find(stored, key);
        const auto number = value ? value->asInteger() : std::nullopt;
        if (number && *number >= least && *number <= largestSide)
            side = static_cast<int>(*number);
    };
    read(StateKey::width, size.width, WindowPeer::minimumWidth);
    read(StateKey::height, size.height, WindowPeer::minimumHeight);
    const auto* maximized = platform::find(stored, StateKey::maximized);
    size.isMaximized = maximized && maximized->get<bool>() && *maximized->get<bool>();
    return size;
}

PropertyDictionary dictionaryOf(const WindowSize& size)
{
    return {{StateKey::width, size.width}, {StateKey::height, size.height},
        {StateKey::maximized, size.isMaximized}};
}

/// Answers the value for each type that an activity may carry over the bus.
platform::PropertyValue valueOf(GVariant* variant)
{
    if (g_variant_is_of_type(variant, G_VARIANT_TYPE_STRING))
        return std::string(g_variant_get_string(variant, nullptr));
    if (g_variant_is_of_type(variant, G_VARIANT_TYPE_BOOLEAN))
        return g_variant_get_boolean(variant) != FALSE;
    if (g_variant_is_of_type(variant, G_VARIANT_TYPE_INT32))
        return g_variant_get_int32(variant);
    if (g_variant_is_of_type(variant, G_VARIANT_TYPE_INT64))
        return static_cast<std::int64_t>(g_variant_get_int64(variant));
    if (g_variant_is_of_type(variant, G_VARIANT_TYPE_UINT64))
        return static_cast<std::uint64_t>(g_variant_get_uint64(variant));
    if (g_variant_is_of_type(variant, G_VARIANT_TYPE_DOUBLE))
        return g_variant_get_double(variant);
    return {};
}

UserActivity activityOf(GVariant* dictionary)
{
    UserActivity activity;
    GVariantIter entries;
    g_variant_iter_init(&entries, dictionary);
    const char* key = nullptr;
    GVariant* value = nullptr;
    while (g_variant_iter_next(&entries, "{&sv}", &key, &value)) {
        if (std::string_view(key) == "type" && g_variant_is_of_type(value, G_VARIANT_TYPE_STRING))
            activity.type = g_variant_get_string(value, nullptr);
        else
            activity.userInfo.insert_or_assign(key, valueOf(value));
        g_variant_unref(value);
    }
    return activity;
}

ShortcutItem searchShortcut()
{
    return {std::string(platform::ShortcutTypeSearch), {}};
}

/// Answers the shortcut that was kept, or one without a document, for which the delegate says that there is
/// none.
ShortcutItem recentDocumentShortcut()
{
    return platform::services().launcherShortcuts().recentDocument().value_or(
        ShortcutItem{std::string(platform::ShortcutTypeRecentDocument), {}});
}

/// Answers the launcher's shortcut for which a request stands; nothing for every other request.
std::optional<ShortcutItem> shortcutOf(const LaunchRequest& request)
{
    if (const auto* search = std::get_if<OpenSearch>(&request); search && !search->query)
        return searchShortcut();
    return std::holds_alternative<OpenRecentDocument>(request) ? std::optional(recentDocumentShortcut())
                                                               : std::nullopt;
}

/// Other programs name the drive's documents by their files.
std::string schemeUrl(const std::string& url)
{
    const auto parsed = platform::Url::parse(url);
    return parsed && parsed->isFileURL() ? platform::linkToItem(*parsed) : url;
}

bool hasDisplayVariable()
{
    return g_getenv("DISPLAY") || g_getenv("WAYLAND_DISPLAY") || g_getenv("BROADWAY_DISPLAY");
}

} // namespace

std::unique_ptr<platform::Application> makeApplication(ApplicationSettings settings)
{
    return std::make_unique<GtkApplicationLoop>(std::move(settings));
}

GtkApplicationLoop::GtkApplicationLoop(ApplicationSettings settings)
    : _settings(std::move(settings))
    , _stateFile(_settings.stateFile, _settings.dispatch)
{
}

GtkApplicationLoop::~GtkApplicationLoop()
{
    _connections.clear();
    _handOver.reset();
    _delegate.reset();
    _windowHost.reset();
}

WindowPeer* GtkApplicationLoop::windowPeer() const
{
    return _windowHost ? _windowHost->windowPeer().get() : nullptr;
}

int GtkApplicationLoop::run(int argc, char** argv, const DelegateFactory& makeDelegate)
{
    const auto line = CommandLine::parse(argc, argv);
    switch (line.mode) {
    case CommandLine::Mode::Help:
        std::cout << CommandLine::helpText();
        return EX_OK;
    case CommandLine::Mode::Version:
        std::cout << "Tarrow Drive " << _settings.version << '\n';
        return EX_OK;
    case CommandLine::Mode::Invalid:
        std::cerr << line.complaint << '\n' << CommandLine::helpText();
        return EX_USAGE;
    case CommandLine::Mode::Run:
        if (RemoteInstance(_settings.applicationId).forward(line.requests))
            return EX_OK;
        break;
    case CommandLine::Mode::Service:
        break;
    }
    _makeDelegate = makeDelegate;
    return runPrimary(argv, line);
}

int GtkApplicationLoop::runPrimary(char** argv, const CommandLine& line)
{
    if (!openDisplay()) {
        std::cerr << platform::localized(
            "There is no display, and no Broadway server (gtk4-broadwayd) to stand in for one.")
                  << '\n';
        return EX_UNAVAILABLE;
    }
    Theme::registerResources();
    int flags = G_APPLICATION_HANDLES_OPEN;
    if (line.mode == CommandLine::Mode::Service)
        flags |= G_APPLICATION_IS_SERVICE;
    _application = ObjectRef<AdwApplication>::adopt(
        adw_application_new(_settings.applicationId.c_str(), static_cast<GApplicationFlags>(flags)));
    addActions();
    connectApplication();
    auto* application = G_APPLICATION(_application.get());
    g_application_register(application, nullptr, nullptr);
    // Another process may have taken the name since this one asked for it.
    if (g_application_get_is_remote(application))
        return RemoteInstance(_settings.applicationId).forward(line.requests) ? EX_OK : EX_UNAVAILABLE;
    _waiting = line.requests;
    const int status = g_application_run(application, 1, argv);
    _handOver.reset();
    if (_windowHost)
        _windowHost->close();
    return status;
}

bool GtkApplicationLoop::openDisplay()
{
    if (hasDisplayVariable() && gtk_init_check())
        return true;
    _broadway = BroadwayServer::start();
    if (!_broadway)
        return false;
    // After the initialisation failed above, the toolkit does not open a display by itself.
    if (!gtk_init_check() || (!gdk_display_get_default() && !gdk_display_open(nullptr)))
        return false;
    std::cout << platform::localized("Open %@ in a web browser on this machine.", {_broadway->address()})
              << '\n'
              << std::flush;
    return true;
}

void GtkApplicationLoop::connectApplication()
{
    auto* application = _application.get();
    _connections.push_back(connectSignal<void()>(application, "activate", [this] {
        if (!_delegate)
            launch({});
        else if (auto* window = windowPeer())
            window->show();
    }));
    _connections.push_back(connectSignal<void(GFile**, int, const char*)>(
        application, "open", [this](GFile** files, int count, const char*) {
            for (int i = 0; i < count; ++i) {
                char* uri = g_file_get_uri(files[i]);
                handle(OpenUrl{uri});
                g_free(uri);
            }
        }));
    _connections.push_back(connectSignal<void()>(application, "shutdown", [this] {
        resignActive();
        platform::services().notificationCenter().post(Notification::ApplicationWillTerminate);
    }));
    for (const int number : {SIGTERM, SIGINT})
        g_unix_signal_add(
            number,
            [](gpointer running) -> gboolean {
                g_application_quit(G_APPLICATION(running));
                return G_SOURCE_CONTINUE;
            },
            application);
}

void GtkApplicationLoop::addActions()
{
    const auto add = [this](const char* name, const GVariantType* type, auto handler) {
        const auto action = ObjectRef<GSimpleAction>::adopt(g_simple_action_new(name, type));
        _connections.push_back(connectSignal<void(GVariant*)>(action.get(), "activate", std::move(handler)));
        g_action_map_add_action(G_ACTION_MAP(_application.get()), G_ACTION(action.get()));
    };
    add(ActionNames::openUrl, G_VARIANT_TYPE_STRING,
        [this](GVariant* url) { handle(OpenUrl{g_variant_get_string(url, nullptr)}); });
    add(ActionNames::search, nullptr, [this](GVariant*) { handle(OpenSearch()); });
    add(ActionNames::recentDocument, nullptr, [this](GVariant*) { handle(OpenRecentDocument()); });
    add(ActionNames::continueActivity, G_VARIANT_TYPE_VARDICT,
        [this](GVariant* activity) { continueActivity(activityOf(activity)); });
}

/// Lets the delegate build the window, restores the state and ends the launch. Then it carries out the
/// requests of the command line.
void GtkApplicationLoop::launch(std::optional<ShortcutItem> shortcut)
{
    auto waiting = std::exchange(_waiting, {});
    if (!shortcut && !waiting.empty()) {
        shortcut = shortcutOf(waiting.front());
        if (shortcut)
            waiting.erase(waiting.begin());
    }
    gtk_widget_set_default_direction(
        platform::services().localization().isRightToLeft() ? GTK_TEXT_DIR_RTL : GTK_TEXT_DIR_LTR);
    auto size = storedSize(_stateFile);
    if (_broadway) {
        // In a browser the page is the whole screen, so a minimised window could not be brought back.
        size.isMaximized = true;
        g_object_set(gtk_settings_get_default(), "gtk-decoration-layout", ":", nullptr);
    }
    _windowHost = std::make_shared<GtkWindowHost>(_application.get(), size, _settings.previews);
    _windowHost->setOnShow([this](WindowPeer& window) { windowShown(window); });
    kit::WindowHost::install(_windowHost);
    _delegate = _makeDelegate();
    const platform::LaunchOptions options{shortcut};
    const bool remains = _delegate->applicationWillFinishLaunchingWithOptions(*this, options);
    // A restored preview would cover what the shortcut shows.
    if (!shortcut)
        restoreState();
    _delegate->applicationDidFinishLaunchingWithOptions(*this, options);
    activeChanged(true);
    if (shortcut && remains)
        perform(*shortcut);
    for (const auto& request : waiting)
        handle(request);
}

void GtkApplicationLoop::windowShown(WindowPeer& window)
{
    window.context()->firstList().setOnShown(_settings.onFirstList);
    window.setOnMinimized([this](bool minimized) { activeChanged(!minimized); });
    window.setOnFocusLost([this] { focusLost(); });
    window.setOnClosed([this] { resignActive(); });
    _handOver = HandOverToasts::make(
        window.toasts(), [this](const UserActivity& activity) { continueActivity(activity); },
        [this](const UserActivity& activity, const platform::Error& error) {
            failedToContinue(activity, error);
        });
}

void GtkApplicationLoop::handle(const LaunchRequest& request)
{
    if (const auto* open = std::get_if<OpenUrl>(&request)) {
        openUrl(schemeUrl(open->url));
    } else if (const auto shortcut = shortcutOf(request)) {
        perform(*shortcut);
    } else {
        UserActivity activity{std::string(platform::activityType::queryContinuation), {}};
        activity.userInfo.insert_or_assign(
            std::string(platform::activityKey::searchQuery), *std::get<OpenSearch>(request).query);
        continueActivity(activity);
    }
}

void GtkApplicationLoop::openUrl(const std::string& url)
{
    if (!_delegate)
        launch({});
    _delegate->applicationOpenURLOptions(*this, url, {});
    if (auto* window = windowPeer())
        window->show();
}

void GtkApplicationLoop::perform(const ShortcutItem& shortcut)
{
    if (!_delegate) {
        launch(shortcut);
        return;
    }
    _delegate->applicationPerformActionForShortcutItemCompletionHandler(*this, shortcut, [](bool) {});
    if (auto* window = windowPeer())
        window->show();
}

void GtkApplicationLoop::continueActivity(const UserActivity& activity)
{
    if (!_delegate)
        launch({});
    if (_delegate->applicationWillContinueUserActivityWithType(*this, activity.type))
        _delegate->applicationContinueUserActivityRestorationHandler(*this, activity, [] {});
    if (auto* window = windowPeer())
        window->show();
}

void GtkApplicationLoop::failedToContinue(const UserActivity& activity, const platform::Error& error)
{
    using namespace kit;
    _delegate->applicationDidFailToContinueUserActivityWithTypeError(*this, activity.type, error);
    const auto model = windowPeer() ? windowPeer()->model() : nullptr;
    if (!model || !model->rootViewController())
        return;
    const auto alert = std::make_shared<AlertController>(
        error.text(platform::errorKey::localizedDescription).value_or(""), "", AlertStyle::Alert);
    alert->addAction(std::make_shared<AlertAction>(platform::localized("OK"), AlertActionStyle::Default));
    model->rootViewController()->presentViewController(alert, true);
}

void GtkApplicationLoop::activeChanged(bool active)
{
    if (!_delegate || active == _active)
        return;
    if (!active) {
        resignActive();
        return;
    }
    _active = true;
    platform::services().notificationCenter().post(Notification::ApplicationDidBecomeActive);
}

void GtkApplicationLoop::resignActive()
{
    if (!_delegate || !std::exchange(_active, false))
        return;
    _delegate->applicationWillResignActive(*this);
    platform::services().notificationCenter().post(Notification::ApplicationWillResignActive);
    saveState();
}

/// The state is saved here as well, because the user may end the session from another window.
void GtkApplicationLoop::focusLost()
{
    if (!_active)
        return;
    platform::services().notificationCenter().post(Notification::ApplicationDidLoseFocus);
    saveState();
}

void GtkApplicationLoop::restoreState()
{
    const auto interface = dictionaryAt(_stateFile.values(), StateKey::interface);
    platform::StateCoder coder(dictionaryAt(_stateFile.values(), StateKey::application));
    const auto* window = windowPeer();
    const auto model = window ? window->model() : nullptr;
    const auto root = model ? model->rootViewController() : nullptr;
    if (!interface.empty() && root && _delegate->applicationShouldRestoreApplicationState(*this, coder))
        kit::decodeInterfaceState(*root, interface);
}

void GtkApplicationLoop::saveState()
{
    const auto* window = windowPeer();
    const auto model = window ? window->model() : nullptr;
    if (!model)
        return;
    _stateFile.set(StateKey::window, dictionaryOf(window->currentSize()));
    platform::StateCoder coder;
    const auto root = model->rootViewController();
    // The state of an account must not be restored for the next account.
    const bool allowed = root && _delegate->applicationShouldSaveApplicationState(*this, coder);
    _stateFile.set(
        StateKey::application, allowed ? platform::PropertyValue(coder.values()) : platform::PropertyValue());
    _stateFile.set(StateKey::interface,
        allowed ? platform::PropertyValue(kit::encodeInterfaceState(*root)) : platform::PropertyValue());
}

} // namespace host::gtk
