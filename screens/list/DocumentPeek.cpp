// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/list/DocumentPeek.h"

#include "kit/controllers/AlertController.h"
#include "kit/views/TapRecognizer.h"
#include "kit/views/View.h"
#include "platform/Dispatch.h"
#include "platform/Localization.h"
#include "platform/Services.h"
#include "platform/Weakly.h"
#include "screens/PlatformNames.h"

#include <utility>

namespace screens {

namespace {

/// Holds the peeked screen in a place of fixed height.
class Miniature : public kit::ViewController {
public:
    Miniature(std::shared_ptr<kit::ViewController> screen, std::function<void()> ended)
        : _ended(std::move(ended))
        , _screen(std::move(screen))
    {
    }

    void loadView() override
    {
        const auto place = std::make_shared<kit::View>();
        place->setPlacedByFrame(false);
        setView(place);
        addChildViewController(_screen);
        const auto& content = _screen->view();
        content->setPlacedByFrame(true);
        content->setAutoresizing({.flexibleWidth = true, .flexibleHeight = true});
        content->setFrame(place->bounds());
        place->addSubview(content);
        _screen->didMoveToParentViewController(shared_from_this());
        coverBy(place);
        kit::LayoutConstraint::activate(
            {place->heightAnchor().equalToConstant(DocumentPeek::miniatureHeight)});
    }

    void viewDidDisappear(bool animated) override
    {
        kit::ViewController::viewDidDisappear(animated);
        // The chosen action runs in this turn of the main queue, right after the peek has gone.
        services().dispatch().mainQueue()->async(std::exchange(_ended, [] {}));
    }

    /// Called when the miniature is tapped.
    void setOnTap(std::function<void()> onTap) { _onTap = std::move(onTap); }

    /// Releases the screen, so that it can be shown elsewhere.
    void release()
    {
        if (_screen->isViewLoaded())
            _screen->view()->removeFromSuperview();
        _screen->removeFromParentViewController();
    }

private:
    /// Covers the screen with a pane that takes the taps, so that a tap anywhere opens the item.
    void coverBy(const std::shared_ptr<kit::View>& place)
    {
        const auto pane = std::make_shared<kit::View>();
        pane->setAutoresizing({.flexibleWidth = true, .flexibleHeight = true});
        pane->setFrame(place->bounds());
        pane->setAccessibility({.label = {}, .hint = {}, .isHidden = true});
        pane->addGestureRecognizer(std::make_shared<kit::TapRecognizer>(weakly(this, [](Miniature& self) {
            if (self._onTap)
                self._onTap();
        })));
        place->addSubview(pane);
    }

    std::function<void()> _onTap, _ended;
    std::shared_ptr<kit::ViewController> _screen;
};

std::shared_ptr<kit::AlertAction> asAlertAction(const kit::MenuAction& action)
{
    const bool isDestructive = action.style == kit::MenuActionStyle::Destructive;
    auto made = std::make_shared<kit::AlertAction>(action.title,
        isDestructive ? kit::AlertActionStyle::Destructive : kit::AlertActionStyle::Default,
        [handler = action.handler](const auto&) { handler(); });
    made->setEnabled(action.enabled);
    return made;
}

} // namespace

std::shared_ptr<kit::AlertController> DocumentPeek::make(const std::string& title,
    const std::shared_ptr<kit::ViewController>& screen, const kit::Menu& actions, const Handlers& handlers)
{
    const auto peek =
        std::make_shared<kit::AlertController>(title, std::string(), kit::AlertStyle::ActionSheet);
    const auto miniature = std::make_shared<Miniature>(screen, handlers.ended);
    const auto opening = std::make_shared<kit::AlertAction>(localized("Open"), kit::AlertActionStyle::Default,
        [release = weakly(miniature, &Miniature::release), open = handlers.open](const auto&) {
            release();
            open();
        });
    peek->addAction(opening);
    peek->setPreferredAction(opening);
    for (const auto& action : actions)
        peek->addAction(asAlertAction(action));
    peek->addAction(std::make_shared<kit::AlertAction>(localized("Cancel"), kit::AlertActionStyle::Cancel));
    miniature->setOnTap(weakly(peek, [opening](kit::AlertController& shown) { shown.press(opening); }));
    peek->setContentViewController(miniature);
    return peek;
}

} // namespace screens
