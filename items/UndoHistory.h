// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/ItemChange.h"

#include <cstdint>
#include <deque>
#include <functional>
#include <memory>
#include <optional>
#include <set>
#include <string>
#include <vector>

namespace tarrow {

/// A change of items that can be undone. Many items that were changed at once are one entry.
struct UndoEntry {
    std::string sentence; ///< what was done, in the user's language: "“a.txt” was moved to “Trip”"
    std::vector<Url> items; ///< the items that are changed back, under the names that they have now
    /// Changes the items back, and answers why the ones that stay as they are do so: each error has a
    /// sentence for the user that names its item. It is called on the queue of all changes with a change of
    /// `items`, replaces nothing, and leaves alone what another program has changed meanwhile.
    std::function<std::vector<Error>(ItemChange&)> changeBack;
};

/// What became of an undo.
struct UndoOutcome {
    std::vector<Error> errors; ///< of the items that stay as they are
    bool isWhole = true; ///< false: it was cancelled before all items had their turn
};

class UndoHistory;

/// A change that has begun, and will be an entry of the history when it has succeeded. Whoever begins a
/// change keeps one until the change has ended, because the user may ask for its undo before that, and does
/// not mean an earlier change then.
class ExpectedUndo {
public:
    ExpectedUndo(std::weak_ptr<UndoHistory> history, std::uint64_t number, AccountSession asked);
    ~ExpectedUndo();
    ExpectedUndo(const ExpectedUndo&) = delete;
    ExpectedUndo& operator=(const ExpectedUndo&) = delete;

    /// The change has ended, and this is how it is undone.
    void add(UndoEntry entry) const;

private:
    const std::weak_ptr<UndoHistory> _history;
    const std::uint64_t _number;
    const AccountSession _asked;
};

/// The changes that the user can undo, of which the latest comes first. It shows nothing itself. Main thread.
class UndoHistory : public std::enable_shared_from_this<UndoHistory> {
public:
    using Number = std::uint64_t; ///< names an entry
    static constexpr std::size_t depth = 20; ///< older entries are forgotten

    struct Handlers {
        std::function<void(Number, const UndoEntry&)> added;
        /// The undo of an entry has begun, as this change.
        std::function<void(const std::shared_ptr<ItemChange>&)> begun;
        std::function<void(const UndoEntry&, const UndoOutcome&)> ended;
    };
    explicit UndoHistory(Handlers handlers)
        : _handlers(std::move(handlers))
    {
    }

    /// Answers what is kept while a change runs. The history may be null; then no entry is added.
    static std::shared_ptr<const ExpectedUndo> expect(
        const std::shared_ptr<UndoHistory>& history, const AccountSession& asked);

    /// Undoes an entry. Nothing happens when it is not in the history any more.
    void undo(Number number);
    /// Undoes the change that was begun last, as soon as it has ended. Answers false when there is none.
    bool undoLatest();
    /// Forgets all entries, and those of the changes that still run.
    void forget();
    std::size_t count() const { return _entries.size(); }

private:
    friend class ExpectedUndo;
    struct Kept {
        Number number;
        AccountSession asked;
        UndoEntry entry;
    };
    void add(Kept kept);
    void changeEnded(Number number);
    void begin(const Kept& kept);

    const Handlers _handlers;
    std::deque<Kept> _entries; ///< the latest is the last
    Number _lastNumber = 0;
    std::set<Number> _running; ///< the changes that have not ended
    std::optional<Number> _awaited; ///< the one of them that is undone when it ends
};

} // namespace tarrow
