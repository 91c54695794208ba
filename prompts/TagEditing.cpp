// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "prompts/TagEditing.h"

#include "items/DRItem.h"
#include "items/FileUtils.h"
#include "items/ItemChange.h"
#include "kit/controllers/ViewController.h"
#include "kit/controllers/Window.h"
#include "platform/Localization.h"
#include "platform/Weakly.h"
#include "prompts/TagsPrompt.h"
#include "prompts/UIUtils.h"

namespace tarrow {

using platform::Error;
using platform::localized;
using platform::localizedPlural;
using platform::Url;
using platform::weakly;

TagEditing::TagEditing(Token, std::vector<Url> items, std::weak_ptr<kit::ViewController> screen)
    : _items(std::move(items))
    , _screen(std::move(screen))
{
}

void TagEditing::begin(std::vector<Url> items, const std::shared_ptr<kit::ViewController>& screen)
{
    const auto editing = std::make_shared<TagEditing>(Token{}, std::move(items), screen);
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
    ItemChange::begin(
        _asked, _items, work, [self = shared_from_this()](const Outcome& outcome) { self->tell(outcome); });
}

/// The items get back the tags that each of them had.
void TagEditing::undo(const std::vector<Tagged>& changed)
{
    std::vector<Url> items;
    for (const auto& tagged : changed)
        items.push_back(tagged.item);
    const auto work = [changed](ItemChange& change) {
        auto next = changed.begin();
        return change.forEachItem([&](const Url& item) {
            return FileUtils::setTags(item, (next++)->tagsBefore, change.stillWanted()).error;
        });
    };
    ItemChange::begin(_asked, std::move(items), work,
        [self = shared_from_this()](const std::vector<Error>& errors) { self->showErrors(errors); });
}

void TagEditing::tell(const Outcome& outcome)
{
    const auto screen = _screen.lock();
    const auto window = screen ? screen->window() : nullptr;
    if (window && !outcome.changed.empty() && _asked.isCurrent()) {
        const auto count = static_cast<std::int64_t>(outcome.changed.size());
        window->showNotice(localizedPlural(".DICT.TAGS_CHANGED.%d", {count}),
            {localized("Undo"),
                [self = shared_from_this(), changed = outcome.changed] { self->undo(changed); }});
    }
    showErrors(outcome.errors);
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
