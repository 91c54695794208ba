// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <cstdint>
#include <utility>

namespace host::system {

/// Marks, on the current thread, the time in which the accessor of one coordinated metadata read runs. What
/// is read of an item within one such time may be kept until it ends, so that the many questions about a row
/// cost one look at the disk.
class CoordinatedRead {
public:
    CoordinatedRead()
        : _outer(std::exchange(_current, ++_last))
    {
    }
    ~CoordinatedRead() { _current = _outer; }
    CoordinatedRead(const CoordinatedRead&) = delete;
    CoordinatedRead& operator=(const CoordinatedRead&) = delete;

    /// A number that no other read of this thread has; 0 outside of any.
    static std::uint64_t current() { return _current; }

private:
    inline static thread_local std::uint64_t _last = 0;
    inline static thread_local std::uint64_t _current = 0;
    std::uint64_t _outer;
};

} // namespace host::system
