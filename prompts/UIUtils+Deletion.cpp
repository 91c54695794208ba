// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/DRItem.h"
#include "kit/controllers/AlertController.h"
#include "kit/controllers/BarButtonItem.h"
#include "kit/views/View.h"
#include "platform/Localization.h"
#include "prompts/UIUtils.h"

namespace tarrow {

using kit::AlertAction;
using kit::AlertActionStyle;
using kit::AlertController;
using platform::localized;

namespace {

using Pressed = std::shared_ptr<AlertAction>;

constexpr Operation op{"+[UIUtils showDeleteWarningAlert:hasContainer:viewController:usingView:usingButton:"
                       "completion:]"};

/// Answers a line across the view's middle, so that the popover's arrow may come from its ends.
kit::PopoverAnchor anchorOf(
    const std::shared_ptr<kit::View>& view, const std::shared_ptr<kit::BarButtonItem>& button)
{
    if (!view)
        return std::weak_ptr(button);
    const auto bounds = view->bounds();
    return kit::ViewAnchor{
        view, {bounds.x, bounds.midY(), bounds.width, 0}, kit::ArrowDirections::LeftOrRight};
}

std::shared_ptr<AlertAction> deleteAction(const UIUtils::DeleteCompletion& completion)
{
    return std::make_shared<AlertAction>(localized("Delete from Tarrow Drive"), AlertActionStyle::Destructive,
        [completion](const Pressed& action) {
            op.debug("Delete action");
            completion(action, false);
        });
}

std::shared_ptr<AlertAction> cancelAction(const UIUtils::DeleteCompletion& completion)
{
    return std::make_shared<AlertAction>(
        localized("Cancel"), AlertActionStyle::Cancel, [completion](const Pressed& action) {
            op.info("Delete: Cancel pressed");
            completion(action, true);
        });
}

} // namespace

void UIUtils::showDeleteWarningAlertHasContainerViewControllerUsingViewUsingButtonCompletion(
    const std::vector<Url>& items, bool /*hasContainer*/, const Screen& parent,
    const std::shared_ptr<kit::View>& view, const std::shared_ptr<kit::BarButtonItem>& button,
    DeleteCompletion completion)
{
    showDeleteWarningAlertMessageViewControllerUsingViewUsingButtonCompletion(
        items.empty() ? std::nullopt : messageForDeletePrompt(items), parent, view, button,
        std::move(completion));
}

void UIUtils::showDeleteWarningAlertMessageViewControllerUsingViewUsingButtonCompletion(
    const std::optional<std::string>& message, const Screen& parent, const std::shared_ptr<kit::View>& view,
    const std::shared_ptr<kit::BarButtonItem>& button, DeleteCompletion completion)
{
    if (!message || !parent) {
        completion(nullptr, true);
        return;
    }
    const auto sheet = std::make_shared<AlertController>("", *message, kit::AlertStyle::ActionSheet);
    sheet->addAction(deleteAction(completion));
    sheet->addAction(cancelAction(completion));
    sheet->setPopoverAnchor(anchorOf(view, button));
    parent->presentViewController(sheet, true);
}

std::optional<std::string> UIUtils::messageForDeletePrompt(const std::vector<Url>& items)
{
    if (items.size() != 1) {
        const auto count = static_cast<std::int64_t>(items.size());
        return localized("%@ will be permanently deleted from Tarrow Drive on all your devices. This action "
                         "cannot be undone.",
            {platform::localizedPlural(".DICT.ITEMS.%d", {count})});
    }
    const auto item = DRItem::initWithURL(items.front());
    if (!item || item->localizedName().empty())
        return std::nullopt;
    if (item->isContainer())
        return localized("The %@ app library, and all its documents, will be permanently deleted from Tarrow "
                         "Drive on all your devices. This action cannot be undone.",
            {item->localizedName()});
    return localized("\"%@\" will be permanently deleted from Tarrow Drive on all your devices. This action "
                     "cannot be undone.",
        {item->localizedName()});
}

} // namespace tarrow
