// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "prompts/UIUtils.h"

#include "kit/controllers/AlertController.h"
#include "kit/values/Screen.h"
#include "kit/views/View.h"
#include "platform/Localization.h"

namespace tarrow {

using kit::AlertAction;
using kit::AlertController;
using platform::Error;
using platform::FileErrorCode;
using platform::localized;

namespace {

/// Answers a message for an error's code without any details of the failure.
std::string describeCode(const Error& error)
{
    if (error.is(FileErrorCode::Unsupported))
        return localized("This operation is not supported.");
    if (error.is(FileErrorCode::Cancelled))
        return localized("The item was kept because it was changed in the meantime.");
    return localized("Mishap exception");
}

std::string describe(const Error& error)
{
    for (const auto key :
        {platform::errorKey::localizedDescription, platform::errorKey::localizedFailureReason}) {
        if (auto text = error.text(key); text && !text->empty())
            return *text;
    }
    return describeCode(error);
}

std::string destinationName(const Error& error)
{
    const auto path = error.text(platform::errorKey::destinationFilePath);
    return path && !path->empty() ? platform::Url::fileURL(*path).lastPathComponent() : std::string();
}

/// Answers a name without its extension.
std::string stemOf(const std::string& name, const std::string& extension)
{
    return extension.empty() ? name : name.substr(0, name.size() - extension.size() - 1);
}

} // namespace

void UIUtils::showAlertMessageParentViewController(
    const std::string& title, const std::string& message, const Screen& parent)
{
    if (!parent)
        return;
    const auto alert = std::make_shared<AlertController>(title, message, kit::AlertStyle::Alert);
    alert->addAction(std::make_shared<AlertAction>(localized("OK"), kit::AlertActionStyle::Default));
    parent->presentViewController(alert, true);
}

void UIUtils::showErrorParentViewController(const MaybeError& error, const Screen& parent)
{
    showAlertMessageParentViewController(
        error ? describe(*error) : localized("Mishap exception"), {}, parent);
}

void UIUtils::showErrorsTitleParentViewController(
    const std::vector<Error>& errors, const std::string& title, const Screen& parent)
{
    if (errors.size() == 1)
        return showErrorParentViewController(errors.front(), parent);
    // More would not fit on a small screen.
    constexpr std::size_t mostReasons = 3;
    std::string reasons;
    for (std::size_t i = 0; i < std::min(errors.size(), mostReasons); ++i)
        reasons += (i == 0 ? "" : "\n") + describe(errors[i]);
    showAlertMessageParentViewController(title, reasons, parent);
}

void UIUtils::showUnsupportedError(const Screen& parent)
{
    showErrorParentViewController(Error(FileErrorCode::Unsupported), parent);
}

std::string UIUtils::bestMessage(const MaybeError& error)
{
    if (!error)
        return {};
    switch (static_cast<FileErrorCode>(error->code())) {
    case FileErrorCode::ItemExists:
        return localized("Name is already taken");
    case FileErrorCode::InvalidName:
        return localized("Character not allowed in filename");
    default:
        return describe(*error);
    }
}

void UIUtils::showFriendlyMoveErrorParentViewController(const Error& error, const Screen& parent)
{
    showFriendlyMoveOrRenameErrorBasenameMovingToDirParentViewController(
        error, destinationName(error), true, parent);
}

void UIUtils::showFriendlyRenameErrorBasenameParentViewController(
    const Error& error, const std::string& name, const Screen& parent)
{
    showFriendlyMoveOrRenameErrorBasenameMovingToDirParentViewController(error, name, false, parent);
}

void UIUtils::showFriendlyMoveOrRenameErrorBasenameMovingToDirParentViewController(
    const Error& error, const std::string& name, bool movingToDir, const Screen& parent)
{
    switch (static_cast<FileErrorCode>(error.code())) {
    case FileErrorCode::ItemExists:
        showItemExistsAlertMovingToDirParentViewController(name, movingToDir, parent);
        break;
    case FileErrorCode::InvalidName:
        showInvalidItemNameAlertParentViewController(name, parent);
        break;
    default:
        showErrorParentViewController(error, parent);
    }
}

void UIUtils::showItemExistsAlertMovingToDirParentViewController(
    const std::string& name, bool movingToDir, const Screen& parent)
{
    if (movingToDir) {
        const auto title = localized("An item named “%@” already exists in the new location.", {name});
        showAlertMessageParentViewController(title, {}, parent);
        return;
    }
    const auto extension = platform::Url::fileURL("/").appendingPathComponent(name).pathExtension();
    const auto stem = stemOf(name, extension);
    const auto title = extension.empty()
        ? localized("The name “%@” is already taken.", {stem})
        : localized("The name “%1$@” with extension “.%2$@” is already taken.", {stem, extension});
    showAlertMessageParentViewController(title, localized("Choose a different name."), parent);
}

void UIUtils::showInvalidItemNameAlertParentViewController(const std::string& name, const Screen& parent)
{
    const auto message = localized("The name “%@” can’t be used. Try using a name with fewer characters, or "
                                   "with no punctuation marks.",
        {name});
    showAlertMessageParentViewController({}, message, parent);
}

bool UIUtils::tabulaMode()
{
    const auto& screen = kit::Screen::main();
    return screen && screen->idiom == kit::UserInterfaceIdiom::Tablet;
}

void UIUtils::addChildViewControllerChildViewController(const Screen& parent, const Screen& child)
{
    parent->addChildViewController(child);
    parent->view()->addSubview(child->view());
    child->didMoveToParentViewController(parent);
}

} // namespace tarrow
