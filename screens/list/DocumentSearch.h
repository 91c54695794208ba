// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/SearchPresentation.h"
#include "kit/views/ListViewDelegate.h"
#include "platform/NameSearch.h"
#include "platform/Url.h"
#include "screens/PlatformNames.h"
#include "screens/list/DocumentRowSource.h"
#include "screens/list/DocumentRows.h"
#include "screens/list/RowItem.h"

#include <functional>
#include <memory>
#include <optional>
#include <set>
#include <string>

namespace kit {
class ListView;
} // namespace kit

namespace screens {

class PlaceholderView;

/// The search over a folder list. It finds the items of the whole drive whose names contain the query, and
/// shows each with its place. Main thread only.
class DocumentSearch : public std::enable_shared_from_this<DocumentSearch>,
                       private kit::SearchPresentationDelegate,
                       private kit::ListViewDelegate {
public:
    /// The actions of the user on a result, and what else its list must know. None may be empty.
    struct Handlers {
        std::function<void(const Url& url, FolderEntryKind kind)> chosen;
        /// Answers the entries of a result's menu.
        std::function<kit::Menu(const RowItem& item)> menu;
        std::function<bool(const RowItem& item, kit::RowCommand command)> command;
        std::function<bool(const RowItem& item)> held;
        std::function<void()> heldPressedOn;
        DocumentRowSource::TagDots dots;
        /// All results of the query are known, or have changed.
        std::function<void(const DocumentRows& rows)> completed;
    };

    static std::shared_ptr<DocumentSearch> create(Handlers handlers);
    explicit DocumentSearch(Handlers handlers);

    /// Answers the screen to present, which shows the results.
    const std::shared_ptr<kit::SearchPresentation>& presentation() const { return _presentation; }
    const std::shared_ptr<kit::ListView>& results() const { return _results; }
    const std::shared_ptr<PlaceholderView>& placeholder() const { return _placeholder; }
    /// Answers the place of an item's row for a popover, or the list of results when the row is not visible.
    std::shared_ptr<kit::View> anchorFor(const Url& url) const;

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
    bool rowCommand(kit::ListView& list, std::size_t index, kit::RowCommand command) override;
    bool rowHeld(kit::ListView& list, std::size_t index) override;
    void heldRowPressedOn(kit::ListView& list) override;
    std::optional<RowItem> itemAt(std::size_t index) const;
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
    std::shared_ptr<kit::View> _rowAnchor; ///< an invisible view at the place of a row, for popovers
    std::shared_ptr<DocumentRowSource> _source;
    std::shared_ptr<NameSearchSession> _session;
    std::set<std::string> _promised; ///< the paths of the shown items of which only a promise is here
    std::string _shownQuery; ///< the query of the rows that are shown
    bool _isComplete = false; ///< whether the rows for this query are complete
    Ahead _ahead;
};

} // namespace screens
