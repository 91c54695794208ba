// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/coordination/PresenterWatch.h"

#include "host/system/coordination/PresenterNotices.h"
#include "host/system/files/ItemPaths.h"
#include "platform/Weakly.h"

#include <algorithm>

namespace host::system {

namespace {

using platform::Duration;
using platform::weakly;

// A program that saves makes several changes at once. A missing item may come back soon, because a save that
// first moves the old version away takes as long as writing the new one.
constexpr Duration changesSettle = std::chrono::milliseconds(50);
constexpr Duration missingSettles = std::chrono::milliseconds(250);
// The items are polled when the system has no watches left.
constexpr Duration pollPeriod = std::chrono::seconds(5);

bool isSame(const std::weak_ptr<platform::FilePresenter>& a, const std::weak_ptr<platform::FilePresenter>& b)
{
    return !a.owner_before(b) && !b.owner_before(a);
}

} // namespace

std::shared_ptr<PresenterWatch> PresenterWatch::create(
    std::shared_ptr<PresenterNotices> notices, std::shared_ptr<platform::Dispatch> dispatch, std::string root)
{
    return std::shared_ptr<PresenterWatch>(
        new PresenterWatch(std::move(notices), std::move(dispatch), std::move(root)));
}

PresenterWatch::PresenterWatch(
    std::shared_ptr<PresenterNotices> notices, std::shared_ptr<platform::Dispatch> dispatch, std::string root)
    : _notices(std::move(notices))
    , _dispatch(std::move(dispatch))
    , _queue(_dispatch->makeSerialQueue("filePresenters"))
    , _root(std::move(root))
{
}

void PresenterWatch::stop()
{
    const std::lock_guard lock(_mutex);
    _isStopped = true;
    _presenters.clear();
    _watches.reset();
}

void PresenterWatch::presentersChanged()
{
    _queue->async(weakly(this, &PresenterWatch::askAgain));
}

void PresenterWatch::askAgain()
{
    const auto asked = askPresenters();
    const std::lock_guard lock(_mutex);
    update(asked);
    markEvents();
    lookLater(changesSettle);
}

/// Answers which presenter presents which item. Presenters take their own locks to answer, so none of ours
/// may be held meanwhile.
std::vector<PresenterWatch::Asked> PresenterWatch::askPresenters() const
{
    std::vector<Asked> all;
    for (const auto& weak : _notices->presenters()) {
        auto presenter = weak.lock();
        if (!presenter)
            continue;
        if (const auto url = presenter->presentedItemURL())
            all.push_back({weak, url->path()});
        // The owner may have released the presenter meanwhile, and a presenter that owns screens must be
        // destroyed on the main thread.
        _dispatch->mainQueue()->async([held = std::move(presenter)] {});
    }
    return all;
}

std::unique_ptr<FolderWatches> PresenterWatch::makeWatches()
{
    const auto arrived = weakly(this, [](PresenterWatch& self) {
        if (!self._isReading.exchange(true))
            self._queue->async(weakly(&self, &PresenterWatch::readEvents));
    });
    return std::make_unique<FolderWatches>(std::make_unique<Inotify>(Inotify::Writing::AtOnce, arrived));
}

void PresenterWatch::update(const std::vector<Asked>& asked)
{
    if (_isStopped)
        return;
    if (!_watches)
        _watches = makeWatches();
    std::vector<WatchedPresenter> kept;
    for (const auto& [presenter, path] : asked) {
        const auto known = std::ranges::find_if(_presenters, [&](const auto& each) {
            return isSame(each.presenter(), presenter)
                && (each.askedPath() == path || each.item().path() == path);
        });
        if (known != _presenters.end()) {
            kept.push_back(std::move(*known));
            _presenters.erase(known);
        } else {
            kept.emplace_back(presenter, path, _root).start(*_watches);
        }
        kept.back().setAskedPath(path);
    }
    std::ranges::for_each(_presenters, [this](auto& each) { each.stop(*_watches); });
    _presenters = std::move(kept);
}

void PresenterWatch::readEvents()
{
    _isReading = false;
    const std::lock_guard lock(_mutex);
    markEvents();
    lookLater(changesSettle);
}

/// Passes the events to the presenters that they concern.
void PresenterWatch::markEvents()
{
    if (!_watches)
        return;
    for (const auto& event : _watches->take()) {
        for (auto& each : _presenters)
            each.mark(event, [this](const auto& path) { return isOwn(path); });
    }
}

bool PresenterWatch::isOwn(const std::string& path) const
{
    return std::ranges::any_of(_ownPaths, [&](const auto& own) { return isPathWithin(path, own); });
}

/// Answers whether to look now. In the middle of a write of this process a look would see half of the write.
bool PresenterWatch::mustLook(const WatchedPresenter& presenter) const
{
    const auto& path = presenter.item().path();
    return presenter.isDue() && !isOwn(path)
        && std::ranges::none_of(_ownPaths, [&](const auto& own) { return isPathWithin(own, path); });
}

/// Schedules one look when a presenter needs it.
void PresenterWatch::lookLater(Duration delay)
{
    const bool isNeeded =
        std::ranges::any_of(_presenters, [this](const auto& each) { return mustLook(each); });
    if (isNeeded && !std::exchange(_isLookComing, true))
        _dispatch->after(delay, _queue, weakly(this, &PresenterWatch::look));
    const bool isBlind = std::ranges::any_of(_presenters, &WatchedPresenter::isBlind);
    if (isBlind && !std::exchange(_isPollComing, true))
        _dispatch->after(pollPeriod, _queue, weakly(this, &PresenterWatch::poll));
}

void PresenterWatch::look()
{
    const auto asked = askPresenters();
    std::vector<WatchedPresenter::Notice> notices;
    {
        const std::lock_guard lock(_mutex);
        _isLookComing = false;
        update(asked);
        markEvents();
        for (auto& each : _presenters) {
            if (mustLook(each))
                each.look(*_watches, notices);
        }
        lookLater(missingSettles);
    }
    for (const auto& notice : notices) {
        if (!_isStopped)
            notice(*_notices);
    }
}

void PresenterWatch::poll()
{
    const std::lock_guard lock(_mutex);
    _isPollComing = false;
    for (auto& each : _presenters) {
        if (each.isBlind())
            each.markDue();
    }
    lookLater(changesSettle);
}

void PresenterWatch::beginOwnWrite(std::span<const OwnWrite> writes)
{
    const std::lock_guard lock(_mutex);
    for (const auto& write : writes)
        _ownPaths.push_back(write.path);
}

void PresenterWatch::endOwnWrite(std::span<const OwnWrite> writes)
{
    const std::lock_guard lock(_mutex);
    // All events of this write are in the kernel's queue by now.
    markEvents();
    for (const auto& write : writes)
        _ownPaths.erase(std::ranges::find(_ownPaths, write.path));
    for (auto& each : _presenters)
        absorb(each, writes);
    lookLater(changesSettle);
}

void PresenterWatch::absorb(WatchedPresenter& presenter, std::span<const OwnWrite> writes)
{
    const auto path = presenter.item().path();
    auto ending = WatchedPresenter::Ending::MayBeThere;
    bool isConcerned = false;
    for (const auto& write : writes) {
        isConcerned |= isPathWithin(path, write.path) || isPathWithin(write.path, path);
        if (write.isDeletion && isPathWithin(path, write.path))
            ending = WatchedPresenter::Ending::WasDeleted;
    }
    if (isConcerned)
        presenter.absorb(*_watches, ending);
}

void PresenterWatch::ownMove(const std::string& from, const std::string& to)
{
    const std::lock_guard lock(_mutex);
    for (auto& each : _presenters) {
        const auto& path = each.item().path();
        if (isPathWithin(path, from))
            each.follow(to + path.substr(from.size()));
    }
}

} // namespace host::system
