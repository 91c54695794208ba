// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Dispatch.h"
#include "platform/FileCoordinator.h"
#include "platform/FilePresenter.h"

#include <functional>
#include <memory>
#include <mutex>
#include <optional>
#include <vector>

namespace host::system {

/// The presenters of this process, and the calls to them. Any thread.
class PresenterNotices {
public:
    /// `patience` is the longest time for which one write waits for all presenters that it asks.
    /// `beforeWaiting` runs on the writer's thread before it waits (null: nothing).
    PresenterNotices(platform::Duration patience, std::function<void()> beforeWaiting)
        : _patience(patience)
        , _beforeWaiting(std::move(beforeWaiting))
    {
    }

    void add(const std::shared_ptr<platform::FilePresenter>& presenter);
    void remove(const platform::FilePresenter& presenter);

    std::vector<std::weak_ptr<platform::FilePresenter>> presenters() const;
    /// Calls a presenter on its queue, unless it was removed.
    void tell(const std::weak_ptr<platform::FilePresenter>& presenter,
        std::function<void(platform::FilePresenter&)> call) const;

    /// Asks the presenters of an item, of everything below it and of the folders above it to prepare for its
    /// deletion, and waits for them. Answers the first error of one of them.
    std::optional<platform::Error> askForDeletion(const platform::Url& url);
    /// Tells the presenters of an item and of everything below it that it is about to be moved, and waits.
    void announceMove(const platform::Url& from, const platform::Url& to);
    /// Tells the same presenters the new place of the item. They are the ones that were registered before the
    /// move.
    void tellOfMove(const platform::Url& from, const platform::Url& to);
    /// Tells the presenters of an item and of the folders above it that it may have changed.
    void tellOfChange(const platform::Url& url);

private:
    struct Presented {
        std::shared_ptr<platform::FilePresenter> presenter;
        std::shared_ptr<platform::OperationQueue> queue;
        platform::Url url;
    };
    class Answers;
    using Ask = std::function<void(const Presented&, platform::FilePresenter::CompletionHandler)>;

    std::vector<Presented> presented() const;
    void ask(const Presented& presented, const std::shared_ptr<Answers>& answers, Ask question);
    void wait(const std::shared_ptr<Answers>& answers, const platform::Url& url);

    platform::Duration _patience;
    std::function<void()> _beforeWaiting;
    mutable std::mutex _mutex;
    std::vector<std::weak_ptr<platform::FilePresenter>> _presenters;
};

} // namespace host::system
