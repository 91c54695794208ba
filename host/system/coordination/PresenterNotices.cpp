// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/coordination/PresenterNotices.h"

#include "platform/Log.h"

#include <algorithm>
#include <condition_variable>

namespace host::system {

using platform::Error;
using platform::FilePresenter;
using platform::Url;

/// The answers for which one write waits. Presenters may answer late, twice or never.
class PresenterNotices::Answers {
public:
    void expect()
    {
        const std::lock_guard lock(_mutex);
        ++_missing;
    }
    void receive(const std::optional<Error>& error)
    {
        const std::lock_guard lock(_mutex);
        if (error && !_error)
            _error = error;
        if (--_missing == 0)
            _complete.notify_all();
    }
    bool waitFor(platform::Duration patience)
    {
        std::unique_lock lock(_mutex);
        return _complete.wait_for(lock, patience, [this] { return _missing == 0; });
    }
    std::optional<Error> error() const
    {
        const std::lock_guard lock(_mutex);
        return _error;
    }

private:
    mutable std::mutex _mutex;
    std::condition_variable _complete;
    int _missing = 0;
    std::optional<Error> _error;
};

namespace {

/// One presenter's answer. The first call counts. When every copy of the answer is destroyed without a call,
/// the answer is "nothing".
class Answer {
public:
    explicit Answer(std::function<void(const std::optional<Error>&)> receive)
        : _receive(std::move(receive))
    {
    }
    Answer(const Answer&) = delete;
    Answer& operator=(const Answer&) = delete;
    ~Answer() { give(std::nullopt); }

    void give(const std::optional<Error>& error)
    {
        std::call_once(_given, [&] { _receive(error); });
    }

private:
    std::once_flag _given;
    std::function<void(const std::optional<Error>&)> _receive;
};

Url moved(const Url& url, const Url& from, const Url& to)
{
    return Url::fileURL(to.path() + url.path().substr(from.path().size()));
}

} // namespace

// A presenter removes itself from the list when it is destroyed. The last reference may be the one that is
// used here, so it is released only after the lock.

void PresenterNotices::add(const std::shared_ptr<FilePresenter>& presenter)
{
    std::vector<std::shared_ptr<FilePresenter>> endLater;
    const std::lock_guard lock(_mutex);
    std::erase_if(_presenters, [&](const auto& known) {
        const auto& strong = endLater.emplace_back(known.lock());
        return !strong || strong == presenter;
    });
    _presenters.push_back(presenter);
}

void PresenterNotices::remove(const FilePresenter& presenter)
{
    std::vector<std::shared_ptr<FilePresenter>> endLater;
    const std::lock_guard lock(_mutex);
    std::erase_if(_presenters, [&](const auto& known) {
        const auto& strong = endLater.emplace_back(known.lock());
        return !strong || strong.get() == &presenter;
    });
}

std::vector<std::weak_ptr<FilePresenter>> PresenterNotices::presenters() const
{
    const std::lock_guard lock(_mutex);
    return _presenters;
}

void PresenterNotices::tell(
    const std::weak_ptr<FilePresenter>& presenter, std::function<void(FilePresenter&)> call) const
{
    const auto told = presenter.lock();
    const auto isTold = [&](const auto& known) { return known.lock() == told; };
    if (!told || std::ranges::none_of(presenters(), isTold))
        return;
    const auto queue = told->presentedItemOperationQueue();
    if (!queue)
        return;
    queue->addOperation([presenter, call = std::move(call)] {
        if (const auto strong = presenter.lock())
            call(*strong);
    });
}

std::vector<PresenterNotices::Presented> PresenterNotices::presented() const
{
    // Presenters take their own locks to answer, so none of ours may be held meanwhile.
    std::vector<Presented> all;
    for (const auto& weak : presenters()) {
        const auto presenter = weak.lock();
        const auto url = presenter ? presenter->presentedItemURL() : std::nullopt;
        if (auto queue = url ? presenter->presentedItemOperationQueue() : nullptr)
            all.push_back({presenter, std::move(queue), *url});
    }
    return all;
}

void PresenterNotices::ask(const Presented& presented, const std::shared_ptr<Answers>& answers, Ask question)
{
    answers->expect();
    const auto answer =
        std::make_shared<Answer>([answers](const std::optional<Error>& error) { answers->receive(error); });
    presented.queue->addOperation([weak = std::weak_ptr(presented.presenter), url = presented.url,
                                      question = std::move(question), answer] {
        if (const auto presenter = weak.lock())
            question({presenter, nullptr, url},
                [answer](const std::optional<Error>& error) { answer->give(error); });
    });
}

void PresenterNotices::wait(const std::shared_ptr<Answers>& answers, const Url& url)
{
    static constexpr platform::Operation op{"-[LocalFileCoordinator waitForPresenters:]"};
    if (answers->waitFor(platform::Duration::zero()))
        return;
    if (_beforeWaiting)
        _beforeWaiting();
    if (!answers->waitFor(_patience))
        op.warning("A presenter did not answer in time, going on: %@", url);
}

std::optional<Error> PresenterNotices::askForDeletion(const Url& url)
{
    const auto answers = std::make_shared<Answers>();
    for (const auto& each : presented()) {
        if (each.url.isWithin(url)) {
            ask(each, answers, [](const Presented& asked, FilePresenter::CompletionHandler completion) {
                asked.presenter->accommodatePresentedItemDeletionWithCompletionHandler(std::move(completion));
            });
        } else if (url.isWithin(each.url)) {
            ask(each, answers, [url](const Presented& asked, FilePresenter::CompletionHandler completion) {
                asked.presenter->accommodatePresentedSubitemDeletionAtURLCompletionHandler(
                    url, std::move(completion));
            });
        }
    }
    wait(answers, url);
    return answers->error();
}

void PresenterNotices::announceMove(const Url& from, const Url& to)
{
    const auto answers = std::make_shared<Answers>();
    for (const auto& each : presented()) {
        if (!each.url.isWithin(from))
            continue;
        ask(each, answers,
            [destination = moved(each.url, from, to)](
                const Presented& asked, const FilePresenter::CompletionHandler& completion) {
                asked.presenter->presentedItemWillMoveToURL(destination);
                completion(std::nullopt);
            });
    }
    wait(answers, from);
}

void PresenterNotices::tellOfMove(const Url& from, const Url& to)
{
    for (const auto& each : presented()) {
        if (!each.url.isWithin(from))
            continue;
        tell(each.presenter, [destination = moved(each.url, from, to)](auto& presenter) {
            presenter.presentedItemDidMoveToURL(destination);
        });
    }
}

void PresenterNotices::tellOfChange(const Url& url)
{
    for (const auto& each : presented()) {
        if (!url.isWithin(each.url))
            continue;
        tell(each.presenter, [](auto& presenter) { presenter.presentedItemDidChange(); });
    }
}

} // namespace host::system
