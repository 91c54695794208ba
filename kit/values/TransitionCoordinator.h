// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/TransitionToken.h"

#include <functional>
#include <vector>

namespace kit {

/// Handed to a screen that is about to change its size: collects what changes along with it.
class TransitionCoordinator {
public:
    /// `alongside` runs with the change, `completion` after it; each once.
    void animateAlongside(std::function<void()> alongside, std::function<void()> completion = {});

    /// The kit's affair: the change takes place.
    void run();

private:
    std::vector<std::function<void()>> _alongside, _completions;
};

} // namespace kit
