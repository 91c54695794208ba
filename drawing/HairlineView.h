// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/layout/LayoutConstraint.h"
#include "kit/views/View.h"

#include <memory>

namespace tarrow {

/// A separator that is one device pixel thick, also after its window has moved to a display of another scale.
/// Main thread only.
class HairlineView : public kit::View {
public:
    static std::shared_ptr<HairlineView> init();

    /// Answers the points to a device pixel of the main screen.
    double _hairlineThicknessInPoints() const;

protected:
    void traitsDidChange() override;

private:
    std::shared_ptr<kit::LayoutConstraint> _thickness;
};

} // namespace tarrow
