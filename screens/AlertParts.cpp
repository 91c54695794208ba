// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/AlertParts.h"

#include "platform/Localization.h"
#include "screens/PlatformNames.h"

#include <utility>

namespace screens {

std::shared_ptr<kit::AlertAction> alertAction(
    std::string title, kit::AlertActionStyle style, std::function<void()> act)
{
    return std::make_shared<kit::AlertAction>(std::move(title), style, [act = std::move(act)](const auto&) {
        if (act)
            act();
    });
}

std::shared_ptr<kit::AlertController> messageAlert(const std::string& title, const std::string& words)
{
    auto alert = std::make_shared<kit::AlertController>(title, words, kit::AlertStyle::Alert);
    alert->addAction(alertAction(localized("OK"), kit::AlertActionStyle::Default));
    return alert;
}

} // namespace screens
