// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/preview/NotePeer.h"

#include "host/gtk/base/SignalConnection.h"
#include "platform/Weakly.h"
#include "screens/preview/NoteView.h"

#include <gtk/gtk.h>

#include <memory>
#include <string>

namespace host::gtk {

using screens::NoteView;

namespace {

constexpr int margin = 10; ///< points around the text

std::string textOf(GtkTextBuffer* buffer)
{
    GtkTextIter start, end;
    gtk_text_buffer_get_bounds(buffer, &start, &end);
    char* text = gtk_text_buffer_get_text(buffer, &start, &end, FALSE);
    std::string copy = text;
    g_free(text);
    return copy;
}

/// Keeps the connections for as long as the widget lives.
void keep(GtkWidget* widget, SignalConnections connections)
{
    g_object_set_data_full(G_OBJECT(widget), "trw-note-connections",
        std::make_unique<SignalConnections>(std::move(connections)).release(),
        [](gpointer kept) { delete static_cast<SignalConnections*>(kept); });
}

GtkWidget* makeText(const std::shared_ptr<NoteView>& note)
{
    auto* text = gtk_text_view_new();
    auto* view = GTK_TEXT_VIEW(text);
    gtk_text_view_set_wrap_mode(view, GTK_WRAP_WORD_CHAR);
    gtk_text_view_set_left_margin(view, margin);
    gtk_text_view_set_right_margin(view, margin);
    gtk_text_view_set_top_margin(view, margin);
    gtk_text_view_set_bottom_margin(view, margin);
    // The Tab key moves the focus to the buttons instead of writing a tab.
    gtk_text_view_set_accepts_tab(view, FALSE);
    auto* buffer = gtk_text_view_get_buffer(view);
    gtk_text_buffer_set_text(buffer, note->text().c_str(), static_cast<int>(note->text().size()));
    gtk_accessible_update_property(
        GTK_ACCESSIBLE(text), GTK_ACCESSIBLE_PROPERTY_LABEL, note->accessibility().label.c_str(), -1);
    SignalConnections connections;
    connections.push_back(connectSignal<void()>(buffer, "changed",
        platform::weakly(note, [buffer](NoteView& edited) { edited.userEdited(textOf(buffer)); })));
    keep(text, std::move(connections));
    return text;
}

} // namespace

void addNoteMaker(PeerContext& context)
{
    context.setHostedViewMaker(
        NoteView::kindName, [](kit::HostedView& hosted, GtkWidget* current) -> ObjectRef<GtkWidget> {
            if (current)
                return ObjectRef<GtkWidget>::retain(current);
            // The cast is safe, because the kind of a hosted view decides its class.
            const auto note = std::static_pointer_cast<NoteView>(hosted.shared_from_this());
            auto* window = gtk_scrolled_window_new();
            gtk_widget_add_css_class(window, "note");
            // The text takes the focus, and its frame does not.
            gtk_widget_set_focusable(window, FALSE);
            gtk_scrolled_window_set_policy(
                GTK_SCROLLED_WINDOW(window), GTK_POLICY_NEVER, GTK_POLICY_AUTOMATIC);
            gtk_scrolled_window_set_child(GTK_SCROLLED_WINDOW(window), makeText(note));
            return ObjectRef<GtkWidget>::retain(window);
        });
}

} // namespace host::gtk
