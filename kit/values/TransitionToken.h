// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <functional>
#include <memory>

namespace kit {

/// A peer holds a token while it shows a transition. The model has already changed; the callbacks that wait
/// for the end of the movement run once, when `finish()` is called or when the last copy of the token is
/// destroyed. Because of that, a peer that is destroyed during the movement loses no callback. Without an
/// observer the callbacks run at once, and the next change finishes a movement that still runs. Main thread
/// only.
class TransitionToken {
public:
    /// Makes a token that is finished already.
    TransitionToken() = default;
    explicit TransitionToken(std::function<void()> atEnd);

    /// Runs the waiting callbacks. Later calls do nothing.
    void finish() const;
    bool isFinished() const;

private:
    struct State;
    std::shared_ptr<State> _state;
};

} // namespace kit
