// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/views/GestureRecognizer.h"

#include <optional>

namespace kit {

/// Recognises a touch that rests. The handler is called once, while the finger is still down: at the first
/// report, `held` or `moved`, that comes after the minimum duration.
class LongPressRecognizer : public GestureRecognizer {
public:
    using GestureRecognizer::GestureRecognizer;

    static constexpr double maximumMovement = 10; ///< points
    static constexpr Time minimumDuration{500};

    void pressed(Point point, Time time) override;
    void moved(Point point, Time time) override;
    void released(Point point, Time time) override;
    void cancelled() override;
    /// Reports that time has passed and the finger has not moved. A host with a long-press gesture of its own
    /// calls this.
    void held(Time time);

private:
    struct Press {
        Point point;
        Time time;
    };
    std::optional<Press> _press;
};

} // namespace kit
