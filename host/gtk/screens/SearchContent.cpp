// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/screens/SearchContent.h"

#include "platform/Localization.h"
#include "platform/Weakly.h"

namespace host::gtk {

class SearchContent::Observer : public kit::SearchObserver {
public:
    explicit Observer(SearchContent& content)
        : _content(content)
    {
    }
    void searchQueryWasSet(kit::SearchPresentation& search) override
    {
        const SignalBlock block(_content._onEdited);
        gtk_editable_set_text(GTK_EDITABLE(_content._entry), search.query().c_str());
        gtk_editable_set_position(GTK_EDITABLE(_content._entry), -1);
    }
    void searchWantsFocus(kit::SearchPresentation&, bool focus) override
    {
        if (focus)
            gtk_widget_grab_focus(_content._entry);
    }

private:
    SearchContent& _content;
};

SearchContent::SearchContent(
    const std::shared_ptr<PeerContext>& context, const std::shared_ptr<kit::SearchPresentation>& search)
    : _search(search)
    , _box(ObjectRef<GtkWidget>::retain(gtk_box_new(GTK_ORIENTATION_VERTICAL, 0)))
    , _entry(gtk_search_entry_new())
    , _cancel(gtk_button_new_with_label(platform::localized("Cancel").c_str()))
    , _observer(std::make_shared<Observer>(*this))
{
    buildBar(*search);
    _results = makeScreenPeer(context, search, WindowButtons::Hidden);
    gtk_box_append(GTK_BOX(widget()), _results->widget());
    search->setSearchObserver(_observer);
    _observer->searchQueryWasSet(*search);
}

SearchContent::~SearchContent()
{
    _onEdited.disconnect();
    _connections.clear();
    gtk_box_remove(GTK_BOX(widget()), _results->widget());
}

void SearchContent::buildBar(const kit::SearchPresentation& search)
{
    auto* bar = gtk_box_new(GTK_ORIENTATION_HORIZONTAL, 0);
    gtk_widget_add_css_class(bar, "kit-search-bar");
    const auto& name = search.placeholder().empty() ? platform::localized("Search") : search.placeholder();
    g_object_set(_entry, "placeholder-text", name.c_str(), "search-delay", 0U, "hexpand", TRUE, nullptr);
    gtk_accessible_update_property(GTK_ACCESSIBLE(_entry), GTK_ACCESSIBLE_PROPERTY_LABEL, name.c_str(), -1);
    gtk_widget_add_css_class(_cancel, "flat");
    gtk_box_append(GTK_BOX(bar), _entry);
    gtk_box_append(GTK_BOX(bar), _cancel);
    gtk_box_append(GTK_BOX(widget()), bar);
    const auto cancel = platform::weakly(_search, &kit::SearchPresentation::userCancelled);
    _onEdited = connectSignal<void()>(_entry, "changed", [this] {
        if (const auto edited = _search.lock())
            edited->userEditedQuery(gtk_editable_get_text(GTK_EDITABLE(_entry)));
    });
    _connections.push_back(connectSignal<void()>(
        _entry, "activate", platform::weakly(_search, &kit::SearchPresentation::userPressedReturn)));
    connectKeys();
    _connections.push_back(connectSignal<void()>(_entry, "stop-search", cancel));
    _connections.push_back(connectSignal<void()>(_cancel, "clicked", cancel));
}

/// Handles the keys that lead to the results, which may arrive after the key.
void SearchContent::connectKeys()
{
    auto* keys = gtk_event_controller_key_new();
    gtk_event_controller_set_propagation_phase(keys, GTK_PHASE_CAPTURE);
    gtk_widget_add_controller(_entry, keys);
    _connections.push_back(connectSignal<gboolean(guint, guint, GdkModifierType)>(keys, "key-pressed",
        platform::weaklyOr(FALSE, _search, [](kit::SearchPresentation& search, guint key, auto...) {
            const bool isDown = key == GDK_KEY_Down || key == GDK_KEY_KP_Down;
            if (isDown)
                search.userWentDown();
            return isDown;
        })));
}

void SearchContent::focus()
{
    const auto search = _search.lock();
    if (search && search->hasFocus())
        gtk_widget_grab_focus(_entry);
}

} // namespace host::gtk
