// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/Theme.h"
#include "host/system/drawing/CairoCanvas.h"

namespace host::gtk {

/// The canvas into which a view draws while its widget is painted: its colours, texts and icons are those of
/// the window's theme. Main thread only.
class ThemedCanvas : public system::CairoCanvas {
public:
    ThemedCanvas(cairo_t* cairo, const Theme& theme);

    void drawImage(const platform::Image& image, const platform::Rect& rect) override;
    void drawText(std::string_view text, const kit::Font& font, platform::Point origin) override;

private:
    void use(const platform::Color& color) override;

    const Theme& _theme;
};

} // namespace host::gtk
