// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "browser/TrashScreen.h"

#include "kit/controllers/AlertController.h"
#include "kit/controllers/NavigationController.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/controllers/Window.h"
#include "kit/views/ListView.h"
#include "platform/Localization.h"
#include "platform/Weakly.h"
#include "prompts/UIUtils.h"
#include "screens/DisplayName.h"
#include "screens/ErrorWords.h"
#include "screens/PlaceholderView.h"

#include <algorithm>

namespace tarrow {

using kit::BarButtonItem;
using kit::ListView;
using kit::RowId;
using kit::SystemItem;
using platform::localized;
using platform::localizedPlural;
using platform::weakly;

namespace {

std::int64_t count(const auto& items)
{
    return static_cast<std::int64_t>(items.size());
}

std::vector<RowId> idsOf(const std::vector<TrashRow>& rows)
{
    std::vector<RowId> ids;
    for (const auto& row : rows)
        ids.push_back(row.id());
    return ids;
}

std::string deletionMessage(const std::vector<TrashRow>& rows, const std::vector<TrashedItem>& items)
{
    const auto* const only = items.size() == 1 ? &items.front() : nullptr;
    const auto row = std::ranges::find_if(rows, [&](const auto& each) { return only && each.item == *only; });
    if (row == rows.end())
        return localized("%@ will be permanently deleted from Tarrow Drive on all your devices. This action "
                         "cannot be undone.",
            {localizedPlural(".DICT.ITEMS.%d", {count(items)})});
    return localized("\"%@\" will be permanently deleted from Tarrow Drive on all your devices. This action "
                     "cannot be undone.",
        {row->name});
}

} // namespace

std::shared_ptr<TrashScreen> TrashScreen::present(
    const std::shared_ptr<kit::ViewController>& parent, Handlers handlers)
{
    auto screen = std::make_shared<TrashScreen>(std::move(handlers));
    const auto stack = std::make_shared<kit::NavigationController>();
    stack->setToolbarHidden(false);
    stack->setViewControllers({screen}, false);
    stack->setPresentationStyle(kit::PresentationStyle::OverCurrentContext);
    parent->presentViewController(stack, true);
    return screen;
}

TrashScreen::TrashScreen(Handlers handlers)
    : _handlers(std::move(handlers))
    , _queue(services().dispatch().makeSerialQueue("TarrowDriveAppID.trash"))
{
    setTitle(localized("Trash"));
}

std::shared_ptr<TrashScreen> TrashScreen::self()
{
    return std::static_pointer_cast<TrashScreen>(shared_from_this());
}

void TrashScreen::loadView()
{
    const auto view = std::make_shared<kit::View>();
    _listView = std::make_shared<ListView>();
    _listView->setAccessibility({.label = localized("Trash"), .hint = {}});
    _placeholder = screens::PlaceholderView::create();
    _placeholder->setHidden(true);
    for (const auto& part : std::initializer_list<std::shared_ptr<kit::View>>{_listView, _placeholder}) {
        part->setAutoresizing({.flexibleWidth = true, .flexibleHeight = true});
        part->setFrame(view->bounds());
        view->addSubview(part);
    }
    setView(view);
}

void TrashScreen::viewDidLoad()
{
    view()->setBackground(platform::Color::white());
    _listView->setDataSource(self());
    _listView->setListDelegate(self());
    _onChange = services().notificationCenter().observe(
        platform::Notification::TrashDidChange, weakly(this, &TrashScreen::readAgain));
    showBars();
    readAgain();
}

void TrashScreen::viewDidAppear(bool animated)
{
    kit::ViewController::viewDidAppear(animated);
    _hasTakenKeyboard = false;
    takeKeyboard();
}

void TrashScreen::takeKeyboard()
{
    if (_hasTakenKeyboard || appearanceState() != kit::AppearanceState::Appeared || _rows.empty()
        || presentedViewController())
        return;
    _hasTakenKeyboard = true;
    _listView->becomeFirstResponder();
}

void TrashScreen::readAgain()
{
    _queue->async([main = services().dispatch().mainQueue(), arrived = weakly(this, &TrashScreen::arrived)] {
        main->async([arrived, content = readTrash()] { arrived(content); });
    });
}

void TrashScreen::arrived(TrashContent content)
{
    if (!_asked.isCurrent())
        return;
    const auto before = idsOf(_rows);
    _rows = std::move(content.rows);
    _isKnown = true;
    auto changes = kit::ListChanges::between(before, idsOf(_rows));
    changes.changed = {{0, _rows.size()}};
    _listView->apply(changes);
    if (_rows.empty())
        setSelecting(false);
    showBars();
    showState(content.error);
    takeKeyboard();
}

void TrashScreen::showState(const std::optional<Error>& error)
{
    _placeholder->setHidden(!_rows.empty());
    if (error)
        _placeholder->setContent({.iconName = "dialog-warning-symbolic",
            .title = localized("The trash cannot be shown"),
            .message = screens::errorWords(*error)});
    else
        _placeholder->setContent({.iconName = "user-trash-symbolic",
            .title = localized("The trash is empty"),
            .message = localizedPlural(".DICT.STAYS_IN_TRASH.%d", {std::int64_t{TrashUtils::daysInTrash}})});
}

void TrashScreen::setSelecting(bool selecting)
{
    if (_isSelecting == selecting)
        return;
    _isSelecting = selecting;
    _listView->setSelectionMode(selecting ? kit::SelectionMode::Multiple : kit::SelectionMode::None);
    showBars();
}

void TrashScreen::showBars()
{
    const auto selected = selectedItems();
    const auto button = [](const std::string& title, bool isEnabled, auto action) {
        auto item = std::make_shared<BarButtonItem>(title, std::move(action));
        item->setEnabled(isEnabled);
        return item;
    };
    const auto space = std::make_shared<BarButtonItem>(SystemItem::FlexibleSpace);
    const auto select = [this](
                            bool selecting) { return weakly(this, &TrashScreen::setSelecting, selecting); };
    if (_isSelecting) {
        setTitle(selected.empty() ? localized("Select Items")
                                  : localizedPlural(".DICT.ITEMS_SELECTED.%d", {count(selected)}));
        navigationItem().setLeftItems({});
        navigationItem().setRightItem(std::make_shared<BarButtonItem>(SystemItem::Cancel, select(false)));
        setToolbarItems({button(localized("Restore"), !selected.empty(),
                             weakly(this,
                                 [selected](TrashScreen& screen) {
                                     screen.setSelecting(false);
                                     screen.restore(selected, IfTaken::Refuse);
                                 })),
            space,
            button(localized("Delete"), !selected.empty(),
                weakly(this, [selected](TrashScreen& screen, const std::shared_ptr<BarButtonItem>& pressed) {
                    screen.askBeforeRemoval(selected, pressed);
                }))});
        return;
    }
    setTitle(localized("Trash"));
    navigationItem().setLeftItems({std::make_shared<BarButtonItem>(
        SystemItem::Done, weakly(this, [](TrashScreen& screen) { screen.dismissViewController(true); }))});
    navigationItem().setRightItem(_rows.empty() ? nullptr : button(localized("Select"), true, select(true)));
    setToolbarItems({space,
        button(localized("Empty Trash"), !_rows.empty(),
            weakly(this, [](TrashScreen& screen, const std::shared_ptr<BarButtonItem>& pressed) {
                Items all;
                for (const auto& row : screen._rows)
                    all.push_back(row.item);
                screen.askBeforeRemoval(all, pressed);
            }))});
}

kit::ListRow TrashScreen::rowAtIndex(const ListView&, std::size_t index) const
{
    auto row = _rows[index].listRow();
    row.isDimmed = _busy.contains(_rows[index].item.identifier);
    return row;
}

TrashScreen::Items TrashScreen::selectedItems() const
{
    Items items;
    for (const auto& row : _rows) {
        if (_isSelecting && _listView->selection().contains(row.id()))
            items.push_back(row.item);
    }
    return items;
}

TrashScreen::Items TrashScreen::itemsAt(std::size_t index) const
{
    auto selected = selectedItems();
    const auto& item = _rows[index].item;
    return std::ranges::find(selected, item) == selected.end() ? Items{item} : selected;
}

/// Says all that is known of an item, and what can be done with it.
void TrashScreen::rowActivated(ListView&, std::size_t index)
{
    const auto& row = _rows[index];
    const auto sheet =
        std::make_shared<kit::AlertController>(row.name, row.description(), kit::AlertStyle::Alert);
    const auto add = [&](const std::string& title, kit::AlertActionStyle style, auto action) {
        sheet->addAction(std::make_shared<kit::AlertAction>(title, style, std::move(action)));
        return sheet->actions().back();
    };
    const Items items{row.item};
    sheet->setPreferredAction(add(localized("Restore"), kit::AlertActionStyle::Default,
        weakly(this, &TrashScreen::restore, items, IfTaken::Refuse)));
    add(localized("Delete"), kit::AlertActionStyle::Destructive,
        weakly(this, &TrashScreen::askBeforeRemoval, items, std::shared_ptr<BarButtonItem>()));
    add(localized("Cancel"), kit::AlertActionStyle::Cancel, kit::AlertAction::Handler());
    presentViewController(sheet, true);
}

kit::Menu TrashScreen::menuForRow(ListView&, std::size_t index)
{
    const auto items = itemsAt(index);
    return {{.title = localized("Restore"),
                .handler = weakly(this, &TrashScreen::restore, items, IfTaken::Refuse),
                .image = {}},
        {.title = localized("Delete"),
            .handler = weakly(this, &TrashScreen::askBeforeRemoval, items, std::shared_ptr<BarButtonItem>()),
            .style = kit::MenuActionStyle::Destructive,
            .image = {}}};
}

bool TrashScreen::rowCommand(ListView&, std::size_t index, kit::RowCommand command)
{
    if (command != kit::RowCommand::Delete && command != kit::RowCommand::DeleteForGood)
        return false;
    askBeforeRemoval(itemsAt(index), nullptr);
    return true;
}

/// Begins a change of items, whose rows are dimmed until it ends.
template <typename Work, typename Ended>
void TrashScreen::begin(const Items& items, Work work, Ended ended)
{
    for (const auto& item : items)
        _busy.insert(item.identifier);
    _listView->apply({.splices = {}, .changed = {{0, _rows.size()}}});
    _handlers.begun(ItemChange::begin(_asked, placesOf(items), std::move(work),
        [told = _handlers.ended, items, ended = weakly(this, ended), weak = std::weak_ptr(self())](
            const auto& outcome) {
            told();
            if (const auto screen = weak.lock()) {
                for (const auto& item : items)
                    screen->_busy.erase(item.identifier);
                screen->readAgain();
            }
            ended(outcome);
        }));
}

void TrashScreen::restore(const Items& items, IfTaken ifTaken)
{
    static constexpr Operation op{"-[TrashScreen restore:]"};
    op.userAction("Restore From Trash");
    begin(
        items, [items, ifTaken](ItemChange& change) { return restoreItems(change, items, ifTaken); },
        &TrashScreen::restored);
}

void TrashScreen::restored(const RestoringOutcome& outcome)
{
    if (!_asked.isCurrent())
        return;
    const auto shown = window();
    if (shown && outcome.restored.size() == 1)
        shown->showNotice(localized(
            "“%@” was put back", {screens::displayName(outcome.restored.front().lastPathComponent())}));
    else if (shown && !outcome.restored.empty())
        shown->showNotice(localizedPlural(".DICT.ITEMS_PUT_BACK.%d", {count(outcome.restored)}));
    if (!outcome.refused.empty())
        askToKeepBoth(outcome.refused);
    else if (!outcome.errors.empty())
        UIUtils::showErrorsTitleParentViewController(outcome.errors,
            localizedPlural(".DICT.CANNOT_RESTORE_ITEMS.%d", {count(outcome.errors)}), self());
}

void TrashScreen::askToKeepBoth(const Items& items)
{
    const auto title = items.size() == 1 ? localized("There is another item named “%@” in its old place.",
                           {screens::displayName(items.front().name)})
                                         : localizedPlural(".DICT.PLACES_TAKEN.%d", {count(items)});
    const auto alert = std::make_shared<kit::AlertController>(
        title, localized("What comes back gets another name."), kit::AlertStyle::Alert);
    alert->addAction(std::make_shared<kit::AlertAction>(localized("Keep Both"),
        kit::AlertActionStyle::Default, weakly(this, &TrashScreen::restore, items, IfTaken::KeepBoth)));
    alert->setPreferredAction(alert->actions().back());
    alert->addAction(std::make_shared<kit::AlertAction>(localized("Cancel"), kit::AlertActionStyle::Cancel));
    presentViewController(alert, true);
}

void TrashScreen::askBeforeRemoval(const Items& items, const std::shared_ptr<BarButtonItem>& button)
{
    static constexpr Operation op{"-[TrashScreen askBeforeRemoval:]"};
    if (items.empty())
        return;
    const auto answered = [items](TrashScreen& screen, const auto&, bool cancelled) {
        op.userAction(cancelled ? "Delete was Cancelled (trash)" : "Delete was Confirmed (trash)");
        if (cancelled || !screen._asked.isCurrent())
            return;
        screen.setSelecting(false);
        screen.remove(items);
    };
    UIUtils::showDeleteWarningAlertMessageViewControllerUsingViewUsingButtonCompletion(
        deletionMessage(_rows, items), self(), button ? nullptr : _listView, button, weakly(this, answered));
}

void TrashScreen::remove(const Items& items)
{
    const auto removed = [](TrashScreen& screen, const std::vector<Error>& errors) {
        if (screen._asked.isCurrent() && !errors.empty())
            UIUtils::showErrorsTitleParentViewController(
                errors, localizedPlural(".DICT.CANNOT_DELETE_ITEMS.%d", {count(errors)}), screen.self());
    };
    begin(
        items, [items](ItemChange& change) { return removeItemsForGood(change, items); }, removed);
}

} // namespace tarrow
