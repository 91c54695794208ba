// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <functional>
#include <memory>

namespace kit {

/// What a peer holds while it shows a transition. The model has changed already; what has to wait for the end
/// of the movement runs once, when `finish()` is called or when the last copy of the token is destroyed, so
/// that a peer that dies in the middle loses nothing. Without an observer it runs at once, and the next
/// change finishes what still runs. Main thread only.
class TransitionToken {
public:
    /// A token that is finished already.
    TransitionToken() = default;
    explicit TransitionToken(std::function<void()> atEnd);

    /// Runs what waits. Later calls do nothing.
    void finish() const;
    bool isFinished() const;

private:
    struct State;
    std::shared_ptr<State> _state;
};

} // namespace kit
