// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/views/View.h"

namespace kit {

enum class StackAlignment { Fill, Leading, Center, Trailing, FirstBaseline };
enum class StackDistribution { Fill, FillEqually };

/// Arranges views in a row or a column by constraints of its own. Hidden views take no room.
class StackView : public View {
public:
    explicit StackView(Axis axis = Axis::Horizontal);

    const std::vector<std::shared_ptr<View>>& arrangedSubviews() const { return _arranged; }
    void addArrangedSubview(const std::shared_ptr<View>& view);
    void insertArrangedSubview(const std::shared_ptr<View>& view, std::size_t index);
    /// Stops arranging a view, which stays a subview.
    void removeArrangedSubview(const std::shared_ptr<View>& view);

    Axis axis() const { return _axis; }
    void setAxis(Axis axis);
    /// In a row, Leading means the top and Trailing the bottom.
    StackAlignment stackAlignment() const { return _alignment; }
    void setStackAlignment(StackAlignment alignment);
    StackDistribution distribution() const { return _distribution; }
    void setDistribution(StackDistribution distribution);
    double spacing() const { return _spacing; } ///< points between neighbours
    void setSpacing(double points);

    void updateConstraints() override;

protected:
    void subviewVisibilityDidChange() override;
    void willRemoveSubview(View& view) override;

private:
    void arrangementDidChange();

    std::vector<std::shared_ptr<View>> _arranged;
    LayoutConstraints _own;
    Axis _axis;
    StackAlignment _alignment = StackAlignment::Fill;
    StackDistribution _distribution = StackDistribution::Fill;
    double _spacing = 0;
};

} // namespace kit
