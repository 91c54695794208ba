// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/views/GestureRecognizer.h"

#include <optional>

namespace kit {

/// Recognises a short touch that does not move. The handler is called once, when the finger is lifted.
class TapRecognizer : public GestureRecognizer {
public:
    using GestureRecognizer::GestureRecognizer;

    /// A touch that moves further than this many points is no tap.
    static constexpr double maximumMovement = 10;
    /// A touch that lasts longer is a long press.
    static constexpr Time maximumDuration{500};

    void pressed(Point point, Time time) override;
    void moved(Point point, Time time) override;
    void released(Point point, Time time) override;
    void cancelled() override;

private:
    struct Press {
        Point point;
        Time time;
    };
    std::optional<Press> _press;
};

} // namespace kit
