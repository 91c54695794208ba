// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/SystemError.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace host::system {

/// The kernel's notices of changes in folders. The kernel's queue is made for the first watch and read in the
/// main loop (GLib's default main context). Any thread, except for `arrived`.
class Inotify {
public:
    /// Says whether a file that is being written is reported at once or when it is closed.
    enum class Writing { WhenClosed, AtOnce };

    struct Event {
        int watch = -1;
        std::uint32_t mask = 0; ///< the kernel's bits
        std::uint32_t cookie = 0; ///< the same for both halves of a move; else 0
        std::string name; ///< empty: the watched folder itself

        /// Answers whether changes may have been missed, because there were too many events or the folder
        /// went away.
        bool isLoss() const;
    };

    /// `arrived` is called on the main thread when events are waiting. It may destroy this object.
    Inotify(Writing writing, std::function<void()> arrived);
    ~Inotify();
    Inotify(const Inotify&) = delete;
    Inotify& operator=(const Inotify&) = delete;

    /// Watches the names in a folder: created, removed, moved, written, or with other attributes. Answers the
    /// watch, which is the same for the same folder. Errors: ENOSPC or EMFILE when the system has none left.
    SystemResult<int> watch(const std::string& folder);
    void unwatch(int watch);

    /// Answers all events up to this call that were not taken yet, in order.
    std::vector<Event> take();

private:
    struct State;
    std::shared_ptr<State> _state;
};

} // namespace host::system
