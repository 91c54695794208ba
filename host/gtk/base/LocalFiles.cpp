// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/base/LocalFiles.h"

#include "host/gtk/base/ObjectRef.h"

#include <memory>

namespace host::gtk {

void LocalFiles::add(GFile* file)
{
    const std::unique_ptr<char, decltype(&g_free)> path(g_file_get_path(file), g_free);
    if (path)
        files.push_back(platform::Url::fileURL(path.get()));
    else
        areAll = false;
}

LocalFiles LocalFiles::of(GListModel* files)
{
    LocalFiles found;
    for (guint i = 0; i < g_list_model_get_n_items(files); ++i)
        found.add(ObjectRef<GFile>::adopt(G_FILE(g_list_model_get_item(files, i))).get());
    return found;
}

LocalFiles LocalFiles::of(const GSList* files)
{
    LocalFiles found;
    for (; files; files = files->next)
        found.add(G_FILE(files->data));
    return found;
}

GdkContentProvider* contentOf(const std::vector<platform::Url>& files)
{
    std::string copied = "copy";
    GSList* list = nullptr;
    for (const auto& url : files) {
        auto* file = g_file_new_for_path(url.path().c_str());
        const std::unique_ptr<char, decltype(&g_free)> uri(g_file_get_uri(file), g_free);
        copied.append("\n").append(uri.get());
        list = g_slist_prepend(list, file);
    }
    list = g_slist_reverse(list);
    GValue value = G_VALUE_INIT;
    g_value_init(&value, GDK_TYPE_FILE_LIST);
    g_value_take_boxed(&value, list);
    auto* bytes = g_bytes_new(copied.data(), copied.size());
    GdkContentProvider* forms[] = {gdk_content_provider_new_for_value(&value),
        gdk_content_provider_new_for_bytes("x-special/gnome-copied-files", bytes)};
    g_bytes_unref(bytes);
    g_value_unset(&value);
    return gdk_content_provider_new_union(forms, 2);
}

} // namespace host::gtk
