// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/TransitionToken.h"

#include <functional>
#include <vector>

namespace kit {

/// Collects what runs along with a screen's change of size. It is handed to the screen before the change.
class TransitionCoordinator {
public:
    /// `alongside` runs with the change and `completion` after it, each of them once.
    void animateAlongside(std::function<void()> alongside, std::function<void()> completion = {});

    /// The kit calls this when the change takes place.
    void run();

private:
    std::vector<std::function<void()>> _alongside, _completions;
};

} // namespace kit
