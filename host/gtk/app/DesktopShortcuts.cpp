// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/app/DesktopShortcuts.h"

#include "platform/Dispatch.h"
#include "platform/Log.h"

#include <gtk/gtk.h>

#include <memory>
#include <utility>

namespace host::gtk {

using platform::PropertyDictionary;
using platform::ShortcutItem;
using platform::Url;

namespace {

constexpr const char* documentKey = "recentDocument";

using Bookmarks = std::unique_ptr<GBookmarkFile, decltype(&g_bookmark_file_free)>;
using Text = std::unique_ptr<char, decltype(&g_free)>;

/// Answers whether the user wants the desktop to know of recent files.
bool keepsRecentFiles()
{
    auto* settings = gtk_settings_get_default();
    gboolean isEnabled = TRUE;
    int days = -1; // for ever
    if (settings)
        g_object_get(
            settings, "gtk-recent-files-enabled", &isEnabled, "gtk-recent-files-max-age", &days, nullptr);
    return isEnabled && days != 0;
}

/// Puts a document into a list of recent files. The toolkit's own manager would read and write the list on
/// the main thread.
void addToRecentFiles(const std::string& list, const Url& document)
{
    static constexpr platform::Operation op{"-[DesktopShortcuts addToRecentFiles:]"};
    const auto name = document.lastPathComponent(), uri = document.absoluteString();
    const Text contentType(g_content_type_guess(name.c_str(), nullptr, 0, nullptr), g_free);
    const Text mimeType(g_content_type_get_mime_type(contentType.get()), g_free);
    const Bookmarks bookmarks(g_bookmark_file_new(), g_bookmark_file_free);
    GError* error = nullptr;
    g_bookmark_file_load_from_file(bookmarks.get(), list.c_str(), &error);
    // A list that cannot be read is another program's, so only a missing one is made.
    const bool isUsable = !error || g_error_matches(error, G_FILE_ERROR, G_FILE_ERROR_NOENT);
    g_clear_error(&error);
    if (isUsable) {
        g_bookmark_file_set_mime_type(
            bookmarks.get(), uri.c_str(), mimeType ? mimeType.get() : "application/octet-stream");
        g_bookmark_file_add_application(bookmarks.get(), uri.c_str(), "Tarrow Drive", "tarrow-drive %u");
        g_bookmark_file_to_file(bookmarks.get(), list.c_str(), &error);
    }
    if (!isUsable || error)
        op.warning("The list of recent files %@ cannot be changed: %@", list,
            error ? std::string(error->message) : std::string("it is damaged"));
    g_clear_error(&error);
}

ShortcutItem shortcutWith(const PropertyDictionary& information)
{
    return {std::string(platform::ShortcutTypeRecentDocument), information};
}

} // namespace

DesktopShortcuts::DesktopShortcuts(Settings settings)
    : _settings(std::move(settings))
    , _file(std::make_shared<StateFile>(_settings.stateFile))
{
    const auto* value = platform::find(_file->values(), documentKey);
    if (const auto* information = value ? value->get<PropertyDictionary>() : nullptr)
        _recent = shortcutWith(*information);
}

std::string DesktopShortcuts::sharedRecentFiles()
{
    return std::string(g_get_user_data_dir()) + "/recently-used.xbel";
}

void DesktopShortcuts::keep(std::optional<ShortcutItem> shortcut)
{
    _recent = std::move(shortcut);
    _settings.queue->async([file = _file, recent = _recent] {
        file->set(
            documentKey, recent ? platform::PropertyValue(recent->userInfo) : platform::PropertyValue());
    });
}

void DesktopShortcuts::keepRecentDocument(const Url& document, const ShortcutItem& shortcut)
{
    keep(shortcut);
    if (keepsRecentFiles())
        _settings.queue->async(
            [list = _settings.recentFiles, document] { addToRecentFiles(list, document); });
}

std::optional<ShortcutItem> DesktopShortcuts::recentDocument() const
{
    return _recent;
}

void DesktopShortcuts::forgetRecentDocument()
{
    keep(std::nullopt);
}

} // namespace host::gtk
