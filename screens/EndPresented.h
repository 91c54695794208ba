// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

namespace kit {
class NavigationController;
}

namespace screens {

/// Takes away every screen that lies over a stack. None of them is answered. A question that Escape does not
/// close stays with all that lies below it, because it asks about changes that would be lost without an
/// answer. Main thread.
void endPresented(kit::NavigationController& stack);

} // namespace screens
