// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/service/LocalDownload.h"

#include "host/drive/changes/DownloadWork.h"

#include <atomic>

namespace host::drive {

using Continue = CloudStore::Continue;

namespace {

constexpr std::uint64_t bytesPerNotice = std::uint64_t{1} << 20;

std::optional<platform::Error> keepOthersOut(
    platform::FileCoordinator* coordinator, const std::string& path, const std::function<void()>& steps)
{
    if (coordinator)
        return coordinator->coordinateWriting(platform::Url::fileURL(path), platform::WritingOptions::None,
            [&](const platform::Url&) { steps(); });
    steps();
    return std::nullopt;
}

} // namespace

/// The state is shared with the work in the background and on the main queue, which goes on when the handle
/// is gone.
struct LocalDownload::State {
    std::shared_ptr<platform::Queue> mainQueue;
    platform::DownloadHandlers handlers;
    std::atomic<bool> isCancelled = false;
    std::uint64_t noticed = 0; ///< used in the background only
};

Continue LocalDownload::tell(
    const std::shared_ptr<State>& state, std::uint64_t done, const std::optional<std::uint64_t>& total)
{
    if (state->isCancelled)
        return Continue::No;
    const bool isDue = done - state->noticed >= bytesPerNotice || done == total;
    if (!isDue || !state->handlers.progress)
        return Continue::Yes;
    state->noticed = done;
    state->mainQueue->async([state, progress = platform::DownloadProgress{done, total}] {
        if (!state->isCancelled)
            state->handlers.progress(progress);
    });
    return Continue::Yes;
}

std::unique_ptr<LocalDownload> LocalDownload::start(
    const Setting& setting, const std::string& path, platform::DownloadHandlers handlers)
{
    auto state = std::make_shared<State>();
    state->mainQueue = setting.mainQueue;
    state->handlers = std::move(handlers);
    setting.queue->addOperation(
        [state, layout = setting.layout, store = setting.store, coordinator = setting.coordinator, path] {
            auto error = state->isCancelled
                ? std::nullopt
                : bringHere(
                    layout, *store, path,
                    [&](std::uint64_t done, std::optional<std::uint64_t> total) {
                        return tell(state, done, total);
                    },
                    [&](const auto& steps) { return keepOthersOut(coordinator.get(), path, steps); });
            // The handlers are destroyed on the thread that made them.
            state->mainQueue->async([state, error = std::move(error)] {
                if (!state->isCancelled.exchange(true) && state->handlers.completion)
                    state->handlers.completion(error);
                state->handlers = {};
            });
        });
    return std::unique_ptr<LocalDownload>(new LocalDownload(std::move(state)));
}

void LocalDownload::cancel()
{
    _state->isCancelled = true;
}

} // namespace host::drive
