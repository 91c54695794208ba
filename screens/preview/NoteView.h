// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/ViewController.h"
#include "kit/views/HostedView.h"

#include <memory>
#include <string>
#include <utility>

namespace screens {

/// A text of several lines that the user writes. Main thread only.
class NoteView : public kit::HostedView {
public:
    static constexpr const char* kindName = "note";
    static constexpr double height = 132; ///< points

    explicit NoteView(std::string text)
        : HostedView(kindName)
        , _text(std::move(text))
    {
    }

    const std::string& text() const { return _text; }
    /// Event up: the peer now shows this text.
    void userEdited(std::string text) { _text = std::move(text); }

private:
    std::string _text;
};

/// Shows a note as the content of an alert.
class NoteScreen : public kit::ViewController {
public:
    /// `name` is the name by which a screen reader announces the text.
    NoteScreen(const std::string& name, std::string text)
        : _note(std::make_shared<NoteView>(std::move(text)))
    {
        _note->setAccessibilityLabel(name);
    }

    const std::shared_ptr<NoteView>& note() const { return _note; }
    void loadView() override
    {
        setView(_note);
        _note->anchor(kit::LayoutAttribute::Height).equalToConstant(NoteView::height)->setActive(true);
    }

private:
    std::shared_ptr<NoteView> _note;
};

} // namespace screens
