// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/views/ActivityIndicator.h"

#include "kit/views/ViewVisitor.h"

namespace kit {

void ActivityIndicator::accept(ViewVisitor& visitor)
{
    visitor.visit(*this);
}

void ActivityIndicator::startAnimating()
{
    if (_animating)
        return;
    _animating = true;
    changed(ViewChange::Content);
}

void ActivityIndicator::stopAnimating()
{
    if (!_animating)
        return;
    _animating = false;
    changed(ViewChange::Content);
}

Size ActivityIndicator::intrinsicContentSize(double) const
{
    return {sideLength, sideLength};
}

} // namespace kit
