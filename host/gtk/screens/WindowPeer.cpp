// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/screens/WindowPeer.h"

#include "host/gtk/preview/NotePeer.h"
#include "host/gtk/preview/PreviewPeer.h"
#include "host/gtk/screens/FileOffers.h"
#include "host/gtk/screens/LayerFactory.h"
#include "host/gtk/screens/ToastTitle.h"
#include "kit/controllers/ViewController.h"
#include "kit/values/KeyboardNotice.h"
#include "platform/Localization.h"
#include "platform/NotificationCenter.h"
#include "platform/Services.h"
#include "platform/Weakly.h"

#include <algorithm>

namespace host::gtk {
using platform::Size;
using platform::weakly;

namespace {

constexpr double lowWindow = 480; ///< points; a lower window has a compact height

} // namespace

std::shared_ptr<WindowPeer> WindowPeer::make(AdwApplication* application,
    const std::shared_ptr<kit::Window>& window, const WindowSize& size,
    const std::shared_ptr<PreviewModule>& previews)
{
    auto peer = std::make_shared<WindowPeer>(application, window, size, previews);
    window->setObserver(peer);
    peer->showRoot();
    return peer;
}

WindowPeer::WindowPeer(AdwApplication* application, const std::shared_ptr<kit::Window>& window,
    const WindowSize& size, const std::shared_ptr<PreviewModule>& previews)
    : _model(window)
    , _theme(std::make_shared<Theme>())
    , _measurer(std::make_shared<PangoTextMeasurer>(_theme))
    , _context(std::make_shared<PeerContext>(_theme, std::make_shared<FrameScheduler>()))
    , _bin(std::make_unique<SizedBin>([this](Size newSize) { resized(newSize); }))
{
    build(application, size);
    _theme->setReference(_window.get());
    _theme->setOnChange([this] { themeChanged(); });
    addPreviewMakers(*_context, previews);
    addNoteMaker(*_context);
    _context->scheduler().attach(_window.get());
    kit::TextMeasurer::install(_measurer);
    connectWindow();
    connectInput();
    connectUndo();
    connectFileOffers(_window.get(), window);
}

WindowPeer::~WindowPeer()
{
    _connections.clear();
    _stateConnection.disconnect();
    kit::TextMeasurer::install(nullptr);
    _layers.clear();
    _leaving.clear();
    _root.reset();
    _bin->setChild(nullptr);
    gtk_window_destroy(window());
}

void WindowPeer::build(AdwApplication* application, const WindowSize& size)
{
    auto* made = application ? adw_application_window_new(GTK_APPLICATION(application))
                             : GTK_WIDGET(g_object_new(ADW_TYPE_APPLICATION_WINDOW, nullptr));
    _window = ObjectRef<GtkWidget>::retain(made);
    _overlay = gtk_overlay_new();
    _toasts = ADW_TOAST_OVERLAY(adw_toast_overlay_new());
    gtk_overlay_set_child(GTK_OVERLAY(_overlay), GTK_WIDGET(_toasts));
    _bin->setChild(_overlay);
    adw_application_window_set_content(ADW_APPLICATION_WINDOW(made), _bin->widget());
    gtk_window_set_title(window(), platform::localized("Tarrow Drive").c_str());
    gtk_widget_set_size_request(made, minimumWidth, minimumHeight);
    gtk_window_set_default_size(window(), size.width, size.height);
    if (size.isMaximized)
        gtk_window_maximize(window());
}

void WindowPeer::connectWindow()
{
    _connections.push_back(connectNotify(_window.get(), "notify::scale-factor", [this] {
        if (_bin->size().width > 0)
            resized(_bin->size());
    }));
    _connections.push_back(connectNotify(_window.get(), "notify::is-active", [this] {
        if (const auto call = _onFocusLost; call && !gtk_window_is_active(window()))
            call();
    }));
    _connections.push_back(connectSignal<void()>(_window.get(), "realize", [this] { connectSurface(); }));
    _connections.push_back(connectSignal<gboolean()>(_window.get(), "close-request", [this]() -> gboolean {
        closed();
        return FALSE;
    }));
}

void WindowPeer::connectSurface()
{
    auto* surface = gtk_native_get_surface(GTK_NATIVE(_window.get()));
    _stateConnection = connectNotify(surface, "notify::state", [this, surface] {
        const bool isMinimized =
            (gdk_toplevel_get_state(GDK_TOPLEVEL(surface)) & GDK_TOPLEVEL_STATE_MINIMIZED) != 0;
        if (std::exchange(_isMinimized, isMinimized) == isMinimized)
            return;
        if (const auto call = _onMinimized)
            call(isMinimized);
    });
}

void WindowPeer::connectInput()
{
    auto* keys = gtk_event_controller_key_new();
    gtk_widget_add_controller(_window.get(), keys);
    _connections.push_back(connectSignal<gboolean(guint, guint, GdkModifierType)>(
        keys, "key-pressed", [this](guint key, guint, GdkModifierType modifiers) -> gboolean {
            const bool isAlt = (modifiers & GDK_ALT_MASK) != 0;
            const guint backArrow =
                gtk_widget_get_direction(_window.get()) == GTK_TEXT_DIR_RTL ? GDK_KEY_Right : GDK_KEY_Left;
            if (key == GDK_KEY_Escape || key == GDK_KEY_Back || (isAlt && key == backArrow))
                return goBack();
            return FALSE;
        }));
    constexpr unsigned mouseBackButton = 8;
    auto* click = gtk_gesture_click_new();
    gtk_gesture_single_set_button(GTK_GESTURE_SINGLE(click), mouseBackButton);
    gtk_event_controller_set_propagation_phase(GTK_EVENT_CONTROLLER(click), GTK_PHASE_CAPTURE);
    gtk_widget_add_controller(_window.get(), GTK_EVENT_CONTROLLER(click));
    _connections.push_back(connectSignal<void(int, double, double)>(
        click, "pressed", [this](int, double, double) { goBack(); }));
}

/// A text that has the keyboard undoes its own edits, and nothing else is undone while there are none.
void WindowPeer::connectUndo()
{
    const auto call = [](GtkWidget*, GVariant*, gpointer data) -> gboolean {
        auto& self = *static_cast<WindowPeer*>(data);
        auto* focus = gtk_window_get_focus(self.window());
        const auto shown = self.model();
        return shown && !GTK_IS_TEXT(focus) && !GTK_IS_TEXT_VIEW(focus) && shown->undoRequested();
    };
    auto* keys = gtk_shortcut_controller_new();
    gtk_shortcut_controller_add_shortcut(GTK_SHORTCUT_CONTROLLER(keys),
        gtk_shortcut_new(gtk_keyval_trigger_new(GDK_KEY_z, GDK_CONTROL_MASK),
            gtk_callback_action_new(call, this, nullptr)));
    gtk_widget_add_controller(_window.get(), keys);
}

bool WindowPeer::goBack()
{
    const auto keepsSelf = shared_from_this();
    const auto shown = model();
    return shown && shown->backRequested();
}

void WindowPeer::closed()
{
    const auto keepsSelf = shared_from_this();
    if (const auto call = _onClosed)
        call();
    if (const auto shown = model())
        shown->closed();
}

void WindowPeer::show()
{
    gtk_window_present(window());
}

void WindowPeer::showRoot()
{
    const auto shown = model();
    const auto root = shown ? shown->rootViewController() : nullptr;
    adw_toast_overlay_set_child(_toasts, nullptr);
    if (_root)
        _context->scheduler().release(std::exchange(_root, nullptr));
    if (!root)
        return;
    _root = makeScreenPeer(_context, root, WindowButtons::Shown);
    adw_toast_overlay_set_child(_toasts, _root->widget());
}

void WindowPeer::rootDidChange(kit::Window&)
{
    showRoot();
}

kit::TraitCollection WindowPeer::traits(Size size) const
{
    kit::TraitCollection traits;
    traits.horizontalSizeClass = size.width < wideWindow ? kit::SizeClass::Compact : kit::SizeClass::Regular;
    traits.verticalSizeClass = size.height < lowWindow ? kit::SizeClass::Compact : kit::SizeClass::Regular;
    traits.layoutDirection = gtk_widget_get_direction(_window.get()) == GTK_TEXT_DIR_RTL
        ? kit::LayoutDirection::RightToLeft
        : kit::LayoutDirection::LeftToRight;
    traits.displayScale = gtk_widget_get_scale_factor(_window.get());
    traits.colorScheme = _theme->isDark() ? kit::ColorScheme::Dark : kit::ColorScheme::Light;
    return traits;
}

void WindowPeer::updateScreen(Size size) const
{
    kit::Screen screen;
    screen.bounds = {0, 0, size.width, size.height};
    screen.scale = gtk_widget_get_scale_factor(_window.get());
    screen.idiom = size.width < wideWindow ? kit::UserInterfaceIdiom::Phone : kit::UserInterfaceIdiom::Tablet;
    kit::Screen::setMain(screen);
}

void WindowPeer::resized(Size size)
{
    updateScreen(size);
    kit::TraitCollection::setApplication(traits(size));
    if (const auto shown = model())
        shown->resized(size, traits(size));
    const auto* focused = gtk_window_get_focus(window());
    const auto event = _keyboard.resized(size, focused && GTK_IS_TEXT(focused));
    if (event != KeyboardWatch::Event::None)
        // The screens know their new places in the next frame.
        _context->scheduler().schedule(&_keyboard, weakly(this, &WindowPeer::tellOfKeyboard, event));
}

/// The keyboard stands below the window, which has made room for it.
void WindowPeer::tellOfKeyboard(KeyboardWatch::Event event) const
{
    const auto size = _bin->size();
    kit::KeyboardNotice notice;
    notice.beginFrame = notice.endFrame = {0, size.height, size.width, _keyboard.height()};
    platform::services().notificationCenter().post(event == KeyboardWatch::Event::Appears
            ? platform::Notification::KeyboardWillShow
            : platform::Notification::KeyboardWillHide,
        notice.toUserInfo());
}

void WindowPeer::themeChanged()
{
    _measurer->themeDidChange();
    const auto size = _bin->size();
    if (size.width > 0)
        resized(size);
    _context->themeDidChange();
}

WindowSize WindowPeer::currentSize() const
{
    WindowSize size;
    gtk_window_get_default_size(window(), &size.width, &size.height);
    size.isMaximized = gtk_window_is_maximized(window());
    return size;
}

void WindowPeer::windowWillPresent(
    kit::Window&, const kit::Presentation& presentation, kit::TransitionToken token)
{
    const LayerSite site{GTK_OVERLAY(_overlay), _bin->widget(), _bin->size()};
    const bool moves =
        presentation.animated && _theme->animationsEnabled() && gtk_widget_get_mapped(_overlay);
    Layer layer{presentation.presented.get(), makeLayer(_context, site, presentation.presented),
        ObjectRef<GtkWidget>::retain(gtk_window_get_focus(window()))};
    const auto shown = layer.layer;
    _layers.push_back(std::move(layer));
    coverAllButTop();
    shown->show(moves, [token] { token.finish(); });
    shown->focus();
}

/// Gives the focus back to the widget that had it. When that widget is gone, nothing gets the focus, because
/// the first widget of the window would be a surprise.
void WindowPeer::giveFocusBack(GtkWidget* before) const
{
    const bool isThere =
        before && gtk_widget_get_root(before) == GTK_ROOT(_window.get()) && gtk_widget_get_mapped(before);
    if (isThere)
        gtk_widget_grab_focus(before);
    else
        gtk_window_set_focus(window(), nullptr);
}

void WindowPeer::windowWillDismiss(
    kit::Window&, const kit::Presentation& presentation, kit::TransitionToken token)
{
    const auto found = std::ranges::find(
        _layers, presentation.presented.get(), [](const Layer& layer) { return layer.screen; });
    if (found == _layers.end()) {
        token.finish();
        return;
    }
    const Layer gone = std::move(*found);
    _layers.erase(found);
    coverAllButTop();
    giveFocusBack(gone.focusBefore.get());
    const bool moves =
        presentation.animated && _theme->animationsEnabled() && gtk_widget_get_mapped(_overlay);
    _leaving.push_back(gone.layer);
    const auto hasGone = weakly(
        this, [layer = std::weak_ptr(gone.layer)](WindowPeer& self) { self.layerHasGone(layer.lock()); });
    gone.layer->hide(moves, [hasGone, token] {
        hasGone();
        token.finish();
    });
}

void WindowPeer::windowShowsNotice(kit::Window&, const std::string& text, const kit::NoticeAction& action)
{
    constexpr int lines = 3;
    auto* toast = adw_toast_new("");
    adw_toast_set_custom_title(toast, makeToastTitle(text, lines));
    // A later message means that an earlier one's button is not about the latest change any more.
    if (_offer)
        adw_toast_dismiss(_offer.get());
    _offer.reset();
    if (!action.title.empty()) {
        _offer = ObjectRef<AdwToast>::retain(toast);
        adw_toast_set_button_label(toast, action.title.c_str());
        connectForLife<void()>(toast, "button-clicked", action.run);
    }
    adw_toast_overlay_add_toast(_toasts, toast);
}

/// The layer is kept alive a little longer, because this is called from one of its own signals.
void WindowPeer::layerHasGone(const std::shared_ptr<PresentedLayer>& layer)
{
    std::erase(_leaving, layer);
    _context->scheduler().release(layer);
}

void WindowPeer::coverAllButTop()
{
    auto* root = gtk_overlay_get_child(GTK_OVERLAY(_overlay));
    const bool covered = !_layers.empty();
    if (root) {
        gtk_widget_set_can_focus(root, !covered);
        gtk_widget_set_can_target(root, !covered);
        gtk_accessible_update_state(
            GTK_ACCESSIBLE(root), GTK_ACCESSIBLE_STATE_HIDDEN, covered ? TRUE : FALSE, -1);
    }
    for (auto& layer : _layers)
        layer.layer->setCovered(&layer != &_layers.back());
}

} // namespace host::gtk
