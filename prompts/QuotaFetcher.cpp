// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "prompts/QuotaFetcher.h"

#include "platform/CloudDocumentService.h"
#include "platform/Log.h"
#include "platform/Services.h"
#include "platform/Weakly.h"

#include <algorithm>

namespace tarrow {

using platform::Notification;
using platform::Operation;
using platform::services;
using platform::weakly;

namespace {

constexpr platform::Duration leeway = std::chrono::seconds(1);

} // namespace

std::shared_ptr<QuotaFetcher> QuotaFetcher::init()
{
    auto fetcher = std::make_shared<QuotaFetcher>(Private{});
    fetcher->observeApplication();
    return fetcher;
}

QuotaFetcher::QuotaFetcher(Private)
    : _queue(services().dispatch().makeSerialQueue("TarrowDriveAppID.quotafetcher"))
    , _quotaFetchingOperationsQueue(services().dispatch().makeOperationQueue(
          "TarrowDriveAppID.quotafetcher.operations", platform::QualityOfService::Utility))
{
}

QuotaFetcher::~QuotaFetcher()
{
    if (_timer)
        _timer->cancel();
}

void QuotaFetcher::observeApplication()
{
    auto& center = services().notificationCenter();
    _becameActive = center.observe(
        Notification::ApplicationDidBecomeActive, weakly(this, &QuotaFetcher::didBecomeActiveNotification));
    _willResignActive = center.observe(
        Notification::ApplicationWillResignActive, weakly(this, &QuotaFetcher::willResignActiveNotification));
}

void QuotaFetcher::runWithInterval(double seconds)
{
    if (_timer)
        _timer->cancel();
    _timer = nullptr;
    const auto period =
        std::chrono::duration_cast<platform::Duration>(std::chrono::duration<double>(seconds));
    _timer =
        services().dispatch().startTimer(_queue, period, leeway, weakly(this, &QuotaFetcher::performFetch));
}

void QuotaFetcher::fetchNow()
{
    _queue->async(weakly(this, &QuotaFetcher::performFetch));
}

void QuotaFetcher::performFetch()
{
    static constexpr Operation op{"-[QuotaFetcher performFetch]"};
    if (!_canFetch) {
        op.debug("Not fetching quota: backgrounded.");
        return;
    }
    fetchUserQuotaWithCompletion([weak = weak_from_this()](std::uint64_t freeBytes, const auto& error) {
        if (error) {
            op.warning("can't update quota: %{public}@", *error);
            return;
        }
        services().dispatch().mainQueue()->async(weakly(weak, &QuotaFetcher::notify, freeBytes));
    });
}

void QuotaFetcher::fetchUserQuotaWithCompletion(QuotaCompletion completion)
{
    static constexpr Operation op{"-[QuotaFetcher fetchUserQuotaWithCompletion:]"};
    const auto& account = services().cloudDocumentService().account();
    if (!account.identityToken()) {
        op.info("Not fetching quota. Ubiquity is not enabled");
        return;
    }
    _quotaFetchingOperationsQueue->addOperation(account.makeQuotaFetchOperation(
        [completion = std::move(completion)](const platform::Result<std::int64_t>& result) {
            // An account above its limit has a negative number of free bytes, which counts as 0.
            const auto bytes = std::max<std::int64_t>(0, result.value.value_or(0));
            completion(static_cast<std::uint64_t>(bytes), result.error);
        }));
}

void QuotaFetcher::notify(std::uint64_t freeBytes)
{
    _freeBytes = freeBytes;
    if (const auto delegate = _delegate.lock())
        delegate->quotaFetcherDidUpdateValue(*this, _freeBytes);
}

void QuotaFetcher::didBecomeActiveNotification()
{
    static constexpr Operation op{"-[QuotaFetcher didBecomeActiveNotification:]"};
    op.info("HostDidActivateEvent (quota)");
    _canFetch = true;
}

void QuotaFetcher::willResignActiveNotification()
{
    static constexpr Operation op{"-[QuotaFetcher willResignActiveNotification:]"};
    op.info("HostWillDeactivateEvent (quota)");
    _canFetch = false;
}

} // namespace tarrow
