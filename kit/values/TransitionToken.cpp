// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/values/TransitionToken.h"

#include <utility>

namespace kit {

struct TransitionToken::State {
    std::function<void()> atEnd;

    ~State() { run(); }
    void run()
    {
        if (const auto call = std::exchange(atEnd, nullptr))
            call();
    }
};

TransitionToken::TransitionToken(std::function<void()> atEnd)
    : _state(std::make_shared<State>())
{
    _state->atEnd = std::move(atEnd);
}

void TransitionToken::finish() const
{
    if (const auto state = _state)
        state->run();
}

bool TransitionToken::isFinished() const
{
    return !_state || !_state->atEnd;
}

} // namespace kit
