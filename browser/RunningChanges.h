// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/ItemChange.h"

#include <chrono>
#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace platform {
class Timer;
}

namespace tarrow {

/// The changes that the browser has begun and that have not ended. Main thread.
class RunningChanges : public std::enable_shared_from_this<RunningChanges> {
public:
    /// Makes an empty collection. `changed` is called when a change has begun or ended, `progressed` several
    /// times a second while a long one runs.
    static std::shared_ptr<RunningChanges> create(
        std::function<void()> changed, std::function<void()> progressed);
    RunningChanges() = default;

    /// A change that takes longer shows its progress.
    static constexpr auto longTime = std::chrono::milliseconds(500);
    /// Answers whether that time has passed since a moment.
    static bool isLong(const platform::Date& since);

    void begun(const std::shared_ptr<ItemChange>& change);
    /// Forgets the changes that have ended.
    void forgetEnded();

    /// Answers the items of all changes.
    std::vector<Url> items() const;
    /// Answers the change whose progress a person wants to see: the first one, once it has taken half a
    /// second; null otherwise.
    std::shared_ptr<ItemChange> longOne() const;
    /// Says how far a change has come.
    static std::string progressText(const ItemChange& change);

private:
    struct Running {
        std::shared_ptr<ItemChange> change;
        platform::Date since;
    };
    void follow();

    std::function<void()> _changed, _progressed;
    std::vector<Running> _running;
    std::unique_ptr<platform::Timer> _timer;
};

} // namespace tarrow
