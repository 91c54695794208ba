// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/views/ViewObserver.h"

namespace kit {

void ViewObserver::viewWantsFocus(View&, bool) { }

std::optional<Size> ViewObserver::nativeSize(const View&, double)
{
    return std::nullopt;
}

} // namespace kit
