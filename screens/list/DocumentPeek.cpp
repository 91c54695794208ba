// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/list/DocumentPeek.h"

#include "kit/controllers/AlertController.h"
#include "kit/views/TapRecognizer.h"
#include "kit/views/View.h"
#include "platform/Localization.h"

#include <utility>

namespace platform::components {

namespace {

/// Holds the peeked screen in a place of fixed height.
class Miniature : public ui::ViewController {
public:
    explicit Miniature(std::shared_ptr<ui::ViewController> screen)
        : _screen(std::move(screen))
    {
    }

    void loadView() override
    {
        const auto place = std::make_shared<ui::View>();
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
        ui::LayoutConstraint::activate(
            {place->heightAnchor().equalToConstant(DocumentPeek::miniatureHeight)});
    }

    /// Called when the miniature is tapped.
    void setOnTap(std::function<void()> onTap) { _onTap = std::move(onTap); }

    /// Lets the screen go, so that it can be shown elsewhere.
    void release()
    {
        if (_screen->isViewLoaded())
            _screen->view()->removeFromSuperview();
        _screen->removeFromParentViewController();
    }

private:
    /// A pane that takes the taps, so that a miniature opens as a whole.
    void coverBy(const std::shared_ptr<ui::View>& place)
    {
        const auto pane = std::make_shared<ui::View>();
        pane->setAutoresizing({.flexibleWidth = true, .flexibleHeight = true});
        pane->setFrame(place->bounds());
        pane->setAccessibility({.label = {}, .hint = {}, .isHidden = true});
        pane->addGestureRecognizer(std::make_shared<ui::TapRecognizer>([weak = weak_from_this()](Point) {
            const auto self = std::static_pointer_cast<Miniature>(weak.lock());
            if (self && self->_onTap)
                self->_onTap();
        }));
        place->addSubview(pane);
    }

    std::function<void()> _onTap;
    std::shared_ptr<ui::ViewController> _screen;
};

std::shared_ptr<ui::AlertAction> asAlertAction(const ui::MenuAction& action)
{
    const bool isDestructive = action.style == ui::MenuActionStyle::Destructive;
    auto made = std::make_shared<ui::AlertAction>(action.title,
        isDestructive ? ui::AlertActionStyle::Destructive : ui::AlertActionStyle::Default,
        [handler = action.handler](const auto&) { handler(); });
    made->setEnabled(action.enabled);
    return made;
}

} // namespace

std::shared_ptr<ui::AlertController> DocumentPeek::make(const std::string& title,
    const std::shared_ptr<ui::ViewController>& screen, const ui::Menu& actions, std::function<void()> open)
{
    const auto peek =
        std::make_shared<ui::AlertController>(title, std::string(), ui::AlertStyle::ActionSheet);
    const auto miniature = std::make_shared<Miniature>(screen);
    const auto opening = std::make_shared<ui::AlertAction>(localized("Open"), ui::AlertActionStyle::Default,
        [weak = std::weak_ptr(miniature), open = std::move(open)](const auto&) {
            if (const auto held = weak.lock())
                held->release();
            open();
        });
    peek->addAction(opening);
    peek->setPreferredAction(opening);
    for (const auto& action : actions)
        peek->addAction(asAlertAction(action));
    peek->addAction(std::make_shared<ui::AlertAction>(localized("Cancel"), ui::AlertActionStyle::Cancel));
    miniature->setOnTap([weak = std::weak_ptr(peek), opening] {
        if (const auto shown = weak.lock())
            shown->press(opening);
    });
    peek->setContentViewController(miniature);
    return peek;
}

} // namespace platform::components
