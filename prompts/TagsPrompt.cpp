// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "prompts/TagsPrompt.h"

#include "drawing/FileTags.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/layout/VisualFormat.h"
#include "kit/views/ListView.h"
#include "kit/views/TextField.h"
#include "platform/Localization.h"
#include "platform/Weakly.h"
#include "screens/DisplayName.h"

#include <utility>

namespace tarrow {

using kit::BarButtonItem;
using kit::ListView;
using kit::RowId;
using kit::SystemItem;
using platform::localized;
using platform::weakly;

std::shared_ptr<TagsPrompt> TagsPrompt::present(const std::shared_ptr<kit::ViewController>& parent,
    std::vector<std::vector<std::string>> tagsOfItems, Chosen chosen)
{
    auto prompt = std::make_shared<TagsPrompt>(
        TagChoices(FileTags::allTags(), std::move(tagsOfItems)), std::move(chosen));
    const auto stack = std::make_shared<kit::NavigationController>();
    stack->setViewControllers({prompt}, false);
    stack->setPresentationStyle(kit::PresentationStyle::OverCurrentContext);
    parent->presentViewController(stack, true);
    return prompt;
}

TagsPrompt::TagsPrompt(TagChoices choices, Chosen chosen)
    : _choices(std::move(choices))
    , _chosen(std::move(chosen))
{
    setTitle(localized("Tags"));
}

std::shared_ptr<TagsPrompt> TagsPrompt::self()
{
    return std::static_pointer_cast<TagsPrompt>(shared_from_this());
}

void TagsPrompt::loadView()
{
    const auto view = std::make_shared<kit::View>();
    _nameField = std::make_shared<kit::TextField>();
    _nameField->setPlacedByFrame(false);
    _nameField->setPlaceholder(localized("Add a Tag"));
    _nameField->setInputTraits({.returnKey = kit::ReturnKey::Done,
        .returnKeyNeedsText = true,
        .capitalization = kit::Capitalization::Words,
        .clearButton = kit::ClearButton::WhileEditing});
    _listView = std::make_shared<ListView>();
    _listView->setPlacedByFrame(false);
    _listView->setRowHeight(ListView::minimumRowHeight);
    _listView->setAccessibility({.label = localized("Tags"), .hint = {}});
    view->addSubview(_nameField);
    view->addSubview(_listView);
    kit::VisualFormatInput input;
    input.views = {{"field", _nameField}, {"list", _listView}};
    for (const auto* format : {"H:|-12-[field]-12-|", "H:|[list]|", "V:|-12-[field]-12-[list]|"})
        kit::LayoutConstraint::activate(kit::VisualFormat::constraints(format, input));
    setView(view);
}

void TagsPrompt::viewDidLoad()
{
    view()->setBackground(platform::Color::white());
    navigationItem().setLeftItems({std::make_shared<BarButtonItem>(
        SystemItem::Cancel, weakly(this, [](TagsPrompt& self) { self.dismissViewController(true); }))});
    navigationItem().setRightItem(
        std::make_shared<BarButtonItem>(SystemItem::Done, weakly(this, &TagsPrompt::done)));
    _nameField->setDelegate(self());
    _listView->setDataSource(self());
    _listView->setListDelegate(self());
    _listView->setSelectionMode(kit::SelectionMode::Multiple);
    showSelection();
}

std::size_t TagsPrompt::numberOfRows(const ListView&) const
{
    return _choices.count();
}

RowId TagsPrompt::rowIdAtIndex(const ListView&, std::size_t index) const
{
    return index;
}

kit::ListRow TagsPrompt::rowAtIndex(const ListView&, std::size_t index) const
{
    kit::ListRow row;
    row.id = index;
    row.title = screens::displayName(_choices.name(index));
    row.tagDots = FileTags::dotsForTags({_choices.name(index)});
    const auto with = _choices.itemsWith(index), all = _choices.itemCount();
    if (with > 0 && with < all)
        row.detail =
            localized("%1$d of %2$d", {static_cast<std::int64_t>(with), static_cast<std::int64_t>(all)});
    return row;
}

void TagsPrompt::showSelection()
{
    kit::SelectionModel selection;
    for (std::size_t index = 0; index < _choices.count(); ++index) {
        if (_choices.isOn(index))
            selection.select(index);
    }
    _listView->setSelection(std::move(selection));
}

void TagsPrompt::selectionDidChange(ListView& list)
{
    for (std::size_t index = 0; index < _choices.count(); ++index)
        _choices.set(index, list.selection().contains(index));
}

void TagsPrompt::addTyped()
{
    const auto last = _choices.add(_nameField->text());
    _nameField->setText({});
    _listView->reloadAll();
    showSelection();
    if (last < _choices.count())
        _listView->scrollToRow(last, kit::RowPosition::Middle, true);
}

bool TagsPrompt::textFieldShouldReturn(kit::TextField&)
{
    addTyped();
    return false;
}

/// A name that was typed and not confirmed counts, because it stands there when Done is pressed.
void TagsPrompt::done()
{
    addTyped();
    const auto edit = _choices.edit();
    const auto chosen = std::exchange(_chosen, nullptr);
    dismissViewController(true);
    if (chosen && !edit.isEmpty())
        chosen(edit);
}

} // namespace tarrow
