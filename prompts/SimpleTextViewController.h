// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/ViewController.h"
#include "kit/values/Font.h"

namespace kit {
class Label;
}

namespace tarrow {

/// A short message in red, as tall as its text, for the content of an alert. Made with std::make_shared. Main
/// thread.
class SimpleTextViewController : public kit::ViewController {
public:
    /// Answers null before the view is loaded.
    const std::shared_ptr<kit::Label>& messageLabel() const { return _messageLabel; }
    kit::Font messageLabelFont() const;

    void viewDidLoad() override;

private:
    /// Answers the points between the label and either side of the view.
    double _labelHorizontalInsets() const { return 16.0; }
    void constrainLabel();

    std::shared_ptr<kit::Label> _messageLabel;
};

} // namespace tarrow
