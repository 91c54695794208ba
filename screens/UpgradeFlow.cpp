// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/UpgradeFlow.h"

#include "kit/controllers/AlertController.h"
#include "platform/LinkOpener.h"
#include "platform/Localization.h"
#include "platform/Services.h"
#include "platform/Weakly.h"
#include "screens/ErrorWords.h"

#include <utility>

namespace screens {

namespace {

using kit::AlertAction;
using kit::AlertActionStyle;

std::shared_ptr<kit::AlertController> makeAlert(const std::string& title, const std::string& message)
{
    return std::make_shared<kit::AlertController>(title, message, kit::AlertStyle::Alert);
}

void showFailure(kit::ViewController& presenter, const Error& error)
{
    const auto alert = makeAlert(localized("The page cannot be opened"), errorWords(error));
    alert->addAction(std::make_shared<AlertAction>(localized("OK"), AlertActionStyle::Cancel));
    presenter.presentViewController(alert, true);
}

} // namespace

std::shared_ptr<UpgradeFlow> UpgradeFlow::initWithOffer(std::shared_ptr<const StorageOffer> offer)
{
    return std::make_shared<UpgradeFlow>(std::move(offer));
}

void UpgradeFlow::beginWithPresentingViewController(const std::shared_ptr<kit::ViewController>& presenter)
{
    if (!_offer || !presenter)
        return;
    const auto alert = makeAlert(localized("Get More Storage"),
        localized("The page where you can choose more storage for your drive opens in your web browser."));
    alert->addAction(std::make_shared<AlertAction>(localized("Cancel"), AlertActionStyle::Cancel));
    const auto proceed = std::make_shared<AlertAction>(localized("Open Page"), AlertActionStyle::Default,
        weakly(
            presenter, [self = shared_from_this()](kit::ViewController& screen) { self->openPage(screen); }));
    proceed->setEnabled(!_offer->link.target.empty());
    alert->addAction(proceed);
    alert->setPreferredAction(proceed);
    presenter->presentViewController(alert, true);
}

void UpgradeFlow::openPage(kit::ViewController& presenter)
{
    services().linkOpener().openLink(_offer->link.target,
        weakly(&presenter, [](kit::ViewController& screen, const std::optional<Error>& error) {
            if (error)
                showFailure(screen, *error);
        }));
}

} // namespace screens
