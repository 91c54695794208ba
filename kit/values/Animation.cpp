// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/values/Animation.h"

#include <utility>

namespace kit {

namespace {

const AnimationOptions*& runningAnimation()
{
    static const AnimationOptions* options = nullptr;
    return options;
}

} // namespace

void animate(const AnimationOptions& options, const std::function<void()>& changes,
    const std::function<void()>& completion)
{
    const auto* outer = std::exchange(runningAnimation(), &options);
    if (changes)
        changes();
    runningAnimation() = outer;
    if (completion)
        completion();
}

const AnimationOptions* currentAnimation()
{
    return runningAnimation();
}

} // namespace kit
