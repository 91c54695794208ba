// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/EndPresented.h"

#include "kit/controllers/AlertController.h"
#include "kit/controllers/NavigationController.h"

namespace screens {

void endPresented(kit::NavigationController& stack)
{
    if (!stack.presentedViewController())
        return;
    const auto alert = std::dynamic_pointer_cast<kit::AlertController>(stack.visibleViewController());
    if (!alert || alert->escapeAction())
        stack.dismissViewController(false);
}

} // namespace screens
