// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/list/DocumentSearch.h"

#include "kit/views/ListView.h"
#include "platform/Localization.h"
#include "platform/Services.h"
#include "platform/Weakly.h"
#include "screens/FolderPlaces.h"
#include "screens/PlaceholderView.h"
#include "screens/list/DocumentRowSource.h"

#include <algorithm>
#include <utility>

namespace screens {

namespace {

std::shared_ptr<const DocumentRows> rowsOf(const NameSearchResults& results)
{
    FolderSnapshot::Builder builder(rootFolder().value_or(Url::fileURL("/")));
    for (const auto& item : results.items)
        builder.append(FolderSnapshot::ExtraItem{item.url, item.url.lastPathComponent(), item.kind, {}});
    return DocumentRows::make(builder.finish(ListingStage::Complete));
}

std::set<std::string> promisedPaths(const NameSearchResults& results)
{
    std::set<std::string> paths;
    for (const auto& item : results.items) {
        if (item.isPromise)
            paths.insert(item.url.path());
    }
    return paths;
}

} // namespace

std::shared_ptr<DocumentSearch> DocumentSearch::create(Handlers handlers)
{
    const auto search = std::make_shared<DocumentSearch>(std::move(handlers));
    search->build();
    return search;
}

DocumentSearch::DocumentSearch(Handlers handlers)
    : _handlers(std::move(handlers))
{
}

void DocumentSearch::build()
{
    _results = std::make_shared<kit::ListView>();
    _results->setAccessibility({.label = localized("Search"), .hint = {}});
    _results->setAutoresizing({.flexibleWidth = true, .flexibleHeight = true});
    _source = DocumentRowSource::create(_results);
    _source->setPlaces(placeText);
    _source->setOffersMenus(true);
    _source->setTagDots(_handlers.dots);
    _results->setDataSource(_source);
    _results->setListDelegate(std::shared_ptr<kit::ListViewDelegate>(
        shared_from_this(), static_cast<kit::ListViewDelegate*>(this)));
    _placeholder = PlaceholderView::create();
    _placeholder->setAutoresizing({.flexibleWidth = true, .flexibleHeight = true});
    showState({});
    _presentation = std::make_shared<kit::SearchPresentation>();
    _presentation->setPlaceholder(localized("Search"));
    const auto& view = _presentation->view();
    for (const std::shared_ptr<kit::View>& part :
        {std::shared_ptr<kit::View>(_results), std::shared_ptr<kit::View>(_placeholder)}) {
        part->setFrame(view->bounds());
        view->addSubview(part);
    }
    _rowAnchor = std::make_shared<kit::View>();
    _rowAnchor->setHidden(true);
    view->addSubview(_rowAnchor);
    _presentation->setDelegate(std::shared_ptr<kit::SearchPresentationDelegate>(
        shared_from_this(), static_cast<kit::SearchPresentationDelegate*>(this)));
    // The search begins with an empty query, so that the names are read before the first letter is typed.
    begin();
}

void DocumentSearch::begin()
{
    _session =
        services().nameSearch().begin(searchableFolders(), weakly(this, &DocumentSearch::resultsArrived));
}

void DocumentSearch::searchQueryDidChange(kit::SearchPresentation&)
{
    _ahead = {};
    if (!_session)
        begin();
    _session->setQuery(_presentation->query());
}

void DocumentSearch::searchResultsWanted(kit::SearchPresentation&)
{
    ++_ahead.down;
    catchUp();
}

void DocumentSearch::searchResultChosen(kit::SearchPresentation&)
{
    _ahead.opens = true;
    catchUp();
}

void DocumentSearch::catchUp()
{
    const auto rows = _source->rows();
    const bool isAsked = _ahead.opens || _ahead.down > 0;
    if (!isAsked || !_isComplete || !rows || rows->count() == 0 || _shownQuery != _presentation->query())
        return;
    const auto ahead = std::exchange(_ahead, {});
    const auto row = std::min(std::max<std::size_t>(ahead.down, 1), rows->count()) - 1;
    if (ahead.opens)
        rowActivated(*_results, row);
    else
        _results->focusRow(row);
}

void DocumentSearch::searchDidDisappear(kit::SearchPresentation&)
{
    _session.reset();
}

void DocumentSearch::resultsArrived(const NameSearchResults& results)
{
    const auto before = _source->rows();
    auto rows = rowsOf(results);
    const bool isSameQuery = before && results.query == _shownQuery;
    _shownQuery = results.query;
    _promised = promisedPaths(results);
    const auto changes = isSameQuery ? DocumentRows::changes(*before, *rows) : kit::ListChanges();
    _source->setRows(std::move(rows));
    if (isSameQuery)
        _results->apply(changes);
    else
        _results->reloadAll();
    _source->visibleRowsDidChange();
    showState(results);
    _isComplete = results.isComplete;
    if (_isComplete)
        _handlers.completed(*_source->rows());
    catchUp();
}

void DocumentSearch::showState(const NameSearchResults& results)
{
    if (results.query.empty())
        _placeholder->setContent({.iconName = "edit-find-symbolic",
            .title = localized("Search the whole drive"),
            .message = localized("Find folders and documents by their names, or with “%@” by their tags.",
                {localized("tag:")})});
    else if (results.isComplete)
        _placeholder->setContent({.iconName = "edit-find-symbolic",
            .title = localized("Nothing found"),
            .message = results.isForTag ? localized("No item of the drive has a tag with this name.")
                                        : localized("No item of the drive has a name with this text.")});
    else
        _placeholder->setContent({.message = localized("Searching…"), .isBusy = true});
    _placeholder->setHidden(results.total > 0);
}

void DocumentSearch::rowActivated(kit::ListView&, std::size_t index)
{
    const auto& rows = _source->rows();
    if (rows && index < rows->count())
        _handlers.chosen(rows->url(index), rows->entry(index).kind);
}

kit::Menu DocumentSearch::menuForRow(kit::ListView&, std::size_t index)
{
    const auto item = itemAt(index);
    return item ? _handlers.menu(*item) : kit::Menu();
}

std::optional<RowItem> DocumentSearch::itemAt(std::size_t index) const
{
    const auto& rows = _source->rows();
    if (!rows || index >= rows->count())
        return std::nullopt;
    const auto url = rows->url(index);
    return RowItem{url, rows->entry(index).kind, _promised.contains(url.path()), _results->row(index).title};
}

bool DocumentSearch::rowCommand(kit::ListView&, std::size_t index, kit::RowCommand command)
{
    const auto item = itemAt(index);
    return item && _handlers.command(*item, command);
}

bool DocumentSearch::rowHeld(kit::ListView&, std::size_t index)
{
    const auto item = itemAt(index);
    return item && _handlers.held(*item);
}

void DocumentSearch::heldRowPressedOn(kit::ListView&)
{
    _handlers.heldPressedOn();
}

std::shared_ptr<kit::View> DocumentSearch::anchorFor(const Url& url) const
{
    const auto place = _source->visiblePlaceOf(url);
    if (!place)
        return _results;
    _rowAnchor->setFrame(*place);
    return _rowAnchor;
}

void DocumentSearch::visibleRowsDidChange(kit::ListView&, kit::RowRange)
{
    _source->visibleRowsDidChange();
}

} // namespace screens
