// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/ItemChange.h"

namespace tarrow {

namespace {

/// Answers the queue of all changes. It lives as long as work waits in it, so that no queue is kept while
/// nothing is changed. Main thread.
std::shared_ptr<platform::Queue> queueOfChanges()
{
    static std::weak_ptr<platform::Queue> last;
    auto queue = last.lock();
    if (!queue) {
        queue = services().dispatch().makeSerialQueue("TarrowDriveAppID.itemchanges");
        last = queue;
    }
    return queue;
}

/// What is to be called on the main thread is also destroyed there, because it may be the last to hold a
/// screen.
struct Ending {
    std::function<void()> ended;
    void operator()() { std::exchange(ended, {})(); }
};

} // namespace

std::shared_ptr<ItemChange> ItemChange::start(const AccountSession& asked, std::vector<Url> items,
    std::function<void(ItemChange&)> work, std::function<void()> ended)
{
    const auto change = std::make_shared<ItemChange>(asked, std::move(items));
    const auto queue = queueOfChanges();
    queue->async([queue, change, work = std::move(work), ending = std::make_shared<Ending>(std::move(ended)),
                     main = services().dispatch().mainQueue()] {
        work(*change);
        change->_hasEnded = true;
        main->async([ending] { (*ending)(); });
    });
    return change;
}

std::vector<Error> ItemChange::forEachItem(const std::function<std::optional<Error>(const Url& item)>& step)
{
    std::vector<Error> errors;
    for (const auto& item : _items) {
        if (!isWanted())
            break;
        auto error = step(item);
        if (error && !wasTakenBack(*error))
            errors.push_back(std::move(*error));
        oneDone();
    }
    return errors;
}

} // namespace tarrow
