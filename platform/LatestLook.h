// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Dispatch.h"

#include <cstddef>
#include <functional>
#include <memory>
#include <optional>
#include <type_traits>
#include <utility>

namespace platform {

/// Looks at the disk on another thread for a person who has asked for something, because a disk may be slow,
/// and goes on with what was found. Only the latest look counts: what a person asks for takes the place of
/// what they asked for before. Main thread.
class LatestLook : public std::enable_shared_from_this<LatestLook> {
public:
    /// Calls `look` on another thread, and `then` with its answer on the main thread: before this returns
    /// when the disk is quick, else later. When another look begins first, or forget() is called, `dropped`
    /// is called in its place (empty: nothing).
    template <typename Look, typename Then>
    void begin(Look look, Then then, std::function<void()> dropped = {})
    {
        const auto found = std::make_shared<std::optional<std::invoke_result_t<Look>>>();
        start([found, look = std::move(look)] { found->emplace(look()); },
            [found, then = std::move(then)] { then(std::move(**found)); }, std::move(dropped));
    }
    /// Drops the look that is under way.
    void forget();

private:
    void start(Work look, std::function<void()> then, std::function<void()> dropped);
    void lookEnded(std::size_t number);

    std::shared_ptr<OperationQueue> _queue;
    std::size_t _number = 0;
    std::function<void()> _then, _dropped; ///< of the look that is under way
};

} // namespace platform
