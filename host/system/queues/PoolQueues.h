// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/queues/WorkerPool.h"
#include "platform/Dispatch.h"

#include <memory>
#include <string>

namespace host::system {

/// Work that waits for its turn on a pool. When it is destroyed, work that has not begun never runs.
class PendingWork;

/// A queue that runs on whichever thread of a pool is free, one piece of work at a time.
class SerialQueue : public platform::Queue {
public:
    SerialQueue(const std::shared_ptr<WorkerPool>& pool, std::string label);
    void async(platform::Work work) override;
    const std::string& label() const override { return _label; }

private:
    std::shared_ptr<PendingWork> _pending;
    std::string _label;
};

/// A queue that runs on every free thread of a pool.
class PoolOperationQueue : public platform::OperationQueue {
public:
    PoolOperationQueue(
        const std::shared_ptr<WorkerPool>& pool, std::string name, platform::QualityOfService quality);
    void addOperation(platform::Work work) override;
    const std::string& name() const override { return _name; }
    platform::QualityOfService qualityOfService() const override { return _quality; }

private:
    std::shared_ptr<PendingWork> _pending;
    std::string _name;
    platform::QualityOfService _quality;
};

} // namespace host::system
