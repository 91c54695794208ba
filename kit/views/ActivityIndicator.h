// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/views/View.h"

namespace kit {

/// A spinner for work whose end is not known.
class ActivityIndicator : public View {
public:
    ActivityIndicator() = default;

    void accept(ViewVisitor& visitor) override;

    bool isAnimating() const { return _animating; }
    void startAnimating();
    void stopAnimating();

    static constexpr double sideLength = 20; ///< points
    Size intrinsicContentSize(double maxWidth = 0) const override;

private:
    bool _animating = false;
};

} // namespace kit
