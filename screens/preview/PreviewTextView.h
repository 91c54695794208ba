// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "screens/preview/PreviewView.h"

#include <string>

namespace screens {

/// A text to read, select and search. Zooming makes the letters larger.
class PreviewTextView : public PreviewView {
public:
    static constexpr const char* kindName = "preview.text";

    PreviewTextView()
        : PreviewView(kindName)
    {
    }

    struct Content {
        std::string text; ///< UTF-8 without NUL characters
        std::string fileName; ///< decides the language of source code
        bool isSource = false; ///< shown with the colours of its language, in letters of one width
    };
    const Content& text() const { return _content; }
    void setText(Content content);

    bool canZoom() const override { return true; }
    bool canSearch() const override { return true; }

private:
    Content _content;
};

} // namespace screens
