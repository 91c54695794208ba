// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/views/View.h"

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace kit {
class Button;
class Label;
} // namespace kit

namespace screens {

class PreviewView;

/// The bar below a previewed document: search, page number, zoom buttons, as far as the document has them.
/// Main thread only.
class PreviewToolbar : public kit::View {
public:
    static constexpr double barHeight = 48; ///< points; also a button's side

    static std::shared_ptr<PreviewToolbar> create();
    using kit::View::View;

    void setOnFind(std::function<void()> callback) { _onFind = std::move(callback); }
    void setOnEdit(std::function<void()> callback) { _onEdit = std::move(callback); }
    /// Sets whether the document can be changed here.
    void setCanEdit(bool canEdit);
    /// Shows this view's state and acts on it from now on; null means none.
    void setPreview(const std::shared_ptr<PreviewView>& preview);
    /// Shows the view's current state.
    void update();
    bool isEmpty() const; ///< no button is shown

    const std::shared_ptr<kit::Button>& findButton() const { return _find; }
    const std::shared_ptr<kit::Button>& editButton() const { return _edit; }
    const std::shared_ptr<kit::Label>& pageLabel() const { return _page; }

    void layoutSubviews() override;

private:
    void build();
    void zoomBy(double factor);
    std::string pageText() const;

    std::weak_ptr<PreviewView> _preview;
    std::shared_ptr<kit::Button> _find, _copy, _edit, _zoomOut, _zoomIn;
    std::shared_ptr<kit::Label> _page;
    std::function<void()> _onFind, _onEdit;
    bool _canEdit = false;
};

} // namespace screens
