// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <functional>

namespace kit {

/// The platform's curves, with the numbers that keyboard notices carry.
enum class AnimationCurve { EaseInOut = 0, EaseIn = 1, EaseOut = 2, Linear = 3 };

struct AnimationOptions {
    double duration = 0.25; ///< seconds
    double delay = 0; ///< seconds
    AnimationCurve curve = AnimationCurve::EaseInOut;
    bool laysOutSubviews = false;
    bool beginsFromCurrentState = false;
};

/// Runs changes that a host may show as a movement. The model changes at once, and `completion` is called
/// right afterwards. While `changes` runs, peers that are told of a change read the options from
/// `currentAnimation()`. Main thread only.
void animate(const AnimationOptions& options, const std::function<void()>& changes,
    const std::function<void()>& completion = {});

/// Answers null outside of `animate`.
const AnimationOptions* currentAnimation();

} // namespace kit
