// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Dispatch.h"
#include "platform/Error.h"
#include "platform/NotificationCenter.h"

#include <atomic>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>

namespace tarrow {

class QuotaFetcher;

/// Is told how much storage is free. Main thread.
class QuotaFetcherDelegate {
public:
    virtual ~QuotaFetcherDelegate() = default;
    /// Called after each successful fetch, whether or not the number changed. Overriding it is optional.
    virtual void quotaFetcherDidUpdateValue(QuotaFetcher&, std::uint64_t /*freeBytes*/) { }
};

/// Asks the cloud document service, periodically and on demand, how many bytes of the drive are free. It asks
/// nothing while the application is inactive or nobody is signed in.
///
/// Main thread, except for performFetch() and fetchUserQuotaWithCompletion(), which run on the fetcher's
/// queue.
class QuotaFetcher : public std::enable_shared_from_this<QuotaFetcher> {
    struct Private { };

public:
    /// Called with the free bytes and no error, or with an error, on a thread of the service's choosing.
    using QuotaCompletion =
        std::function<void(std::uint64_t freeBytes, const std::optional<platform::Error>&)>;

    /// Makes a fetcher without a timer, which may fetch and follows the application's state from now on.
    static std::shared_ptr<QuotaFetcher> init();
    explicit QuotaFetcher(Private);
    ~QuotaFetcher();
    QuotaFetcher(const QuotaFetcher&) = delete;
    QuotaFetcher& operator=(const QuotaFetcher&) = delete;

    std::shared_ptr<QuotaFetcherDelegate> delegate() const { return _delegate.lock(); }
    void setDelegate(const std::shared_ptr<QuotaFetcherDelegate>& delegate) { _delegate = delegate; }

    /// The bytes that were free at the last successful fetch; 0 before the first one.
    std::uint64_t freeBytes() const { return _freeBytes; }
    bool canFetch() const { return _canFetch; }
    const std::shared_ptr<platform::Queue>& queue() const { return _queue; }
    const std::shared_ptr<platform::OperationQueue>& quotaFetchingOperationsQueue() const
    {
        return _quotaFetchingOperationsQueue;
    }
    /// The running timer, or null before runWithInterval().
    const platform::Timer* timer() const { return _timer.get(); }

    /// Fetches at once and then every `seconds`, each time at most one second late. A further call replaces
    /// the earlier schedule.
    void runWithInterval(double seconds);
    /// Fetches once, as soon as the queue can.
    void fetchNow();
    /// Makes one attempt, on the fetcher's queue. The delegate is told of the value later, on the main
    /// thread.
    void performFetch();
    /// Asks the service. The completion is called once, or never when nobody is signed in. Any thread.
    void fetchUserQuotaWithCompletion(QuotaCompletion completion);
    /// Stores a value and tells the delegate.
    void notify(std::uint64_t freeBytes);

    void didBecomeActiveNotification();
    void willResignActiveNotification();

private:
    void observeApplication();

    std::weak_ptr<QuotaFetcherDelegate> _delegate;
    std::uint64_t _freeBytes = 0;
    std::shared_ptr<platform::Queue> _queue;
    std::unique_ptr<platform::Timer> _timer;
    std::atomic<bool> _canFetch = true; ///< written on the main thread, read on the queue
    std::shared_ptr<platform::OperationQueue> _quotaFetchingOperationsQueue;
    platform::Observation _becameActive, _willResignActive;
};

} // namespace tarrow
