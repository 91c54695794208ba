// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/PlatformNames.h"
#include "platform/Geometry.h"

#include <cstdint>
#include <memory>
#include <variant>

namespace kit {

class BarButtonItem;
class View;

/// The sides of a popover on which its arrow may be.
enum class ArrowDirections : std::uint8_t {
    Up = 1,
    Down = 2,
    Left = 4,
    Right = 8,
    LeftOrRight = Left | Right,
    Any = Up | Down | Left | Right,
};

/// A rectangle of a view, in the view's coordinates.
struct ViewAnchor {
    std::weak_ptr<View> view;
    Rect rect;
    ArrowDirections arrows = ArrowDirections::Any;
};

/// A popover points at nothing, at a rectangle of a view, or at an item of a bar.
using PopoverAnchor = std::variant<std::monostate, ViewAnchor, std::weak_ptr<BarButtonItem>>;

} // namespace kit
