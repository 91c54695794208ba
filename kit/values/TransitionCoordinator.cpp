// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/values/TransitionCoordinator.h"

#include <utility>

namespace kit {

void TransitionCoordinator::animateAlongside(
    std::function<void()> alongside, std::function<void()> completion)
{
    if (alongside)
        _alongside.push_back(std::move(alongside));
    if (completion)
        _completions.push_back(std::move(completion));
}

void TransitionCoordinator::run()
{
    for (const auto& call : std::exchange(_alongside, {}))
        call();
    for (const auto& call : std::exchange(_completions, {}))
        call();
}

} // namespace kit
