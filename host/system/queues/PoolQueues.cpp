// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/queues/PoolQueues.h"

#include <deque>
#include <mutex>

namespace host::system {

using platform::Work;

class PendingWork : public std::enable_shared_from_this<PendingWork> {
public:
    enum class Turns { OneAfterTheOther, AllAtOnce };

    PendingWork(const std::shared_ptr<WorkerPool>& pool, Turns turns)
        : _pool(pool)
        , _turns(turns)
    {
    }

    void add(Work work)
    {
        {
            const std::lock_guard lock(_mutex);
            _works.push_back(std::move(work));
            if (_turns == Turns::OneAfterTheOther && _hasTurn)
                return;
            _hasTurn = true;
        }
        submitTurn();
    }

private:
    void submitTurn()
    {
        if (const auto pool = _pool.lock())
            pool->submit([weak = weak_from_this()] { runTurn(weak); });
    }

    /// Runs one piece of work and lines up for the next, so that the queues of a pool take turns. The queue
    /// may be destroyed while its work runs.
    static void runTurn(const std::weak_ptr<PendingWork>& weak)
    {
        Work work;
        if (const auto self = weak.lock())
            work = self->takeFirst();
        if (!work)
            return;
        work();
        work = nullptr;
        if (const auto self = weak.lock(); self && self->needsNextTurn())
            self->submitTurn();
    }

    Work takeFirst()
    {
        const std::lock_guard lock(_mutex);
        auto work = std::move(_works.front());
        _works.pop_front();
        return work;
    }

    bool needsNextTurn()
    {
        if (_turns == Turns::AllAtOnce)
            return false;
        const std::lock_guard lock(_mutex);
        _hasTurn = !_works.empty();
        return _hasTurn;
    }

    std::weak_ptr<WorkerPool> _pool;
    const Turns _turns;
    std::mutex _mutex;
    std::deque<Work> _works;
    bool _hasTurn = false;
};

SerialQueue::SerialQueue(const std::shared_ptr<WorkerPool>& pool, std::string label)
    : _pending(std::make_shared<PendingWork>(pool, PendingWork::Turns::OneAfterTheOther))
    , _label(std::move(label))
{
}

void SerialQueue::async(Work work)
{
    _pending->add(std::move(work));
}

PoolOperationQueue::PoolOperationQueue(
    const std::shared_ptr<WorkerPool>& pool, std::string name, platform::QualityOfService quality)
    : _pending(std::make_shared<PendingWork>(pool, PendingWork::Turns::AllAtOnce))
    , _name(std::move(name))
    , _quality(quality)
{
}

void PoolOperationQueue::addOperation(Work work)
{
    _pending->add(std::move(work));
}

} // namespace host::system
