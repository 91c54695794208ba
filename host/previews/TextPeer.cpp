// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/previews/TextPeer.h"

#include "host/previews/SourceLanguages.h"
#include "platform/Weakly.h"

#include <adwaita.h>

#include <algorithm>
#include <cmath>
#include <utility>

namespace host::previews {

using gtk::connectNotify;
using gtk::connectSignal;
using gtk::ObjectRef;
using gtk::PreviewPeer;
using screens::MatchStep;
using screens::PreviewTextView;

namespace {

constexpr int margin = 12; ///< points around the text
/// So many bytes are inserted at once, so that one turn of the main loop takes less than a frame.
constexpr std::size_t pieceBytes = 8 << 10;
constexpr double wheelStep = 1.15;

bool isInsideCharacter(const std::string& text, std::size_t at)
{
    return at < text.size() && (static_cast<unsigned char>(text[at]) & 0xC0) == 0x80;
}

/// The lengths of the common beginning and the common end of two texts, in whole characters.
struct Common {
    std::size_t front = 0, back = 0;
};
Common commonParts(const std::string& a, const std::string& b)
{
    Common common;
    const auto limit = std::min(a.size(), b.size());
    common.front = static_cast<std::size_t>(
        std::mismatch(a.begin(), a.begin() + static_cast<long>(limit), b.begin()).first - a.begin());
    while (common.front > 0 && (isInsideCharacter(a, common.front) || isInsideCharacter(b, common.front)))
        --common.front;
    while (
        common.back < limit - common.front && a[a.size() - 1 - common.back] == b[b.size() - 1 - common.back])
        ++common.back;
    while (common.back > 0 && isInsideCharacter(a, a.size() - common.back))
        --common.back;
    return common;
}

int charactersIn(const std::string& text, std::size_t bytes)
{
    return static_cast<int>(g_utf8_strlen(text.data(), static_cast<gssize>(bytes)));
}

} // namespace

TextPeer::TextPeer(const std::shared_ptr<PreviewTextView>& view)
    : _view(view)
    , _window(ObjectRef<GtkWidget>::retain(gtk_scrolled_window_new()))
    , _buffer(ObjectRef<GtkSourceBuffer>::adopt(gtk_source_buffer_new(nullptr)))
    , _style(ObjectRef<GtkCssProvider>::adopt(gtk_css_provider_new()))
    , _text(gtk_source_view_new_with_buffer(_buffer.get()))
{
    build();
}

TextPeer::~TextPeer()
{
    if (_inserting != 0)
        g_source_remove(_inserting);
}

void TextPeer::build()
{
    gtk_source_buffer_set_highlight_matching_brackets(_buffer.get(), FALSE);
    gtk_text_buffer_set_enable_undo(GTK_TEXT_BUFFER(_buffer.get()), FALSE);
    _marked = gtk_text_buffer_create_tag(
        GTK_TEXT_BUFFER(_buffer.get()), nullptr, "background", "#ff7800", "foreground", "#000000", nullptr);
    auto* text = textView();
    gtk_text_view_set_editable(text, FALSE);
    gtk_text_view_set_cursor_visible(text, FALSE);
    gtk_text_view_set_wrap_mode(text, GTK_WRAP_WORD_CHAR);
    gtk_text_view_set_left_margin(text, margin);
    gtk_text_view_set_right_margin(text, margin);
    gtk_text_view_set_top_margin(text, margin);
    gtk_text_view_set_bottom_margin(text, margin);
    gtk_style_context_add_provider(gtk_widget_get_style_context(_text), GTK_STYLE_PROVIDER(_style.get()),
        GTK_STYLE_PROVIDER_PRIORITY_APPLICATION);
    gtk_scrolled_window_set_policy(GTK_SCROLLED_WINDOW(widget()), GTK_POLICY_NEVER, GTK_POLICY_AUTOMATIC);
    gtk_scrolled_window_set_child(GTK_SCROLLED_WINDOW(widget()), _text);
    // The text takes the keyboard focus, and its scrolled window does not.
    gtk_widget_set_focusable(_window.get(), FALSE);
}

void TextPeer::start()
{
    addShortcuts(widget(), _view);
    addGestures();
    _connections.push_back(
        connectNotify(adw_style_manager_get_default(), "notify::dark", [this] { followTheme(); }));
    _connections.push_back(connectSignal<void()>(widget(), "map", [this] { gtk_widget_grab_focus(_text); }));
    followTheme();
    previewContentDidChange();
    previewZoomDidChange();
    previewQueryDidChange();
}

void TextPeer::addGestures()
{
    auto* pinch = gtk_gesture_zoom_new();
    gtk_event_controller_set_propagation_phase(GTK_EVENT_CONTROLLER(pinch), GTK_PHASE_CAPTURE);
    gtk_widget_add_controller(widget(), GTK_EVENT_CONTROLLER(pinch));
    _connections.push_back(connectSignal<void(GdkEventSequence*)>(pinch, "begin", [this, pinch](auto*) {
        const auto view = _view.lock();
        _pinchStart = view ? view->zoom() : 1;
        gtk_gesture_set_state(pinch, GTK_EVENT_SEQUENCE_CLAIMED);
    }));
    _connections.push_back(connectSignal<void(double)>(pinch, "scale-changed", [this](double scale) {
        if (const auto view = _view.lock())
            view->setZoom(_pinchStart * scale);
    }));
    auto* wheel = gtk_event_controller_scroll_new(GTK_EVENT_CONTROLLER_SCROLL_VERTICAL);
    gtk_event_controller_set_propagation_phase(wheel, GTK_PHASE_CAPTURE);
    gtk_widget_add_controller(widget(), wheel);
    _connections.push_back(connectSignal<gboolean(double, double)>(
        wheel, "scroll", [this, wheel](double, double steps) -> gboolean {
            if ((gtk_event_controller_get_current_event_state(wheel) & GDK_CONTROL_MASK) == 0)
                return FALSE;
            zoomBy(std::pow(wheelStep, -steps));
            return TRUE;
        }));
}

void TextPeer::zoomBy(double factor)
{
    if (const auto view = _view.lock())
        view->setZoom(view->zoom() * factor);
}

void TextPeer::followTheme()
{
    const bool isDark = adw_style_manager_get_dark(adw_style_manager_get_default());
    auto* schemes = gtk_source_style_scheme_manager_get_default();
    gtk_source_buffer_set_style_scheme(_buffer.get(),
        gtk_source_style_scheme_manager_get_scheme(schemes, isDark ? "Adwaita-dark" : "Adwaita"));
}

void TextPeer::previewContentDidChange()
{
    const auto view = _view.lock();
    if (!view)
        return;
    const auto& content = view->text();
    gtk_text_view_set_monospace(textView(), content.isSource ? TRUE : FALSE);
    if (!view->accessibility().label.empty())
        gtk_accessible_update_property(
            GTK_ACCESSIBLE(_text), GTK_ACCESSIBLE_PROPERTY_LABEL, view->accessibility().label.c_str(), -1);
    replaceText(content.text);
    if (content.fileName != _fileName) {
        _fileName = content.fileName;
        _language.reset();
        gtk_source_buffer_set_language(_buffer.get(), nullptr);
        if (content.isSource)
            findLanguage();
    }
}

void TextPeer::findLanguage()
{
    SourceLanguages::guess(
        _fileName, platform::weakly(this, [name = _fileName](TextPeer& self, const auto& language) {
            if (self._fileName != name)
                return;
            self._language = language;
            if (self._inserting == 0)
                self.finishText();
        }));
}

void TextPeer::replaceText(const std::string& text)
{
    auto* buffer = GTK_TEXT_BUFFER(_buffer.get());
    if (_inserting != 0) {
        // The rest of the previous text was not inserted yet, so it is dropped.
        g_source_remove(std::exchange(_inserting, 0));
        _shown.erase(_inserted, _insertEnd - _inserted);
    }
    const auto common = commonParts(_shown, text);
    GtkTextIter from, to;
    gtk_text_buffer_get_iter_at_offset(buffer, &from, charactersIn(_shown, common.front));
    gtk_text_buffer_get_iter_at_offset(buffer, &to, charactersIn(_shown, _shown.size() - common.back));
    gtk_text_buffer_delete(buffer, &from, &to);
    if (_insertPlace)
        gtk_text_buffer_delete_mark(buffer, _insertPlace.get());
    // The mark stays behind text that is inserted at it.
    _insertPlace = ObjectRef<GtkTextMark>::retain(gtk_text_buffer_create_mark(buffer, nullptr, &from, FALSE));
    _shown = text;
    _inserted = common.front;
    _insertEnd = _shown.size() - common.back;
    insertPiece();
}

void TextPeer::insertPiece()
{
    auto* buffer = GTK_TEXT_BUFFER(_buffer.get());
    auto end = std::min(_inserted + pieceBytes, _insertEnd);
    while (isInsideCharacter(_shown, end))
        ++end;
    const bool isStart = _inserted == 0;
    GtkTextIter place;
    gtk_text_buffer_get_iter_at_mark(buffer, &place, _insertPlace.get());
    gtk_text_buffer_insert(buffer, &place, _shown.data() + _inserted, static_cast<int>(end - _inserted));
    _inserted = end;
    if (isStart) {
        gtk_text_buffer_get_start_iter(buffer, &place);
        gtk_text_buffer_place_cursor(buffer, &place);
    }
    if (_inserted >= _insertEnd) {
        _inserting = 0;
        finishText();
        return;
    }
    // The insertion runs when the main loop is idle, after the frames and the layout of the text so far.
    if (_inserting == 0)
        _inserting = g_idle_add(
            [](gpointer data) -> gboolean {
                auto* self = static_cast<TextPeer*>(data);
                self->insertPiece();
                return self->_inserting != 0 ? G_SOURCE_CONTINUE : G_SOURCE_REMOVE;
            },
            this);
}

void TextPeer::finishText()
{
    // The colours are set when the whole text is there, because colouring every piece again would cost more
    // than inserting it.
    if (_language)
        gtk_source_buffer_set_language(_buffer.get(), _language.get());
    publishSearch();
}

void TextPeer::previewZoomDidChange()
{
    const auto view = _view.lock();
    if (!view)
        return;
    char css[64];
    // The zoom enlarges the letters and not the lines, so its square root is enough.
    g_snprintf(css, sizeof css, "textview { font-size: %d%%; }",
        static_cast<int>(std::lround(100 * std::sqrt(view->zoom()))));
    gtk_css_provider_load_from_data(_style.get(), css, -1);
}

void TextPeer::previewQueryDidChange()
{
    const auto view = _view.lock();
    if (!view)
        return;
    unmarkMatch();
    if (view->query().empty()) {
        _search.reset();
        return;
    }
    auto* settings = gtk_source_search_settings_new();
    gtk_source_search_settings_set_search_text(settings, view->query().c_str());
    gtk_source_search_settings_set_case_sensitive(settings, FALSE);
    gtk_source_search_settings_set_wrap_around(settings, TRUE);
    _search =
        ObjectRef<GtkSourceSearchContext>::adopt(gtk_source_search_context_new(_buffer.get(), settings));
    g_object_unref(settings);
    _onCount = connectNotify(_search.get(), "notify::occurrences-count", [this] { publishSearch(); });
    GtkTextIter place;
    GdkRectangle seen;
    gtk_text_view_get_visible_rect(textView(), &seen);
    gtk_text_view_get_iter_at_location(textView(), &place, seen.x, seen.y);
    searchFrom(place, MatchStep::Next);
}

void TextPeer::previewShouldShowMatch(MatchStep step)
{
    if (!_search)
        return;
    GtkTextIter start, end;
    gtk_text_buffer_get_selection_bounds(GTK_TEXT_BUFFER(_buffer.get()), &start, &end);
    searchFrom(step == MatchStep::Next ? end : start, step);
}

void TextPeer::searchFrom(const GtkTextIter& place, MatchStep step)
{
    struct Request {
        std::weak_ptr<PreviewPeer> self;
        MatchStep step;
    };
    const auto answer = [](GObject*, GAsyncResult* result, gpointer data) {
        const std::unique_ptr<Request> request(static_cast<Request*>(data));
        if (const auto self = std::static_pointer_cast<TextPeer>(request->self.lock()))
            self->matched(result, request->step);
    };
    auto request = std::make_unique<Request>(Request{weak_from_this(), step});
    if (step == MatchStep::Next)
        gtk_source_search_context_forward_async(_search.get(), &place, nullptr, answer, request.release());
    else
        gtk_source_search_context_backward_async(_search.get(), &place, nullptr, answer, request.release());
}

void TextPeer::matched(GAsyncResult* result, MatchStep step)
{
    GtkTextIter start, end;
    const auto finish = step == MatchStep::Next ? gtk_source_search_context_forward_finish
                                                : gtk_source_search_context_backward_finish;
    auto* context = GTK_SOURCE_SEARCH_CONTEXT(g_async_result_get_source_object(result));
    const bool found = finish(context, result, &start, &end, nullptr, nullptr) != FALSE;
    if (found && context == _search.get()) {
        gtk_text_buffer_select_range(GTK_TEXT_BUFFER(_buffer.get()), &start, &end);
        markMatch(start, end);
        gtk_text_view_scroll_to_mark(
            textView(), gtk_text_buffer_get_insert(GTK_TEXT_BUFFER(_buffer.get())), 0.1, FALSE, 0, 0);
    }
    g_object_unref(context);
    publishSearch();
}

/// Marks the current match, so that it stands out among the others even while the search field has the focus.
void TextPeer::markMatch(const GtkTextIter& start, const GtkTextIter& end)
{
    unmarkMatch();
    auto* buffer = GTK_TEXT_BUFFER(_buffer.get());
    gtk_text_tag_set_priority(
        _marked, gtk_text_tag_table_get_size(gtk_text_buffer_get_tag_table(buffer)) - 1);
    gtk_text_buffer_apply_tag(buffer, _marked, &start, &end);
}

void TextPeer::unmarkMatch()
{
    GtkTextIter start, end;
    gtk_text_buffer_get_bounds(GTK_TEXT_BUFFER(_buffer.get()), &start, &end);
    gtk_text_buffer_remove_tag(GTK_TEXT_BUFFER(_buffer.get()), _marked, &start, &end);
}

void TextPeer::publishSearch()
{
    const auto view = _view.lock();
    if (!view || !_search)
        return;
    const int count = gtk_source_search_context_get_occurrences_count(_search.get());
    GtkTextIter start, end;
    gtk_text_buffer_get_selection_bounds(GTK_TEXT_BUFFER(_buffer.get()), &start, &end);
    const int position = gtk_source_search_context_get_occurrence_position(_search.get(), &start, &end);
    view->setSearchState({static_cast<std::size_t>(std::max(count, 0)),
        static_cast<std::size_t>(std::max(position, 0)), count >= 0 && _inserting == 0});
}

void TextPeer::previewShouldTakeFocus()
{
    gtk_widget_grab_focus(_text);
}

} // namespace host::previews
