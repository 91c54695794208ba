// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ObjectRef.h"
#include "host/gtk/base/Signal.h"
#include "kit/values/Font.h"
#include "platform/Color.h"

#include <gtk/gtk.h>

#include <functional>
#include <memory>

namespace host::gtk {

/// What a colour is used for: the standard white is the theme's background only behind something, the
/// standard black the theme's text colour only in front.
enum class ColorUse { Background, Content };

/// The desktop's colours and fonts. Main thread only.
class Theme {
public:
    Theme();
    ~Theme();

    /// Makes the program's icons and style sheet known to the toolkit: before the application is registered,
    /// which then finds the icons by itself. Cheap to call again.
    static void registerResources();

    /// A colour of the model as the theme has it: the standard colours follow light, dark and high contrast,
    /// others stay what they are.
    GdkRGBA resolve(const platform::Color& color, ColorUse use) const;
    bool isDark() const;
    bool animationsEnabled() const;

    /// The theme's typeface in the size that stands for the font's. The body text has the desktop's own size;
    /// smaller roles shrink half as much as they would on a phone's display, which keeps them legible.
    using FontDescription = std::unique_ptr<PangoFontDescription, decltype(&pango_font_description_free)>;
    FontDescription describe(const kit::Font& font) const;
    ObjectRef<PangoContext> makePangoContext() const;

    /// The widget whose style answers for the colours: the window.
    void setReference(GtkWidget* widget);
    /// Called after light, dark, contrast, font or animation settings have changed.
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
