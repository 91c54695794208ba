// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "screens/preview/PreviewView.h"

#include <string>

namespace screens {

/// Plays a sound or a film in the platform's player, with controls. It plays when the user starts it and
/// stops when it is no longer visible.
class PreviewMediaView : public PreviewView {
public:
    static constexpr const char* kindName = "preview.media";

    PreviewMediaView()
        : PreviewView(kindName)
    {
    }

    struct Content {
        std::string path;
        std::string title;
        std::string iconName; ///< the icon that is shown for a sound
        bool isFilm = false;
    };
    const Content& media() const { return _content; }
    void setMedia(Content content);

private:
    Content _content;
};

} // namespace screens
