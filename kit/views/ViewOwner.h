// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

namespace kit {

/// Stands behind the root view of a screen, and is told whenever that view lays out its subviews.
class ViewOwner {
public:
    virtual ~ViewOwner() = default;

    virtual void viewWillLayoutSubviews() { } ///< before the root view lays out its subviews
    virtual void viewDidLayoutSubviews() { } ///< after it has
};

} // namespace kit
