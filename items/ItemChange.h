// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/AccountSession.h"
#include "items/FileUtils.h"
#include "items/PlatformNames.h"
#include "platform/Dispatch.h"

#include <atomic>
#include <cstddef>
#include <functional>
#include <memory>
#include <optional>
#include <utility>
#include <vector>

namespace tarrow {

/// A change of items that was begun: a new name for one, or the deletion of a thousand. It runs on the one
/// queue on which the program changes items, because another program may hold an item and the disk may be
/// slow. So changes happen one after the other, in the order in which they were begun, also when the screen
/// that asked for one is gone.
///
/// It is begun, and its end is heard of, on the main thread. Any thread may ask and cancel.
class ItemChange {
public:
    /// Begins a change of these items. `work` makes the change on the queue; it is given this object, and
    /// says there which items are done. What it answers is passed to `ended`, on the main thread. A change by
    /// somebody who has signed out since counts as cancelled.
    template <typename Work, typename Ended>
    static std::shared_ptr<ItemChange> begin(
        const AccountSession& asked, std::vector<Url> items, Work work, Ended ended)
    {
        using Answer = std::invoke_result_t<Work, ItemChange&>;
        const auto answer = std::make_shared<std::optional<Answer>>();
        return start(
            asked, std::move(items),
            [answer, work = std::move(work)](ItemChange& change) { answer->emplace(work(change)); },
            [answer, ended = std::move(ended)] { ended(std::move(**answer)); });
    }
    ItemChange(AccountSession asked, std::vector<Url> items)
        : _asked(std::move(asked))
        , _items(std::move(items))
        , _count(_items.size())
    {
    }

    /// The items that are changed, under the names that they had at the beginning.
    const std::vector<Url>& items() const { return _items; }
    /// Answers how many items are to be done; that is more than the items where a folder among them stands
    /// for the documents in it.
    std::size_t count() const { return _count; }
    void setCount(std::size_t count) { _count = count; }
    /// Answers how many items the change is done with, failed ones included.
    std::size_t doneCount() const { return _doneCount; }
    void oneDone() { ++_doneCount; }
    /// Answers whether the work has ended; what follows on the main thread may still be to come.
    bool hasEnded() const { return _hasEnded; }

    /// Takes back what has not happened yet. An item whose turn has come keeps its place and its name too,
    /// unless the disk has been changed already.
    void cancel() { _isCancelled = true; }
    bool isCancelled() const { return _isCancelled; }
    /// Answers whether the change shall go on. It reads who is signed in.
    bool isWanted() const { return !_isCancelled && _asked.isSignedIn(); }
    /// Calls a function for each item, one after the other, until the change is not wanted any more, and
    /// answers its errors. A failure does not end it. On the queue.
    std::vector<Error> forEachItem(const std::function<std::optional<Error>(const Url& item)>& step);
    /// Answers whether this is the error of a step that was not made because it was not wanted any more.
    bool wasTakenBack(const Error& error) const { return error.is(FileErrorCode::Cancelled) && !isWanted(); }
    /// Asks isWanted(), for FileUtils. The function must not outlive the change.
    FileUtils::StillWanted stillWanted() const
    {
        return [this] { return isWanted(); };
    }

private:
    static std::shared_ptr<ItemChange> start(const AccountSession& asked, std::vector<Url> items,
        std::function<void(ItemChange&)> work, std::function<void()> ended);

    const AccountSession _asked;
    const std::vector<Url> _items;
    std::atomic<std::size_t> _count, _doneCount = 0;
    std::atomic<bool> _isCancelled = false, _hasEnded = false;
};

} // namespace tarrow
