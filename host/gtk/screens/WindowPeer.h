// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/PangoTextMeasurer.h"
#include "host/gtk/base/PeerContext.h"
#include "host/gtk/base/SizedBin.h"
#include "host/gtk/screens/KeyboardWatch.h"
#include "host/gtk/screens/PresentedLayer.h"
#include "host/gtk/screens/ScreenPeer.h"
#include "kit/controllers/Window.h"

#include <adwaita.h>

#include <memory>
#include <string>
#include <vector>

namespace host::gtk {

class PreviewModule;

/// The size of the window when it was last open.
struct WindowSize {
    int width = 900, height = 700; ///< points
    bool isMaximized = false;
    bool operator==(const WindowSize&) const = default;
};

/// Shows the application's window: the root screen, and layers over it for presented screens.
class WindowPeer : public kit::WindowObserver, public std::enable_shared_from_this<WindowPeer> {
public:
    /// `application` may be null; the window then belongs to no application.
    static std::shared_ptr<WindowPeer> make(AdwApplication* application,
        const std::shared_ptr<kit::Window>& window, const WindowSize& size,
        const std::shared_ptr<PreviewModule>& previews);
    WindowPeer(AdwApplication* application, const std::shared_ptr<kit::Window>& window,
        const WindowSize& size, const std::shared_ptr<PreviewModule>& previews);
    ~WindowPeer() override;

    void show();
    GtkWindow* window() const { return GTK_WINDOW(_window.get()); }
    /// Answers the overlay for short messages, over the root screen and below presented screens.
    AdwToastOverlay* toasts() const { return _toasts; }
    const std::shared_ptr<PeerContext>& context() const { return _context; }
    ScreenPeer* rootPeer() const { return _root.get(); }
    std::shared_ptr<kit::Window> model() const { return _model.lock(); }
    WindowSize currentSize() const;
    /// The callback runs when the window is minimised, and with false when it is shown again. A Wayland
    /// compositor does not tell.
    void setOnMinimized(std::function<void(bool)> callback) { _onMinimized = std::move(callback); }
    /// The callback runs when the user turns to another window.
    void setOnFocusLost(std::function<void()> callback) { _onFocusLost = std::move(callback); }
    /// The callback runs before the window's screens disappear because the user closed it.
    void setOnClosed(std::function<void()> callback) { _onClosed = std::move(callback); }

    static constexpr int minimumWidth = 360,
                         minimumHeight = 294; ///< the size of a phone's screen above its keyboard

    void rootDidChange(kit::Window& window) override;
    void windowWillPresent(
        kit::Window& window, const kit::Presentation& presentation, kit::TransitionToken token) override;
    void windowWillDismiss(
        kit::Window& window, const kit::Presentation& presentation, kit::TransitionToken token) override;
    void windowShowsNotice(
        kit::Window& window, const std::string& text, const kit::NoticeAction& action) override;

private:
    struct Layer {
        const kit::ViewController* screen;
        std::shared_ptr<PresentedLayer> layer;
        ObjectRef<GtkWidget> focusBefore;
    };
    void build(AdwApplication* application, const WindowSize& size);
    void connectInput();
    void connectUndo();
    void connectWindow();
    void connectSurface();
    void showRoot();
    void resized(platform::Size size);
    kit::TraitCollection traits(platform::Size size) const;
    void updateScreen(platform::Size size) const;
    void themeChanged();
    void tellOfKeyboard(KeyboardWatch::Event event) const;
    void coverAllButTop();
    void giveFocusBack(GtkWidget* before) const;
    void layerHasGone(const std::shared_ptr<PresentedLayer>& layer);
    bool goBack();
    void closed();

    std::weak_ptr<kit::Window> _model;
    std::shared_ptr<Theme> _theme;
    std::shared_ptr<PangoTextMeasurer> _measurer;
    std::shared_ptr<PeerContext> _context;
    ObjectRef<GtkWidget> _window;
    std::unique_ptr<SizedBin> _bin;
    KeyboardWatch _keyboard;
    AdwToastOverlay* _toasts = nullptr;
    ObjectRef<AdwToast> _offer; ///< the latest message with a button
    GtkWidget* _overlay = nullptr;
    std::shared_ptr<ScreenPeer> _root;
    std::vector<Layer> _layers; ///< the topmost last
    std::vector<std::shared_ptr<PresentedLayer>> _leaving;
    bool _isMinimized = false;
    std::function<void(bool)> _onMinimized;
    std::function<void()> _onFocusLost;
    std::function<void()> _onClosed;
    SignalConnections _connections;
    SignalConnection _stateConnection; ///< to the window's surface
};

} // namespace host::gtk
