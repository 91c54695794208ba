// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "drawing/ConstraintUtils.h"

#include "kit/views/View.h"

namespace tarrow {

kit::LayoutConstraints ConstraintUtils::verticallyStackedConstraintsInParentTopChildBottomChildMiddleGap(
    const View& parent, const View& topChild, const View& bottomChild, float middleGap)
{
    return {
        topChild->centerXAnchor().equalTo(parent->centerXAnchor()),
        topChild->widthAnchor().lessThanOrEqualTo(parent->widthAnchor()),
        bottomChild->centerXAnchor().equalTo(parent->centerXAnchor()),
        bottomChild->widthAnchor().lessThanOrEqualTo(parent->widthAnchor()),
        parent->topAnchor().equalTo(topChild->topAnchor()),
        bottomChild->topAnchor().equalTo(topChild->bottomAnchor(), middleGap),
        bottomChild->bottomAnchor().equalTo(parent->bottomAnchor()),
    };
}

kit::LayoutConstraints ConstraintUtils::stretchSubviewConstraintsWithinView(
    const View& subview, const View& view)
{
    return {
        subview->topAnchor().equalTo(view->topAnchor()),
        subview->bottomAnchor().equalTo(view->bottomAnchor()),
        subview->centerXAnchor().equalTo(view->centerXAnchor()),
        subview->leadingAnchor().equalTo(view->leadingAnchor()),
    };
}

} // namespace tarrow
