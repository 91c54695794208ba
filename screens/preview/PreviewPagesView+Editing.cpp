// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file finds what the user points at, and shows it while the document is being changed.

#include "screens/preview/PreviewPagesView.h"

#include <algorithm>
#include <iterator>
#include <utility>

namespace screens {

namespace {

constexpr double fingerReach = 20; ///< content points around a touch in which a target counts as hit

/// Answers how far a point is from a rectangle, the larger of both directions, and 0 within it.
double distance(const Rect& place, Point point)
{
    const double across = std::max({place.x - point.x, point.x - place.maxX(), 0.0});
    const double down = std::max({place.y - point.y, point.y - place.maxY(), 0.0});
    return std::max(across, down);
}

/// Answers the nearest thing within reach, the last of equal ones, or null.
template <typename Thing>
const Thing* nearest(const std::vector<Thing>& things, Point point, double reach)
{
    const Thing* found = nullptr;
    for (const auto& thing : things) {
        const double away = distance(thing.place, point);
        if (away > reach)
            continue;
        reach = away;
        found = &thing;
    }
    return found;
}

} // namespace

void PreviewPagesView::userTaps(Point content)
{
    const auto page = _deck.pageAt(content.y);
    if (const auto call = _onTap; call && page)
        call({*page, _deck.toPage(*page, content)});
}

void PreviewPagesView::userPressesEnter()
{
    if (_isPlacing)
        userTaps({_visible.midX(), _visible.midY()});
}

void PreviewPagesView::userWantsUndo()
{
    if (const auto call = _onUndo)
        call();
}

void PreviewPagesView::findMark(
    const PagePlace& place, std::function<void(const std::optional<PageMark>&)> answer)
{
    if (!_document)
        return;
    post(
        [place, reach = fingerReachOn(place.page), answer = std::move(answer)](
            const PagedDocument& document) {
            const auto marks = document.marks(place.page);
            const auto* hit = nearest(marks, place.point, reach);
            const auto mark = hit ? std::optional(*hit) : std::nullopt;
            return [answer, mark](PreviewPagesView&) { answer(mark); };
        },
        _reading);
}

std::map<std::size_t, std::vector<Rect>> PreviewPagesView::chosenPlaces() const
{
    std::map<std::size_t, std::vector<Rect>> chosen;
    for (const auto& [page, part] : _selection) {
        if (!part.places.empty())
            chosen[page] = part.places;
    }
    if (chosen.empty() && _marked)
        chosen[_marked->page] = {matchesOn(_marked->page)[_marked->index]};
    return chosen;
}

void PreviewPagesView::documentDidChange()
{
    _deck.forgetPictures();
    needsDisplay();
    drawNext();
}

void PreviewPagesView::setFields(std::vector<FormField> fields)
{
    _fields = std::move(fields);
    needsDisplay();
    stateDidChange();
}

void PreviewPagesView::setActiveField(std::optional<std::uint32_t> field)
{
    if (std::exchange(_activeField, field) == field)
        return;
    needsDisplay();
    if (const auto* active = activeField())
        reveal(_deck.toContent(active->page, active->place));
}

const FormField* PreviewPagesView::activeField() const
{
    const auto active =
        std::ranges::find_if(_fields, [this](const FormField& field) { return field.id == _activeField; });
    return active == _fields.end() ? nullptr : &*active;
}

double PreviewPagesView::fingerReachOn(std::size_t page) const
{
    return fingerReach / _deck.toContent(page, {0, 0, 1, 1}).width;
}

const FormField* PreviewPagesView::fieldAt(const PagePlace& place) const
{
    std::vector<FormField> here;
    std::ranges::copy_if(
        _fields, std::back_inserter(here), [&](const FormField& field) { return field.page == place.page; });
    const auto* hit = nearest(here, place.point, fingerReachOn(place.page));
    const auto own = hit ? std::ranges::find(_fields, hit->id, &FormField::id) : _fields.end();
    return own == _fields.end() ? nullptr : &*own;
}

void PreviewPagesView::setPlacing(bool placing)
{
    if (std::exchange(_isPlacing, placing) == placing)
        return;
    needsDisplay();
    stateDidChange();
}

} // namespace screens
