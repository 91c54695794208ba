// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/previews/MediaPeer.h"

#include "host/previews/MediaSupport.h"
#include "platform/Localization.h"
#include "platform/Weakly.h"

#include <utility>

namespace host::previews {

using gtk::connectNotify;
using gtk::ObjectRef;
using screens::PreviewMediaView;

namespace {

constexpr int iconSide = 128, spacing = 18; ///< points

void name(GtkWidget* control, const std::string& text)
{
    gtk_accessible_update_property(GTK_ACCESSIBLE(control), GTK_ACCESSIBLE_PROPERTY_LABEL, text.c_str(), -1);
}

/// Names the player's controls, because the toolkit gives them icons but no accessible names.
void nameControls(GtkWidget* player, const std::string& button)
{
    for (auto* child = gtk_widget_get_first_child(player); child;
         child = gtk_widget_get_next_sibling(child)) {
        const bool isVolume = GTK_IS_VOLUME_BUTTON(child);
        if (GTK_IS_BUTTON(child))
            name(child, button);
        else if (GTK_IS_SCALE(child))
            name(child, platform::localized("Position"));
        nameControls(child, isVolume ? platform::localized("Volume") : button);
    }
}

} // namespace

MediaPeer::MediaPeer(const std::shared_ptr<PreviewMediaView>& view)
    : _view(view)
    , _box(ObjectRef<GtkWidget>::retain(gtk_box_new(GTK_ORIENTATION_VERTICAL, spacing)))
{
}

MediaPeer::~MediaPeer()
{
    close();
}

void MediaPeer::start()
{
    previewContentDidChange();
}

void MediaPeer::previewContentDidChange()
{
    close();
    MediaSupport::check(
        platform::weakly(this, [generation = ++_generation](MediaPeer& self, const std::string& missing) {
            const auto view = self._generation == generation ? self._view.lock() : nullptr;
            if (!view)
                return;
            if (missing.empty())
                self.open();
            else
                view->peerFailed(missing);
        }));
}

void MediaPeer::open()
{
    const auto view = _view.lock();
    if (!view)
        return;
    const auto& media = view->media();
    _stream = ObjectRef<GtkMediaStream>::adopt(gtk_media_file_new_for_filename(media.path.c_str()));
    _streamConnections.push_back(connectNotify(_stream.get(), "notify::error", [this] { checkError(); }));
    if (media.isFilm)
        showFilm();
    else
        showSound(media);
}

void MediaPeer::showFilm()
{
    _player = gtk_video_new_for_media_stream(_stream.get());
    gtk_widget_set_vexpand(_player, TRUE);
    gtk_widget_set_hexpand(_player, TRUE);
    gtk_box_append(GTK_BOX(widget()), _player);
    nameControls(_player, platform::localized("Play or Pause"));
}

void MediaPeer::showSound(const PreviewMediaView::Content& media)
{
    _player = gtk_box_new(GTK_ORIENTATION_VERTICAL, spacing);
    gtk_widget_set_valign(_player, GTK_ALIGN_CENTER);
    gtk_widget_set_vexpand(_player, TRUE);
    gtk_widget_set_halign(_player, GTK_ALIGN_CENTER);
    auto* icon = gtk_image_new_from_icon_name(media.iconName.c_str());
    gtk_image_set_pixel_size(GTK_IMAGE(icon), iconSide);
    auto* title = gtk_label_new(media.title.c_str());
    gtk_widget_add_css_class(title, "title-2");
    gtk_label_set_wrap(GTK_LABEL(title), TRUE);
    gtk_label_set_wrap_mode(GTK_LABEL(title), PANGO_WRAP_WORD_CHAR);
    gtk_label_set_justify(GTK_LABEL(title), GTK_JUSTIFY_CENTER);
    auto* controls = gtk_media_controls_new(_stream.get());
    gtk_widget_set_size_request(controls, 300, -1);
    for (auto* part : {icon, title, controls})
        gtk_box_append(GTK_BOX(_player), part);
    nameControls(_player, platform::localized("Play or Pause"));
    gtk_box_append(GTK_BOX(widget()), _player);
}

void MediaPeer::checkError()
{
    const auto* error = gtk_media_stream_get_error(_stream.get());
    const auto view = _view.lock();
    if (error && view)
        view->peerFailed(MediaSupport::wordsFor(g_quark_to_string(error->domain), error->code));
}

void MediaPeer::close()
{
    _streamConnections.clear();
    previewShouldStop();
    if (_player)
        gtk_box_remove(GTK_BOX(widget()), std::exchange(_player, nullptr));
    if (_stream)
        gtk_media_file_clear(GTK_MEDIA_FILE(_stream.get()));
    _stream.reset();
}

void MediaPeer::previewShouldStop()
{
    if (_stream)
        gtk_media_stream_pause(_stream.get());
}

void MediaPeer::previewShouldTakeFocus()
{
    gtk_widget_child_focus(widget(), GTK_DIR_TAB_FORWARD);
}

} // namespace host::previews
