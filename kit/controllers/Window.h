// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/Presentation.h"
#include "kit/controllers/WindowObserver.h"
#include "kit/values/ObserverSlot.h"
#include "kit/values/PlatformNames.h"
#include "kit/values/Screen.h"
#include "kit/values/TraitCollection.h"
#include "platform/Color.h"
#include "platform/Geometry.h"
#include "platform/Url.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace kit {

class ViewController;

/// The window of the application: a root screen and the screens presented over it. Made with
/// std::make_shared.
class Window : public std::enable_shared_from_this<Window> {
public:
    explicit Window(const Rect& bounds = {});
    ~Window();

    void setObserver(std::weak_ptr<WindowObserver> observer) { _observer.set(std::move(observer)); }

    const Rect& bounds() const { return _bounds; }
    const TraitCollection& traits() const { return _traits; }
    const std::optional<Color>& background() const { return _background; }
    void setBackground(std::optional<Color> color);
    InterfaceOrientation interfaceOrientation() const; ///< upright unless the window is wider than high

    const std::shared_ptr<ViewController>& rootViewController() const { return _root; }
    void setRootViewController(std::shared_ptr<ViewController> root);
    /// Shows the window through the installed host, if there is one, and makes the root screen appear.
    void makeKeyAndVisible();
    bool isVisible() const { return _visible; }

    /// Answers the screens over the root, the topmost last.
    std::vector<std::shared_ptr<ViewController>> presentedScreens() const;
    void layoutIfNeeded();

    /// Tells the user in a sentence of something that needs no answer, such as a document that another
    /// program has deleted. The message goes by itself after a few seconds.
    void showNotice(const std::string& text, const NoticeAction& action = {});

    // Events up: the host reports what happened to the window.
    void resized(Size size, const TraitCollection& traits);
    /// The user asks to go back by Escape, Alt+Left or the back gesture. The topmost presented screen is
    /// cancelled; else the Cancel button of the bar is pressed; else the navigation goes back. Answers false
    /// when there is nothing to go back to.
    bool backRequested();
    /// The user asks to undo the latest change. The root screen is asked, unless another screen lies over it.
    bool undoRequested();
    /// Files are held over the window, and dropped on it or pasted. The root screen is asked, unless another
    /// screen lies over it.
    bool takesFiles() const;
    bool filesOffered(const std::vector<platform::Url>& files);
    /// The window was closed, so its screens disappear.
    void closed();

    // View controllers call these.
    void finishTransition() { _transition.finish(); }
    void present(const Presentation& presentation, std::function<void()> completion);
    /// The model has already lost these screens, of which the topmost comes last. `presenting` presented the
    /// first one.
    void dismiss(std::vector<Presentation> presentations, std::function<void()> completion);

private:
    using Screens = std::vector<std::shared_ptr<ViewController>>;

    void attach(ViewController& screen);
    void dismissOne(const Presentation& presentation, std::function<void()> completion);
    void show(const Presentation& presentation, std::function<void()> completion);

    Rect _bounds;
    TraitCollection _traits;
    std::optional<Color> _background;
    std::shared_ptr<ViewController> _root;
    ObserverSlot<WindowObserver> _observer;
    TransitionToken _transition;
    bool _visible = false;
};

} // namespace kit
