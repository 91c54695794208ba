#include "platform/components/DocumentSearch.h"

#include "platform/Localization.h"
#include "platform/Services.h"
#include "platform/components/DocumentRowSource.h"
#include "platform/components/PlaceholderView.h"
#include "platform/ui/ListView.h"

#include <utility>

namespace platform::components {

std::shared_ptr<DocumentSearch> DocumentSearch::create(Chosen chosen)
{
    const auto search = std::make_shared<DocumentSearch>(std::move(chosen));
    search->build();
    return search;
}

DocumentSearch::DocumentSearch(Chosen chosen)
    : _chosen(std::move(chosen))
    , _queue(services().dispatch().makeOperationQueue("document search", QualityOfService::UserInteractive))
{
}

void DocumentSearch::build()
{
    _results = std::make_shared<ui::ListView>();
    _results->setAutoresizing({.flexibleWidth = true, .flexibleHeight = true});
    _source = DocumentRowSource::create(_results);
    _results->setDataSource(_source);
    _results->setListDelegate(
        std::shared_ptr<ui::ListViewDelegate>(shared_from_this(), static_cast<ui::ListViewDelegate*>(this)));
    _placeholder = PlaceholderView::create();
    _placeholder->setAutoresizing({.flexibleWidth = true, .flexibleHeight = true});
    _presentation = std::make_shared<ui::SearchPresentation>();
    _presentation->setPlaceholder(localized("Search"));
    const auto& view = _presentation->view();
    for (const std::shared_ptr<ui::View>& part :
        {std::shared_ptr<ui::View>(_results), std::shared_ptr<ui::View>(_placeholder)}) {
        part->setFrame(view->bounds());
        view->addSubview(part);
    }
    _presentation->setDelegate(std::shared_ptr<ui::SearchPresentationDelegate>(
        shared_from_this(), static_cast<ui::SearchPresentationDelegate*>(this)));
}

void DocumentSearch::setSnapshot(std::shared_ptr<const FolderSnapshot> snapshot)
{
    _snapshot = std::move(snapshot);
    findMatches();
}

void DocumentSearch::searchQueryDidChange(ui::SearchPresentation&)
{
    findMatches();
}

void DocumentSearch::findMatches()
{
    if (!_snapshot)
        return;
    const auto main = services().dispatch().mainQueue();
    _queue->addOperation([weak = weak_from_this(), snapshot = _snapshot, query = _presentation->query(), main,
                             generation = ++_generation] {
        // An empty field shows no results rather than the whole folder again.
        auto rows = query.empty()
            ? DocumentRows::make(FolderSnapshot::Builder(snapshot->folder()).finish(ListingStage::Complete))
            : DocumentRows::matching(snapshot, query);
        main->async([weak, rows, generation] {
            if (const auto self = weak.lock(); self && self->_generation == generation)
                self->show(rows);
        });
    });
}

void DocumentSearch::show(std::shared_ptr<const DocumentRows> rows)
{
    const bool isFruitless = rows->count() == 0 && !_presentation->query().empty();
    _source->setRows(std::move(rows));
    _results->reloadAll();
    _source->visibleRowsDidChange();
    _placeholder->setContent({
        .iconName = "edit-find-symbolic",
        .title = localized("Nothing found"),
        .message = localized("No item here has a name with this text."),
    });
    _placeholder->setHidden(!isFruitless);
}

void DocumentSearch::rowActivated(ui::ListView&, std::size_t index)
{
    const auto& rows = _source->rows();
    if (rows && index < rows->count())
        _chosen(rows->url(index), rows->entry(index).kind);
}

void DocumentSearch::visibleRowsDidChange(ui::ListView&, ui::RowRange)
{
    _source->visibleRowsDidChange();
}

} // namespace platform::components
