// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/app/DesktopShortcuts.h"

#include <gtk/gtk.h>

#include <memory>
#include <utility>

namespace host::gtk {

using platform::PropertyDictionary;
using platform::ShortcutItem;
using platform::Url;

namespace {

constexpr const char* documentKey = "recentDocument";

using Text = std::unique_ptr<char, decltype(&g_free)>;

/// Puts a document into the list of recent files that all programs share. The desktop's setting decides
/// whether the list is kept.
void addToRecentFiles(const Url& document)
{
    const auto name = document.lastPathComponent();
    const Text contentType(g_content_type_guess(name.c_str(), nullptr, 0, nullptr), g_free);
    const Text mimeType(g_content_type_get_mime_type(contentType.get()), g_free);
    const Text shownName(g_filename_display_name(name.c_str()), g_free);
    std::string program = "Tarrow Drive", command = "tarrow-drive %u", fallback = "application/octet-stream";
    GtkRecentData data{};
    data.display_name = shownName.get();
    data.mime_type = mimeType ? mimeType.get() : fallback.data();
    data.app_name = program.data();
    data.app_exec = command.data();
    gtk_recent_manager_add_full(gtk_recent_manager_get_default(), document.absoluteString().c_str(), &data);
}

} // namespace

DesktopShortcuts::DesktopShortcuts(std::string path)
    : _file(std::move(path))
{
}

void DesktopShortcuts::keepRecentDocument(const Url& document, const ShortcutItem& shortcut)
{
    _file.set(documentKey, shortcut.userInfo);
    addToRecentFiles(document);
}

std::optional<ShortcutItem> DesktopShortcuts::recentDocument() const
{
    const auto* value = platform::find(_file.values(), documentKey);
    const auto* information = value ? value->get<PropertyDictionary>() : nullptr;
    if (!information)
        return std::nullopt;
    return ShortcutItem{std::string(platform::ShortcutTypeRecentDocument), *information};
}

void DesktopShortcuts::forgetRecentDocument()
{
    _file.set(documentKey, {});
}

} // namespace host::gtk
