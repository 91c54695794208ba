#pragma once

#include "platform/Image.h"

#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace platform::ui {

enum class MenuActionStyle { Default, Destructive };

/// One entry of a context menu.
struct MenuAction {
    std::string title;
    std::function<void()> handler;
    MenuActionStyle style = MenuActionStyle::Default;
    bool enabled = true;
    std::optional<Image> image;
};

using Menu = std::vector<MenuAction>;

} // namespace platform::ui
