// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/SearchPresentation.h"
#include "kit/views/ListViewDelegate.h"
#include "platform/NameSearch.h"
#include "platform/Url.h"
#include "screens/PlatformNames.h"
#include "screens/list/DocumentRows.h"

#include <functional>
#include <memory>
#include <string>

namespace kit {
class ListView;
} // namespace kit

namespace screens {

class DocumentRowSource;
class PlaceholderView;

/// The search over a folder list. It finds the items of the whole drive whose names contain the query, and
/// shows each with its place. Main thread only.
class DocumentSearch : public std::enable_shared_from_this<DocumentSearch>,
                       private kit::SearchPresentationDelegate,
                       private kit::ListViewDelegate {
public:
    /// The actions of the user on a result.
    struct Handlers {
        std::function<void(const Url& url, FolderEntryKind kind)> chosen;
        std::function<void(const Url& url)> showInFolder;
    };

    static std::shared_ptr<DocumentSearch> create(Handlers handlers);
    explicit DocumentSearch(Handlers handlers);

    /// Answers the screen to present, which shows the results.
    const std::shared_ptr<kit::SearchPresentation>& presentation() const { return _presentation; }
    const std::shared_ptr<kit::ListView>& results() const { return _results; }
    const std::shared_ptr<PlaceholderView>& placeholder() const { return _placeholder; }

private:
    void build();
    void searchQueryDidChange(kit::SearchPresentation& search) override;
    void searchResultsWanted(kit::SearchPresentation& search) override;
    void searchResultChosen(kit::SearchPresentation& search) override;
    void searchDidDisappear(kit::SearchPresentation& search) override;
    void begin();
    void rowActivated(kit::ListView& list, std::size_t index) override;
    void visibleRowsDidChange(kit::ListView& list, kit::RowRange range) override;
    kit::Menu menuForRow(kit::ListView& list, std::size_t index) override;
    void resultsArrived(const NameSearchResults& results);
    void showState(const NameSearchResults& results);
    /// Carries out the keys that were pressed before the results arrived.
    void catchUp();

    /// The keys that were pressed in the field before the results arrived.
    struct Ahead {
        std::size_t down = 0; ///< how many rows down
        bool opens = false;
    };

    Handlers _handlers;
    std::shared_ptr<kit::SearchPresentation> _presentation;
    std::shared_ptr<kit::ListView> _results;
    std::shared_ptr<PlaceholderView> _placeholder;
    std::shared_ptr<DocumentRowSource> _source;
    std::shared_ptr<NameSearchSession> _session;
    std::string _shownQuery; ///< the query of the rows that are shown
    bool _isComplete = false; ///< whether the rows for this query are complete
    Ahead _ahead;
};

} // namespace screens
