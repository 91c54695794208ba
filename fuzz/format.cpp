// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "fuzz/support/Fuzzing.h"
#include "kit/layout/VisualFormat.h"
#include "kit/views/View.h"

#include <algorithm>
#include <cmath>

namespace {

using kit::LayoutConstraint;
using kit::View;

std::shared_ptr<View> childOf(View& parent)
{
    auto child = std::make_shared<View>();
    child->setPlacedByFrame(false);
    parent.addSubview(child);
    return child;
}

/// The solver promises places for lengths as they occur on screens.
bool isModest(const std::shared_ptr<LayoutConstraint>& constraint)
{
    return std::abs(constraint->constant()) < 1e6;
}

} // namespace

void fuzzing::tryInput(std::string_view input)
{
    const auto root = std::make_shared<View>(platform::Rect{0, 0, 360, 640});
    const auto a = childOf(*root), b = childOf(*root);
    const auto made = kit::VisualFormat::parse(
        input, {{{"a", a}, {"b", b}, {"loose", std::make_shared<View>()}}, {{"gap", 12}, {"info", 3}}});
    require(!made.error || made.constraints.empty(), "a wrong format makes nothing");
    require(!made.error || made.error->position <= input.size(), "a mistake has a place");
    require(std::ranges::all_of(made.constraints, [](const auto& c) { return std::isfinite(c->constant()); }),
        "every length is a number");
    if (!std::ranges::all_of(made.constraints, isModest))
        return;
    LayoutConstraint::activate(made.constraints);
    root->layoutIfNeeded();
    for (const auto& view : {a, b}) {
        const auto& frame = view->frame();
        require(std::isfinite(frame.x + frame.y + frame.width + frame.height), "every view has a place");
    }
}
