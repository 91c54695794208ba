// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/views/TextFieldDelegate.h"
#include "kit/views/View.h"

#include <functional>
#include <memory>
#include <string>

namespace kit {
class Button;
class Label;
class TextField;
} // namespace kit

namespace screens {

class PreviewView;
enum class MatchStep;

/// The bar above a previewed document in which the user searches its text: the field, the number of matches,
/// and buttons for the match before and the match after. Main thread only.
class PreviewSearchBar : public kit::View, private kit::TextFieldDelegate {
public:
    static constexpr double barHeight = 48; ///< points

    static std::shared_ptr<PreviewSearchBar> create();
    using kit::View::View;

    void setOnClose(std::function<void()> callback) { _onClose = std::move(callback); }
    /// Searches this view from now on; null means none.
    void setPreview(const std::shared_ptr<PreviewView>& preview);
    /// Shows the current state of the search.
    void update();

    const std::shared_ptr<kit::TextField>& field() const { return _field; }
    const std::shared_ptr<kit::Label>& countLabel() const { return _count; }
    const std::shared_ptr<kit::Button>& nextButton() const { return _next; }

    void layoutSubviews() override;

private:
    void build();
    void edited();
    void showMatch(MatchStep direction);
    std::string countText() const;
    bool textFieldShouldReturn(kit::TextField& field) override;

    std::weak_ptr<PreviewView> _preview;
    std::shared_ptr<kit::TextField> _field;
    std::shared_ptr<kit::Label> _count;
    std::shared_ptr<kit::Button> _previous, _next, _close;
    std::function<void()> _onClose;
    unsigned _edits = 0;
};

} // namespace screens
