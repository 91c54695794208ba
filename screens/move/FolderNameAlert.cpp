// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/move/FolderNameAlert.h"

#include "kit/controllers/AlertController.h"
#include "kit/views/TextField.h"
#include "platform/Localization.h"
#include "platform/Weakly.h"
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

std::string nameIn(const kit::AlertController& alert)
{
    return trimmed(alert.textFields().front()->text());
}

} // namespace

std::shared_ptr<kit::AlertController> makeFolderNameAlert(std::function<void(const std::string&)> chosen)
{
    const auto alert = std::make_shared<kit::AlertController>(
        localized("New Folder"), std::string(), kit::AlertStyle::Alert);
    alert->addTextField([](kit::TextField& field) {
        field.setPlaceholder(localized("Name"));
        field.setInputTraits(
            {.returnKey = kit::ReturnKey::Done, .clearButton = kit::ClearButton::WhileEditing});
    });
    alert->addAction(std::make_shared<kit::AlertAction>(localized("Cancel"), kit::AlertActionStyle::Cancel));
    const auto create = std::make_shared<kit::AlertAction>(localized("Create"),
        kit::AlertActionStyle::Default,
        weakly(alert, [chosen = std::move(chosen)](kit::AlertController& asked) { chosen(nameIn(asked)); }));
    create->setEnabled(false);
    alert->addAction(create);
    alert->setPreferredAction(create);
    alert->textFields().front()->setOnEditingChanged(
        weakly(alert, [action = std::weak_ptr(create)](kit::AlertController& asked) {
            if (const auto pressed = action.lock())
                pressed->setEnabled(canBeName(nameIn(asked)));
        }));
    return alert;
}

} // namespace screens
