// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/Theme.h"
#include "kit/values/TextMeasurer.h"

#include <memory>

namespace host::gtk {

/// Measures texts with the fonts in which the labels are shown.
class PangoTextMeasurer : public kit::TextMeasurer {
public:
    explicit PangoTextMeasurer(std::shared_ptr<const Theme> theme);

    platform::Size measure(
        std::string_view text, const kit::Font& font, const kit::TextLimits& limits) const override;
    platform::Size measure(
        const kit::AttributedText& text, const kit::Font& font, const kit::TextLimits& limits) const override;
    kit::FontMetrics metrics(const kit::Font& font) const override;

    /// The theme's fonts or its window have changed.
    void themeDidChange();

private:
    PangoContext* context() const;

    std::shared_ptr<const Theme> _theme;
    mutable ObjectRef<PangoContext> _context;
};

} // namespace host::gtk
