// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file lets the mouse drag files from a list to other programs.

#include "host/gtk/base/LocalFiles.h"
#include "host/gtk/views/ListRowWidget.h"
#include "host/gtk/views/ListViewPeer.h"

namespace host::gtk {

/// A finger scrolls, so only a pointer drags; and along the check marks it selects.
GdkContentProvider* ListViewPeer::beginDrag(GtkDragSource* source, double x, double y) const
{
    auto* device = gtk_event_controller_get_current_event_device(GTK_EVENT_CONTROLLER(source));
    const auto list = _list.lock();
    auto* row = rowAt(x, y);
    if (!list || !row || (device && gdk_device_get_source(device) == GDK_SOURCE_TOUCHSCREEN))
        return nullptr;
    double rowX = 0, rowY = 0;
    gtk_widget_translate_coordinates(native(), row, x, y, &rowX, &rowY);
    const bool isMark =
        list->selectionMode() == kit::SelectionMode::Multiple && ListRowWidget::isOnMark(row, rowX);
    const auto files =
        isMark ? std::vector<platform::Url>() : list->filesToDrag(ListRowWidget::position(row));
    return files.empty() ? nullptr : contentOf(files);
}

void ListViewPeer::connectDragging()
{
    auto* source = gtk_drag_source_new();
    gtk_drag_source_set_actions(source, GDK_ACTION_COPY);
    gtk_widget_add_controller(native(), GTK_EVENT_CONTROLLER(source));
    connect(connectSignal<GdkContentProvider*(double, double)>(
        source, "prepare", [this, source](double x, double y) { return beginDrag(source, x, y); }));
}

} // namespace host::gtk
