// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "drawing/HairlineView.h"

#include "kit/values/Screen.h"
#include "kit/values/StandardColors.h"

namespace tarrow {

std::shared_ptr<HairlineView> HairlineView::init()
{
    auto line = std::make_shared<HairlineView>();
    line->setPlacedByFrame(false);
    line->setBackground(kit::StandardColors::hairline);
    line->setCompressionResistance(kit::LayoutPriorities::required, kit::Axis::Vertical);
    line->_thickness = line->heightAnchor().equalToConstant(line->_hairlineThicknessInPoints());
    line->_thickness->setActive(true);
    return line;
}

double HairlineView::_hairlineThicknessInPoints() const
{
    return 1 / kit::Screen::mainScale();
}

void HairlineView::traitsDidChange()
{
    View::traitsDidChange();
    if (_thickness)
        _thickness->setConstant(_hairlineThicknessInPoints());
}

} // namespace tarrow
