// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/ViewController.h"
#include "screens/PlaceholderView.h"

#include <functional>
#include <memory>
#include <vector>

namespace screens {

/// Is shown while the drive cannot be used. It says what happened and what to do. Main thread only.
class UnavailableScreen : public kit::ViewController {
public:
    /// Answers the screen for when nobody is signed in.
    static std::shared_ptr<UnavailableScreen> create();
    /// Answers the screen for when somebody is signed in and the drive's top level cannot be found. The
    /// button "Try Again" calls `tryAgain`.
    static std::shared_ptr<UnavailableScreen> createForMissingDrive(std::function<void()> tryAgain);

    /// Derived classes and the operations above call this.
    UnavailableScreen(PlaceholderView::Content content, std::vector<PlaceholderView::Action> actions);
    void loadView() override;

    const std::shared_ptr<PlaceholderView>& placeholder() const { return _placeholder; } ///< null: not loaded

private:
    PlaceholderView::Content _content;
    std::vector<PlaceholderView::Action> _actions;
    std::shared_ptr<PlaceholderView> _placeholder;
};

} // namespace screens
