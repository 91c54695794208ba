// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/views/View.h"

#include <memory>
#include <string>

namespace kit {
class Label;
} // namespace kit

namespace screens {

class PreviewSearchBar;
class PreviewToolbar;

/// The whole preview screen, from top to bottom: the search bar, a note on left-out parts, the content, the
/// toolbar. Main thread only.
class PreviewScreenView : public kit::View {
public:
    static std::shared_ptr<PreviewScreenView> create();
    using kit::View::View;

    const std::shared_ptr<PreviewSearchBar>& searchBar() const { return _searchBar; }
    const std::shared_ptr<PreviewToolbar>& toolbar() const { return _toolbar; }
    /// Sets the bars below the content in place of the toolbar; null means none. A hidden bar takes no room.
    void setEditBars(const std::shared_ptr<kit::View>& bar, const std::shared_ptr<kit::View>& barAbove);
    const std::shared_ptr<kit::View>& content() const { return _content; }
    void setContent(const std::shared_ptr<kit::View>& content); ///< null: none
    const std::string& note() const;
    void setNote(const std::string& note); ///< empty: none
    bool isSearching() const;
    void setSearching(bool searching);

    void layoutSubviews() override;

private:
    void build();

    std::shared_ptr<PreviewSearchBar> _searchBar;
    std::shared_ptr<PreviewToolbar> _toolbar;
    std::shared_ptr<kit::Label> _note;
    std::shared_ptr<kit::View> _content, _editBar, _barAbove;
};

} // namespace screens
