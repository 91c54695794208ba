// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/UndoHistory.h"

#include "platform/Weakly.h"

#include <algorithm>

namespace tarrow {

ExpectedUndo::ExpectedUndo(std::weak_ptr<UndoHistory> history, std::uint64_t number, AccountSession asked)
    : _history(std::move(history))
    , _number(number)
    , _asked(std::move(asked))
{
}

ExpectedUndo::~ExpectedUndo()
{
    if (const auto history = _history.lock())
        history->changeEnded(_number);
}

void ExpectedUndo::add(UndoEntry entry) const
{
    if (const auto history = _history.lock())
        history->add({_number, _asked, std::move(entry)});
}

std::shared_ptr<const ExpectedUndo> UndoHistory::expect(
    const std::shared_ptr<UndoHistory>& history, const AccountSession& asked)
{
    const Number number = history ? ++history->_lastNumber : 0;
    if (history)
        history->_running.insert(number);
    return std::make_shared<const ExpectedUndo>(history, number, asked);
}

void UndoHistory::add(Kept kept)
{
    if (!_running.contains(kept.number) || !kept.asked.isCurrent())
        return;
    if (_awaited == kept.number)
        return begin(kept);
    _entries.push_back(kept);
    if (_entries.size() > depth)
        _entries.pop_front();
    _handlers.added(kept.number, kept.entry);
}

void UndoHistory::changeEnded(Number number)
{
    _running.erase(number);
    if (_awaited == number)
        _awaited.reset();
}

void UndoHistory::undo(Number number)
{
    const auto found = std::ranges::find(_entries, number, &Kept::number);
    if (found == _entries.end())
        return;
    const auto kept = std::move(*found);
    _entries.erase(found);
    begin(kept);
}

bool UndoHistory::undoLatest()
{
    // Changes end in the order in which they begin, so every entry is older than a change that runs.
    if (!_running.empty())
        _awaited = *_running.rbegin();
    else if (!_entries.empty())
        undo(_entries.back().number);
    else
        return false;
    return true;
}

void UndoHistory::forget()
{
    _entries.clear();
    _running.clear();
    _awaited.reset();
}

void UndoHistory::begin(const Kept& kept)
{
    const auto& entry = kept.entry;
    _handlers.begun(ItemChange::begin(
        kept.asked, entry.items,
        [changeBack = entry.changeBack](ItemChange& change) {
            UndoOutcome outcome{changeBack(change)};
            outcome.isWhole = change.isWanted();
            return outcome;
        },
        platform::weakly(this, [entry](UndoHistory& self, const UndoOutcome& outcome) {
            self._handlers.ended(entry, outcome);
        })));
}

} // namespace tarrow
