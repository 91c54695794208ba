// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/layout/LayoutConstraint.h"

#include <memory>

namespace kit {
class View;
}

namespace tarrow {

/// Makes the constraints of common arrangements. The caller activates them. Main thread only.
class ConstraintUtils {
public:
    using View = std::shared_ptr<kit::View>;

    ConstraintUtils() = delete;

    /// Answers seven constraints that put one view above another, both centred and at most as wide as the
    /// parent, from its top to its bottom with a gap of `middleGap` points between them: for the top child
    /// its centre and its width, the same for the bottom child, the top, the gap and the bottom.
    static kit::LayoutConstraints verticallyStackedConstraintsInParentTopChildBottomChildMiddleGap(
        const View& parent, const View& topChild, const View& bottomChild, float middleGap);
    /// Answers four constraints that lay a subview over the whole of a view: top, bottom, centre, leading
    /// edge.
    static kit::LayoutConstraints stretchSubviewConstraintsWithinView(const View& subview, const View& view);
};

} // namespace tarrow
