// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/move/FolderNameAlert.h"

#include "kit/controllers/AlertController.h"
#include "kit/views/TextField.h"
#include "platform/Localization.h"
#include "screens/PlatformNames.h"

#include <utility>

namespace screens {

namespace {

constexpr std::size_t longestName = 255; ///< bytes; the limit of Linux file systems

std::string trimmed(const std::string& text)
{
    const auto first = text.find_first_not_of(" \t");
    return first == std::string::npos ? std::string()
                                      : text.substr(first, text.find_last_not_of(" \t") - first + 1);
}

bool canBeName(const std::string& name)
{
    return !name.empty() && name.front() != '.' && name.size() <= longestName
        && name.find_first_of("/:") == std::string::npos;
}

} // namespace

std::shared_ptr<kit::AlertController> makeFolderNameAlert(std::function<void(const std::string&)> chosen)
{
    const auto alert = std::make_shared<kit::AlertController>(
        localized("New Folder"), std::string(), kit::AlertStyle::Alert);
    const std::weak_ptr<kit::AlertController> weak = alert;
    alert->addTextField([](kit::TextField& field) {
        field.setPlaceholder(localized("Name"));
        field.setInputTraits(
            {.returnKey = kit::ReturnKey::Done, .clearButton = kit::ClearButton::WhileEditing});
    });
    alert->addAction(std::make_shared<kit::AlertAction>(localized("Cancel"), kit::AlertActionStyle::Cancel));
    const auto create = std::make_shared<kit::AlertAction>(
        localized("Create"), kit::AlertActionStyle::Default, [weak, chosen = std::move(chosen)](const auto&) {
            if (const auto asked = weak.lock())
                chosen(trimmed(asked->textFields().front()->text()));
        });
    create->setEnabled(false);
    alert->addAction(create);
    alert->setPreferredAction(create);
    alert->textFields().front()->setOnEditingChanged([weak, action = std::weak_ptr(create)] {
        const auto asked = weak.lock();
        const auto pressed = action.lock();
        if (asked && pressed)
            pressed->setEnabled(canBeName(trimmed(asked->textFields().front()->text())));
    });
    return alert;
}

} // namespace screens
