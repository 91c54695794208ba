// What a person points at, and what is shown while the document is being changed.

#include "platform/components/PreviewPagesView.h"

#include <algorithm>
#include <utility>

namespace platform::components {

namespace {

constexpr double fingerReach = 6; ///< page points around what a finger may mean

bool holds(const Rect& place, Point point, double reach)
{
    return point.x >= place.x - reach && point.x <= place.maxX() + reach && point.y >= place.y - reach
        && point.y <= place.maxY() + reach;
}

/// The last one that lies exactly there, else the last one nearby.
template <typename Things>
auto found(const Things& things, Point point)
{
    for (const double reach : {0.0, fingerReach}) {
        const auto hit = std::find_if(things.rbegin(), things.rend(),
            [&](const auto& thing) { return holds(thing.place, point, reach); });
        if (hit != things.rend())
            return hit;
    }
    return things.rend();
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
        [place, answer = std::move(answer)](const PagedDocument& document) {
            const auto marks = document.marks(place.page);
            const auto hit = found(marks, place.point);
            const auto mark = hit == marks.rend() ? std::nullopt : std::optional(*hit);
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

const FormField* PreviewPagesView::fieldAt(const PagePlace& place) const
{
    for (const double reach : {0.0, fingerReach}) {
        const auto hit = std::ranges::find_if(_fields, [&](const FormField& field) {
            return field.page == place.page && holds(field.place, place.point, reach);
        });
        if (hit != _fields.end())
            return &*hit;
    }
    return nullptr;
}

void PreviewPagesView::setPlacing(bool placing)
{
    if (std::exchange(_isPlacing, placing) == placing)
        return;
    needsDisplay();
    stateDidChange();
}

} // namespace platform::components
