// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/base/FirstList.h"

#include "platform/Log.h"

#include <utility>

namespace host::gtk {

FirstList::~FirstList()
{
    if (_idle != 0)
        g_source_remove(_idle);
}

void FirstList::note(GtkWidget* list)
{
    auto* clock = gtk_widget_get_frame_clock(list);
    if (_isNoted || !clock)
        return;
    _isNoted = true;
    _onPaint = connectSignal<void()>(clock, "after-paint", [this] { painted(); });
    gtk_widget_queue_draw(list);
}

void FirstList::painted()
{
    static constexpr platform::Operation op{"FirstList::painted"};
    op.info("First list on screen");
    const auto call = [](gpointer data) -> gboolean {
        auto* self = static_cast<FirstList*>(data);
        self->_idle = 0;
        self->_onPaint.disconnect();
        if (const auto shown = std::exchange(self->_onShown, {}))
            shown();
        return G_SOURCE_REMOVE;
    };
    if (_idle == 0)
        _idle = g_idle_add_full(G_PRIORITY_LOW, call, this, nullptr);
    _onPaint.block();
}

} // namespace host::gtk
