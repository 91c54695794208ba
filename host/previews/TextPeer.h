// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/preview/PreviewPeer.h"
#include "screens/preview/PreviewTextView.h"

#include <gtksourceview/gtksource.h>

#include <string>

namespace host::previews {

/// Shows a text to be read and selected, and source code in the colours of its language. A long text is
/// inserted piece by piece. When a text changes, only the different part is replaced.
class TextPeer : public gtk::PreviewPeer {
public:
    explicit TextPeer(const std::shared_ptr<screens::PreviewTextView>& view);
    ~TextPeer() override;

    GtkWidget* widget() const override { return _window.get(); }
    GtkTextView* textView() const { return GTK_TEXT_VIEW(_text); }
    void start() override;

    void previewContentDidChange() override;
    void previewZoomDidChange() override;
    void previewQueryDidChange() override;
    void previewShouldShowMatch(screens::MatchStep step) override;
    void previewShouldTakeFocus() override;

private:
    void build();
    void addGestures();
    void zoomBy(double factor);
    void replaceText(const std::string& text);
    void insertPiece();
    void finishText();
    void followTheme();
    void findLanguage();
    void searchFrom(const GtkTextIter& place, screens::MatchStep step);
    void matched(GAsyncResult* result, screens::MatchStep step);
    void publishSearch();
    void markMatch(const GtkTextIter& start, const GtkTextIter& end);
    void unmarkMatch();

    std::weak_ptr<screens::PreviewTextView> _view;
    gtk::ObjectRef<GtkWidget> _window;
    gtk::ObjectRef<GtkSourceBuffer> _buffer;
    gtk::ObjectRef<GtkSourceSearchContext> _search;
    gtk::ObjectRef<GtkSourceLanguage> _language;
    gtk::ObjectRef<GtkCssProvider> _style;
    GtkWidget* _text;
    GtkTextTag* _marked = nullptr; ///< belongs to the buffer; marks the current match
    std::string _shown; ///< the text that the buffer has or will have
    std::size_t _inserted = 0,
                _insertEnd = 0; ///< range of bytes of `_shown` that the buffer does not have yet
    gtk::ObjectRef<GtkTextMark> _insertPlace;
    guint _inserting = 0;
    std::string _fileName;
    double _pinchStart = 1;
    gtk::SignalConnection _onCount;
    gtk::SignalConnections _connections;
};

} // namespace host::previews
