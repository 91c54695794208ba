// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <memory>

namespace kit {

class NavigationController;
class ViewController;

/// Is told which screen a navigation controller shows. Main thread only.
class NavigationControllerDelegate {
public:
    virtual ~NavigationControllerDelegate() = default;

    virtual void navigationControllerWillShowViewControllerAnimated(
        NavigationController&, const std::shared_ptr<ViewController>& /*screen*/, bool /*animated*/)
    {
    }
    /// Called after the movement, also when the user went back.
    virtual void navigationControllerDidShowViewControllerAnimated(
        NavigationController&, const std::shared_ptr<ViewController>& /*screen*/, bool /*animated*/)
    {
    }
};

} // namespace kit
