// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

namespace kit {

class ViewController;

/// Calls down: the bars around a screen have changed.
class ViewControllerObserver {
public:
    virtual ~ViewControllerObserver() = default;
    /// The title, the navigation item or the toolbar items changed. This may come several times for one
    /// change.
    virtual void barsDidChange(ViewController& controller) = 0;
};

} // namespace kit
