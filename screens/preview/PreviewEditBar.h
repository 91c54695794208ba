// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/views/View.h"

#include <functional>
#include <map>
#include <memory>

namespace kit {
class Button;
} // namespace kit

namespace screens {

/// The tools with which the user changes a document.
enum class EditTool { Undo, Highlight, Underline, Note, PreviousField, NextField, Done };

/// The bar below a document that is being changed. Main thread only.
class PreviewEditBar : public kit::View {
public:
    static constexpr double barHeight = 48; ///< points; also the side of a button with a picture

    static std::shared_ptr<PreviewEditBar> create();
    using kit::View::View;

    void setOnTool(std::function<void(EditTool)> callback) { _onTool = std::move(callback); }
    /// Says which tools work now. Tools that do not apply to the document are not shown.
    struct State {
        bool canUndo = false, canMark = false, hasMarkable = false, hasFields = false;
    };
    void setState(const State& state);
    std::shared_ptr<kit::Button> button(EditTool tool) const { return _buttons.at(tool); }

    void layoutSubviews() override;

private:
    void build();

    std::map<EditTool, std::shared_ptr<kit::Button>> _buttons;
    std::function<void(EditTool)> _onTool;
};

} // namespace screens
