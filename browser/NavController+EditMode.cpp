// How a list's bars are configured, and the line under it.

#include "browser/ListLogging.h"
#include "browser/NavController.h"
#include "drawing/FileTags.h"
#include "platform/Formatters.h"
#include "platform/Localization.h"
#include "platform/Log.h"
#include "platform/Services.h"
#include "platform/components/DocumentListController.h"
#include "platform/ui/NavigationItem.h"
#include "platform/ui/View.h"

namespace tarrow {

using platform::ByteCountStyle;
using platform::ByteCountUnit;
using platform::Operation;
using platform::services;
using platform::components::DocumentListAction;
using platform::components::DocumentListController;

namespace {

constexpr auto offeredActions = actionBit(DocumentListAction::Delete) | actionBit(DocumentListAction::Rename)
    | actionBit(DocumentListAction::PressurePop);

} // namespace

void NavController::initNewListController(const List& list)
{
    static constexpr Operation op{"-[NavController initNewListController:]"};
    _viewTitle = list->title();
    logNewList(list);
    list->setAvailableActions(offeredActions);
    configureNavBar(list);
    if (list->title().empty())
        op.warning("Warning: newList title not set");
    list->view()->setBackground(platform::Color::white());
    configureToolbar(list);
    list->setDelegate(self());
}

void NavController::configureNavBar(const List& list)
{
    list->navigationItem().setRightItem(nullptr);
    list->navigationItem().setHidesBackButton(false);
    list->setTitle(_viewTitle);
}

void NavController::configureToolbar(const List& list)
{
    if (!statusBar(*list))
        createStatusBarButtonPressDelegate(*list, _upgradeOffer, self());
    displayStatusBar(*list);
    updateStatusUI(list);
}

void NavController::updateStatusUI(const List& list)
{
    if (!_pickerIsAlive)
        return;
    const auto shown = list ? list : getTopDocumentListController();
    const auto bar = shown ? statusBar(*shown) : nullptr;
    if (!bar)
        return;
    bar->setStatusText(toolbarStatusText(shown->containedItemCount()));
    bar->showUpgradeOffer(_upgradeOffer);
}

std::string NavController::toolbarStatusText(std::size_t itemCount) const
{
    auto items = platform::localizedPlural(".DICT.ITEMS.%d", {static_cast<std::int64_t>(itemCount)});
    if (!okToShowQuota())
        return items;
    return platform::localized("%1$@, %2$@", {std::move(items), quotaAvailableString()});
}

std::string NavController::quotaAvailableString() const
{
    const auto& formatters = services().formatters();
    const auto text = formatters.byteCount(_quotaBytes, ByteCountStyle::Binary, ByteCountUnit::Included);
    const double number = formatters.byteCountNumber(_quotaBytes, ByteCountStyle::Binary);
    return platform::localizedPlural(".DICT.AVAILABLE.%g", {number, text});
}

std::vector<platform::Color> NavController::documentListControllerColorsForTagNames(
    const List&, const std::vector<std::string>& names)
{
    const auto colors = FileTags::tagColorsByTag();
    std::vector<platform::Color> dots;
    for (const auto& name : names) {
        if (const auto found = colors.find(name); found != colors.end())
            dots.push_back(found->second);
    }
    return dots;
}

} // namespace tarrow
