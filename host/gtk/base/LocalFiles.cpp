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

} // namespace host::gtk
