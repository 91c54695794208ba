// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/base/Theme.h"

#include "kit/values/StandardColors.h"

#include <adwaita.h>

#include <algorithm>
#include <memory>
#include <mutex>
#include <string>

extern "C" void trw_resources_register_resource();

namespace host::gtk {

using platform::Color;
namespace StandardColors = kit::StandardColors;

namespace {

constexpr double bodyPointSize = 17; ///< points of the kit's body text
constexpr double defaultDpi = 96;
/// Shares of the text colour. Grey text needs a contrast of 4.5 to 1 to its background, or 7 to 1 with high
/// contrast.
constexpr float greyShare = 0.7F, strongGreyShare = 0.9F, lightGreyShare = 0.4F;
/// The size of a row's second line in the style sheet, as a share of the body size. Each further size would
/// be one more font to find, which takes milliseconds of the start, and smaller ones are hard to read.
constexpr double smallestShare = 0.85;
constexpr auto iconsPath = "/app/tarrow/Drive/icons";

GdkRGBA plain(const Color& color)
{
    return {color.red, color.green, color.blue, color.alpha};
}

const char* themeName(const Color& color, ColorUse use)
{
    if (color == StandardColors::red)
        return "error_color";
    if (color == StandardColors::tint)
        return "accent_color";
    if (color == StandardColors::hairline)
        return "borders";
    if (color == Color::white() && use == ColorUse::Background)
        return "view_bg_color";
    if (color == Color::black() && use == ColorUse::Content)
        return "view_fg_color";
    return nullptr;
}

/// Turns a size in the kit's points into a share of the desktop's body size.
double relativeSize(double pointSize)
{
    const double ratio = pointSize / bodyPointSize;
    return ratio >= 1 ? ratio : std::max((1 + ratio) / 2, smallestShare);
}

/// The application has already added its icons by the path of its identifier. Adding them again would drop
/// the icon theme that the toolkit has meanwhile read on another thread, and read it again on this one.
void addIcons(GtkIconTheme* icons)
{
    const std::unique_ptr<char*, decltype(&g_strfreev)> paths(
        gtk_icon_theme_get_resource_path(icons), g_strfreev);
    const std::string ours(iconsPath);
    for (char** path = paths.get(); path && *path; ++path) {
        if (*path == ours || *path == ours + '/')
            return;
    }
    gtk_icon_theme_add_resource_path(icons, iconsPath);
}

/// Adds this program's icons and style sheet, once for the process's display.
void installResources()
{
    static bool isInstalled = false;
    auto* display = gdk_display_get_default();
    if (isInstalled || !display)
        return;
    isInstalled = true;
    addIcons(gtk_icon_theme_get_for_display(display));
    const auto provider = ObjectRef<GtkCssProvider>::adopt(gtk_css_provider_new());
    gtk_css_provider_load_from_resource(provider.get(), "/app/tarrow/Drive/kit.css");
    gtk_style_context_add_provider_for_display(
        display, GTK_STYLE_PROVIDER(provider.get()), GTK_STYLE_PROVIDER_PRIORITY_APPLICATION);
}

double settingsDpi()
{
    int dpi = -1;
    if (auto* settings = gtk_settings_get_default())
        g_object_get(settings, "gtk-xft-dpi", &dpi, nullptr);
    return dpi > 0 ? dpi / 1024.0 : defaultDpi;
}

} // namespace

void Theme::registerResources()
{
    static std::once_flag once;
    std::call_once(once, trw_resources_register_resource);
}

Theme::Theme()
{
    registerResources();
    installResources();
    auto* style = adw_style_manager_get_default();
    for (const char* signal : {"notify::dark", "notify::high-contrast"})
        _connections.push_back(connectNotify(style, signal, [this] { changed(); }));
    auto* settings = gtk_settings_get_default();
    for (const char* signal : {"notify::gtk-font-name", "notify::gtk-xft-dpi"})
        _connections.push_back(connectNotify(settings, signal, [this] { changed(); }));
}

Theme::~Theme() = default;

void Theme::changed() const
{
    markContrast();
    if (_onChange)
        _onChange();
}

/// Marks the window with a class for high contrast, because the style sheet cannot ask for it.
void Theme::markContrast() const
{
    if (!_reference)
        return;
    if (hasHighContrast())
        gtk_widget_add_css_class(_reference, "high-contrast");
    else
        gtk_widget_remove_css_class(_reference, "high-contrast");
}

void Theme::setReference(GtkWidget* widget)
{
    _reference = widget;
    markContrast();
    _onReferenceEnd = connectSignal<void()>(widget, "destroy", [this] { _reference = nullptr; });
}

bool Theme::named(const char* name, GdkRGBA& color) const
{
    return _reference
        && gtk_style_context_lookup_color(gtk_widget_get_style_context(_reference), name, &color);
}

GdkRGBA Theme::resolve(const Color& color, ColorUse use) const
{
    GdkRGBA found = plain(color);
    if (const char* name = themeName(color, use)) {
        named(name, found);
        return found;
    }
    // Grey text is the text colour with some transparency, so that it can be read on either background.
    if (color == StandardColors::gray || color == StandardColors::lightGray) {
        if (named("view_fg_color", found))
            found.alpha *= color == StandardColors::lightGray ? lightGreyShare
                : hasHighContrast()                           ? strongGreyShare
                                                              : greyShare;
    }
    return found;
}

bool Theme::hasHighContrast()
{
    return adw_style_manager_get_high_contrast(adw_style_manager_get_default());
}

bool Theme::isDark() const
{
    return adw_style_manager_get_dark(adw_style_manager_get_default());
}

bool Theme::animationsEnabled() const
{
    gboolean enabled = TRUE;
    g_object_get(gtk_settings_get_default(), "gtk-enable-animations", &enabled, nullptr);
    return enabled;
}

Theme::FontDescription Theme::describe(const kit::Font& font) const
{
    char* name = nullptr;
    g_object_get(gtk_settings_get_default(), "gtk-font-name", &name, nullptr);
    FontDescription description(
        pango_font_description_from_string(name ? name : "Sans 11"), &pango_font_description_free);
    g_free(name);
    const bool follows = font.sizing == kit::TextSizing::FollowsSetting;
    const double dpi = follows ? settingsDpi() : defaultDpi;
    double size = pango_font_description_get_size(description.get());
    if (!pango_font_description_get_size_is_absolute(description.get()))
        size *= dpi / 72;
    pango_font_description_set_absolute_size(description.get(), size * relativeSize(font.pointSize));
    if (font.weight == kit::FontWeight::Bold)
        pango_font_description_set_weight(description.get(), PANGO_WEIGHT_BOLD);
    return description;
}

ObjectRef<PangoContext> Theme::makePangoContext() const
{
    if (_reference)
        return ObjectRef<PangoContext>::adopt(gtk_widget_create_pango_context(_reference));
    return ObjectRef<PangoContext>::adopt(pango_font_map_create_context(pango_cairo_font_map_get_default()));
}

} // namespace host::gtk
