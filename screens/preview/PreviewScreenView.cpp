// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/preview/PreviewScreenView.h"

#include "kit/values/StandardColors.h"
#include "kit/views/Label.h"
#include "screens/preview/PreviewFieldBar.h"
#include "screens/preview/PreviewSearchBar.h"
#include "screens/preview/PreviewToolbar.h"

#include <algorithm>

namespace screens {

namespace {

constexpr double noteHeight = 32;

} // namespace

std::shared_ptr<PreviewScreenView> PreviewScreenView::create()
{
    const auto view = std::make_shared<PreviewScreenView>();
    view->build();
    return view;
}

void PreviewScreenView::build()
{
    _searchBar = PreviewSearchBar::create();
    _searchBar->setHidden(true);
    _toolbar = PreviewToolbar::create();
    _toolbar->setHidden(true);
    _note = std::make_shared<kit::Label>();
    _note->setFont(kit::Font::preferred(kit::TextStyle::Footnote));
    _note->setAlignment(kit::TextAlignment::Center);
    _note->setTextColor(kit::StandardColors::gray);
    _note->setHidden(true);
    addSubview(_searchBar);
    addSubview(_note);
    addSubview(_toolbar);
}

const std::string& PreviewScreenView::note() const
{
    return _note->text();
}

void PreviewScreenView::setNote(const std::string& note)
{
    _note->setText(note);
    _note->setHidden(note.empty());
    setNeedsLayout();
}

bool PreviewScreenView::isSearching() const
{
    return !_searchBar->isHidden();
}

void PreviewScreenView::setSearching(bool searching)
{
    _searchBar->setHidden(!searching);
    setNeedsLayout();
}

void PreviewScreenView::setContent(const std::shared_ptr<kit::View>& content)
{
    if (content == _content)
        return;
    if (_content)
        _content->removeFromSuperview();
    _content = content;
    // The content stands between the bars in the order of views, so that the keyboard focus goes from top to
    // bottom.
    if (_content)
        insertSubview(_content, 2);
    setNeedsLayout();
}

void PreviewScreenView::setEditBars(
    const std::shared_ptr<kit::View>& bar, const std::shared_ptr<kit::View>& barAbove)
{
    for (const auto& before : {_editBar, _barAbove}) {
        if (before)
            before->removeFromSuperview();
    }
    _editBar = bar;
    _barAbove = barAbove;
    for (const auto& now : {_barAbove, _editBar}) {
        if (now)
            addSubview(now);
    }
    setNeedsLayout();
}

void PreviewScreenView::layoutSubviews()
{
    const double width = bounds().width, height = bounds().height;
    double top = 0, bottom = height;
    const auto placeAbove = [&](kit::View& view, double viewHeight) {
        view.setFrame({0, top, width, viewHeight});
        top += view.isHidden() ? 0 : viewHeight;
    };
    const auto placeBelow = [&](kit::View& view, double viewHeight) {
        view.setFrame({0, bottom - viewHeight, width, viewHeight});
        bottom -= view.isHidden() ? 0 : viewHeight;
    };
    placeAbove(*_searchBar, PreviewSearchBar::barHeight);
    placeBelow(*_toolbar, PreviewToolbar::barHeight);
    if (_editBar)
        placeBelow(*_editBar, PreviewToolbar::barHeight);
    if (_barAbove)
        placeBelow(*_barAbove, PreviewFieldBar::barHeight);
    // While the document is being changed, the note stands below the content, so that the content under the
    // user's finger does not move.
    if (_editBar)
        placeBelow(*_note, noteHeight);
    else
        placeAbove(*_note, noteHeight);
    if (_content)
        _content->setFrame({0, top, width, std::max(0.0, bottom - top)});
}

} // namespace screens
