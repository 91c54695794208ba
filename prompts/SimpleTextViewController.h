// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/ViewController.h"
#include "kit/values/Font.h"

namespace platform::ui {
class Label;
}

namespace tarrow {

/// A short message in red, as tall as its text, for the inside of an alert. Made with std::make_shared. Main
/// thread.
class SimpleTextViewController : public platform::ui::ViewController {
public:
    /// Null before the view is loaded.
    const std::shared_ptr<platform::ui::Label>& messageLabel() const { return _messageLabel; }
    platform::ui::Font messageLabelFont() const;

    void viewDidLoad() override;

private:
    /// Points between the label and either side of the view.
    double _labelHorizontalInsets() const { return 16.0; }
    void constrainLabel();

    std::shared_ptr<platform::ui::Label> _messageLabel;
};

} // namespace tarrow
