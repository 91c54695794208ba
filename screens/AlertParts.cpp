// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/AlertParts.h"

#include "platform/Localization.h"

#include <utility>

namespace platform::components {

std::shared_ptr<ui::AlertAction> alertAction(
    std::string title, ui::AlertActionStyle style, std::function<void()> act)
{
    return std::make_shared<ui::AlertAction>(std::move(title), style, [act = std::move(act)](const auto&) {
        if (act)
            act();
    });
}

std::shared_ptr<ui::AlertController> messageAlert(const std::string& title, const std::string& words)
{
    auto alert = std::make_shared<ui::AlertController>(title, words, ui::AlertStyle::Alert);
    alert->addAction(alertAction(localized("OK"), ui::AlertActionStyle::Default));
    return alert;
}

} // namespace platform::components
