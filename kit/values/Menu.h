// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/PlatformNames.h"
#include "platform/Image.h"

#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace kit {

enum class MenuActionStyle { Default, Destructive };

/// Says whether an entry is one of several choices, and whether it is the present one.
enum class MenuMark { None, Off, On };

/// One entry of a context menu.
struct MenuAction {
    std::string title;
    std::function<void()> handler;
    MenuActionStyle style = MenuActionStyle::Default;
    bool enabled = true;
    std::optional<Image> image{};
    MenuMark mark = MenuMark::None;
    bool beginsSection = false; ///< a line stands above it
};

using Menu = std::vector<MenuAction>;

} // namespace kit
