#pragma once

#include "platform/Dispatch.h"
#include "platform/Url.h"
#include "platform/components/DocumentRows.h"
#include "platform/ui/ListViewDelegate.h"
#include "platform/ui/SearchPresentation.h"

#include <functional>
#include <memory>
#include <string>

namespace platform::ui {
class ListView;
} // namespace platform::ui

namespace platform::components {

class DocumentRowSource;
class PlaceholderView;

/// The search over a folder list: the list's items whose names hold what is typed. Main thread only.
class DocumentSearch : public std::enable_shared_from_this<DocumentSearch>,
                       private ui::SearchPresentationDelegate,
                       private ui::ListViewDelegate {
public:
    /// A result was tapped.
    using Chosen = std::function<void(const Url& url, FolderEntryKind kind)>;

    static std::shared_ptr<DocumentSearch> create(Chosen chosen);
    explicit DocumentSearch(Chosen chosen);

    /// The screen to present; it shows the results.
    const std::shared_ptr<ui::SearchPresentation>& presentation() const { return _presentation; }
    const std::shared_ptr<ui::ListView>& results() const { return _results; }
    const std::shared_ptr<PlaceholderView>& placeholder() const { return _placeholder; }
    const std::shared_ptr<DocumentRowSource>& rowSource() const { return _source; }

    /// The items to search; called again whenever they changed.
    void setSnapshot(std::shared_ptr<const FolderSnapshot> snapshot);

private:
    void build();
    void searchQueryDidChange(ui::SearchPresentation& search) override;
    void rowActivated(ui::ListView& list, std::size_t index) override;
    void visibleRowsDidChange(ui::ListView& list, ui::RowRange range) override;
    void findMatches();
    void show(std::shared_ptr<const DocumentRows> rows);

    Chosen _chosen;
    std::shared_ptr<ui::SearchPresentation> _presentation;
    std::shared_ptr<ui::ListView> _results;
    std::shared_ptr<PlaceholderView> _placeholder;
    std::shared_ptr<DocumentRowSource> _source;
    std::shared_ptr<const FolderSnapshot> _snapshot;
    std::shared_ptr<OperationQueue> _queue;
    unsigned _generation = 0; ///< of the latest search; an older one that ends is ignored
};

} // namespace platform::components
