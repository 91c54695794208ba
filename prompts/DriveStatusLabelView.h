// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/views/View.h"

#include <memory>
#include <string>

namespace screens {
class StorageUpgradeButton;
}
namespace kit {
class Label;
}

namespace tarrow {

/// Shows the status line under a folder list, centred, with the upgrade button below it while storage is low.
class DriveStatusLabelView : public kit::View {
public:
    /// Makes a view that grows and shrinks with its superview. It has no label and no button yet.
    static std::shared_ptr<DriveStatusLabelView> initWithFrame(const platform::Rect& frame);
    explicit DriveStatusLabelView(const platform::Rect& frame);

    /// The status line, or null before it is set.
    const std::shared_ptr<kit::Label>& primaryLabel() const { return _primaryLabel; }
    void setPrimaryLabel(std::shared_ptr<kit::Label> label) { _primaryLabel = std::move(label); }
    /// The upgrade button, or null before it is set.
    const std::shared_ptr<screens::StorageUpgradeButton>& quotaButton() const { return _quotaButton; }
    void setQuotaButton(std::shared_ptr<screens::StorageUpgradeButton> button);

    void setPrimaryLabelText(const std::string& text);

    /// Answers whether the button is shown and laid out. It is not at first.
    bool showLowQuota() const { return _showLowQuota; }
    /// Sets the flag and changes nothing else.
    void setShowLowQuota(bool show) { _showLowQuota = show; }
    /// Shows or hides the button.
    void showLowQuota(bool show);

    void layoutSubviews() override;
    /// The size is as wide as the wider one of the two views and high enough for both, one above the other.
    platform::Size intrinsicContentSize(double maxWidth = 0) const override;

private:
    struct Block;
    Block block(double labelHeight, double titleHeight) const;
    double titleHeight(double labelHeight) const;

    std::shared_ptr<kit::Label> _primaryLabel;
    std::shared_ptr<screens::StorageUpgradeButton> _quotaButton;
    bool _showLowQuota = false;
};

} // namespace tarrow
