// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/preview/PreviewPeer.h"
#include "screens/preview/PreviewMediaView.h"

namespace host::previews {

/// Plays sounds and films in the toolkit's player.
class MediaPeer : public gtk::PreviewPeer {
public:
    explicit MediaPeer(const std::shared_ptr<screens::PreviewMediaView>& view);
    ~MediaPeer() override;

    GtkWidget* widget() const override { return _box.get(); }
    GtkMediaStream* stream() const { return _stream.get(); } ///< null: none yet
    void start() override;

    void previewContentDidChange() override;
    void previewShouldStop() override;
    void previewShouldTakeFocus() override;

private:
    void open();
    void close();
    void showFilm();
    void showSound(const screens::PreviewMediaView::Content& media);
    void checkError();

    std::weak_ptr<screens::PreviewMediaView> _view;
    gtk::ObjectRef<GtkWidget> _box;
    gtk::ObjectRef<GtkMediaStream> _stream;
    GtkWidget* _player = nullptr; ///< in the box
    unsigned _generation = 0; ///< number of the content; an answer for an older one is ignored
    gtk::SignalConnections _connections, _streamConnections;
};

} // namespace host::previews
