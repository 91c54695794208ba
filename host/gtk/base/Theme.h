// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ObjectRef.h"
#include "host/gtk/base/SignalConnection.h"
#include "kit/values/Font.h"
#include "platform/Color.h"

#include <gtk/gtk.h>

#include <functional>
#include <memory>

namespace host::gtk {

/// Says what a colour is used for. The standard white becomes the theme's background only as a background,
/// and the standard black the theme's text colour only as content.
enum class ColorUse { Background, Content };

/// The desktop's colours and fonts. Main thread only.
class Theme {
public:
    Theme();
    ~Theme();

    /// Registers the program's icons and style sheet with the toolkit. Call it before the application is
    /// registered, which then finds the icons by itself. Further calls are cheap.
    static void registerResources();

    /// Answers the theme's colour for a colour of the model. The standard colours follow light, dark and high
    /// contrast; others stay as they are.
    GdkRGBA resolve(const platform::Color& color, ColorUse use) const;
    bool isDark() const;
    bool animationsEnabled() const;

    /// Answers the theme's typeface in the size for a font. Body text has the desktop's own size. Smaller
    /// roles shrink half as much as they would on a phone's display, so that they stay legible.
    using FontDescription = std::unique_ptr<PangoFontDescription, decltype(&pango_font_description_free)>;
    FontDescription describe(const kit::Font& font) const;
    ObjectRef<PangoContext> makePangoContext() const;

    /// Sets the widget whose style gives the colours, which is the window.
    void setReference(GtkWidget* widget);
    /// The callback runs after the light, dark, contrast, font or animation settings have changed.
    void setOnChange(std::function<void()> callback) { _onChange = std::move(callback); }

private:
    void changed() const;
    void markContrast() const;
    static bool hasHighContrast();
    bool named(const char* name, GdkRGBA& color) const;

    GtkWidget* _reference = nullptr;
    SignalConnections _connections;
    SignalConnection _onReferenceEnd;
    std::function<void()> _onChange;
};

} // namespace host::gtk
