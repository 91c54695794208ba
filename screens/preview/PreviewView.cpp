// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/preview/PreviewView.h"

#include <algorithm>
#include <utility>

namespace screens {

void PreviewView::setZoom(double zoom)
{
    const double kept = std::clamp(zoom, minZoom, maxZoom);
    if (kept == _zoom)
        return;
    _zoom = kept;
    _peer.notify([](auto& peer) { peer.previewZoomDidChange(); });
    stateDidChange();
}

void PreviewView::userZoomed(double zoom)
{
    const double kept = std::clamp(zoom, minZoom, maxZoom);
    if (std::exchange(_zoom, kept) != kept)
        stateDidChange();
}

void PreviewView::setQuery(std::string query)
{
    if (query == _query)
        return;
    _query = std::move(query);
    _search = {};
    queryDidChange();
    _peer.notify([](auto& peer) { peer.previewQueryDidChange(); });
    stateDidChange();
}

void PreviewView::showMatch(MatchStep step)
{
    _peer.notify([step](auto& peer) { peer.previewShouldShowMatch(step); });
}

void PreviewView::setSearchState(const SearchState& state)
{
    if (state == _search)
        return;
    _search = state;
    stateDidChange();
}

void PreviewView::stop()
{
    _peer.notify([](auto& peer) { peer.previewShouldStop(); });
}

void PreviewView::takeFocus()
{
    _peer.notify([](auto& peer) { peer.previewShouldTakeFocus(); });
}

void PreviewView::copy()
{
    _peer.notify([](auto& peer) { peer.previewShouldCopy(); });
}

void PreviewView::userWantsToFind()
{
    if (const auto call = _onFind)
        call();
}

void PreviewView::peerFailed(const std::string& words)
{
    if (const auto call = _onFailure)
        call(words);
}

void PreviewView::stateDidChange()
{
    if (const auto call = _onStateChange)
        call();
}

} // namespace screens
