// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "prompts/TagEditing.h"

#include "items/DRItem.h"
#include "items/FileUtils.h"
#include "kit/controllers/ViewController.h"
#include "platform/Localization.h"
#include "prompts/TagsPrompt.h"
#include "prompts/UIUtils.h"

namespace tarrow {

using platform::Error;
using platform::localizedPlural;
using platform::Url;

TagEditing::TagEditing(Token, std::vector<Url> items, std::weak_ptr<kit::ViewController> screen,
    std::weak_ptr<UndoHistory> history)
    : _items(std::move(items))
    , _screen(std::move(screen))
    , _history(std::move(history))
{
}

void TagEditing::begin(std::vector<Url> items, const std::shared_ptr<kit::ViewController>& screen,
    const std::shared_ptr<UndoHistory>& history)
{
    const auto editing = std::make_shared<TagEditing>(Token{}, std::move(items), screen, history);
    const auto read = [](ItemChange& reading) {
        TagLists tags;
        for (const auto& url : reading.items()) {
            if (const auto item = DRItem::initWithURL(url))
                tags.push_back(item->tags());
        }
        return tags;
    };
    ItemChange::begin(
        editing->_asked, editing->_items, read, [editing](TagLists tags) { editing->show(std::move(tags)); });
}

void TagEditing::show(TagLists tagsOfItems)
{
    const auto screen = _screen.lock();
    if (!screen || !screen->isVisible() || screen->presentedViewController() || !_asked.isCurrent()
        || tagsOfItems.empty())
        return;
    TagsPrompt::present(screen, std::move(tagsOfItems),
        [self = shared_from_this()](const TagEdit& edit) { self->apply(edit); });
}

void TagEditing::apply(const TagEdit& edit)
{
    const auto work = [edit](ItemChange& change) {
        Outcome outcome;
        outcome.errors = change.forEachItem([&](const Url& item) -> std::optional<Error> {
            auto before = FileUtils::changeTags(item, edit.added, edit.removed, change.stillWanted());
            if (before.value)
                outcome.changed.push_back(Tagged{item, std::move(*before.value)});
            return before.error;
        });
        return outcome;
    };
    ItemChange::begin(_asked, _items, work,
        [self = shared_from_this(), expected = UndoHistory::expect(_history.lock(), _asked), edit](
            const Outcome& outcome) {
            if (!outcome.changed.empty())
                expected->add(undoOf(outcome.changed, edit));
            self->showErrors(outcome.errors);
        });
}

/// The items get back the tags that each of them had. Tags that were changed since stay as they are.
UndoEntry TagEditing::undoOf(const std::vector<Tagged>& changed, const TagEdit& edit)
{
    std::vector<Url> items;
    items.reserve(changed.size());
    for (const auto& tagged : changed)
        items.push_back(tagged.item);
    const auto count = static_cast<std::int64_t>(changed.size());
    const auto changeBack = [changed, edit](ItemChange& change) {
        auto next = changed.begin();
        return change.forEachItem([&](const Url& item) {
            return FileUtils::changeTagsBack(
                item, (next++)->tagsBefore, edit.added, edit.removed, change.stillWanted())
                .error;
        });
    };
    return {localizedPlural(".DICT.TAGS_CHANGED.%d", {count}), std::move(items), changeBack};
}

void TagEditing::showErrors(const std::vector<Error>& errors) const
{
    const auto screen = _screen.lock();
    if (errors.empty() || !screen || !screen->isVisible() || !_asked.isCurrent())
        return;
    if (errors.size() == 1)
        return UIUtils::showErrorParentViewController(errors.front(), screen);
    const auto count = static_cast<std::int64_t>(errors.size());
    UIUtils::showAlertMessageParentViewController(
        localizedPlural(".DICT.CANNOT_CHANGE_TAGS.%d", {count}), {}, screen);
}

} // namespace tarrow
