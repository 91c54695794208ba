// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "preview/PreviewBaseViewController.h"

#include <memory>

namespace screens {
class PlaceholderView;
}

namespace tarrow {

/// Shows the description of one item: its icon, name, kind and size. Main thread only.
class PreviewDetailsViewController : public PreviewBaseViewController {
public:
    void viewDidLoad() override;
    void refreshItem() override;

    /// Answers null before the view is loaded.
    const std::shared_ptr<screens::PlaceholderView>& summaryView() const { return _summaryView; }

private:
    std::shared_ptr<screens::PlaceholderView> _summaryView;
};

} // namespace tarrow
