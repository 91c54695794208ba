// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/views/ListViewDataSource.h"
#include "platform/NotificationCenter.h"
#include "screens/PlatformNames.h"
#include "screens/list/DocumentRows.h"
#include "screens/list/RowDetails.h"
#include "screens/list/VisibleRowLoader.h"

#include <functional>
#include <memory>
#include <string>
#include <unordered_map>
#include <unordered_set>
#include <vector>

namespace kit {
class ListView;
} // namespace kit

namespace screens {

/// Makes the rows of a document list from the listing, and completes them with details that are fetched while
/// they are visible. Main thread only.
class DocumentRowSource : public kit::ListViewDataSource,
                          public std::enable_shared_from_this<DocumentRowSource> {
public:
    /// Answers the dots for tags. Called on the main thread for rows that are about to be seen.
    using TagDots = std::function<std::vector<kit::TagDot>(const std::vector<std::string>& names)>;

    /// Details of so many rows are kept. Beyond that, those of invisible rows are dropped.
    static constexpr std::size_t keptDetails = 600;

    static std::shared_ptr<DocumentRowSource> create(const std::shared_ptr<kit::ListView>& list);
    explicit DocumentRowSource(const std::shared_ptr<kit::ListView>& list);

    const std::shared_ptr<const DocumentRows>& rows() const { return _rows; }
    /// Sets the rows. The caller tells the list the difference.
    void setRows(std::shared_ptr<const DocumentRows> rows) { _rows = std::move(rows); }
    void setTagDots(TagDots tagDots) { _tagDots = std::move(tagDots); }

    /// Gives the rows a button that opens their menus, or takes it away.
    void setOffersMenus(bool offers) { _offersMenus = offers; }

    /// Dims these rows, in place of the ones before.
    void setDimmed(std::unordered_set<kit::RowId> rows);

    /// Answers the place of an item, which its row shows before the details; none at first. Called on the
    /// main thread for rows that are about to be seen.
    using Places = std::function<std::string(const Url& url)>;
    void setPlaces(Places places) { _places = std::move(places); }

    /// Answers where an item's row is in the view around the list; nothing for a row that is not visible.
    std::optional<platform::Rect> visiblePlaceOf(const Url& url) const;

    /// Fetches the missing details of the visible rows.
    void visibleRowsDidChange();
    /// The details of these items, or of all when absent, may have changed. Known details stay on the screen
    /// until the next `visibleRowsDidChange` has read them again. Folders are always read again, because
    /// their content changes without a notice.
    void invalidateDetails(const std::optional<std::vector<kit::RowId>>& rows = std::nullopt);

    std::size_t numberOfRows(const kit::ListView& list) const override;
    kit::ListRow rowAtIndex(const kit::ListView& list, std::size_t index) const override;
    kit::RowId rowIdAtIndex(const kit::ListView& list, std::size_t index) const override;
    std::optional<std::size_t> rowBeginningWith(
        const kit::ListView& list, std::string_view text, std::size_t from) const override;

private:
    struct Known {
        RowDetails details{};
        bool isNew = true, isStale = false;
        std::optional<Image> thumbnail{};
        std::optional<Date>
            thumbnailOf{}; ///< the version of the document for which a thumbnail was last looked up
    };
    using Loader = VisibleRowLoader<RowDetails>;
    using ThumbnailLoader = VisibleRowLoader<std::optional<Image>>;

    void detailsArrived(kit::RowId id, RowDetails details);
    void thumbnailArrived(kit::RowId id, std::optional<Image> thumbnail);
    /// Answers the visible rows for which the function answers true. It is given the row's known details, or
    /// null when there are none.
    std::vector<RowRequest> visibleRowsThat(
        const std::function<bool(const Known* known)>& lackSomething) const;
    void fetchThumbnails();
    void tellIfVisible(kit::RowId id) const;
    void followDownloads();
    void followTagTable();
    void tagTableDidChange() const;
    void showDownload(kit::ListRow& row, std::size_t index) const;
    void forgetDetailsOutside(const kit::RowRange& range);
    void complete(kit::ListRow& row, const RowDetails& details) const;
    Image iconFor(std::size_t index, const FolderEntry& entry) const;
    const std::string& documentIcon(std::string_view name) const;
    const std::string& documentKind(std::string_view name) const;
    std::string spokenKind(const FolderEntry& entry) const;

    std::weak_ptr<kit::ListView> _list;
    std::shared_ptr<const DocumentRows> _rows;
    std::shared_ptr<Loader> _loader;
    std::shared_ptr<ThumbnailLoader> _thumbnails;
    Observation _onDownloads, _onTagTable;
    TagDots _tagDots;
    bool _offersMenus = false;
    Places _places;
    std::unordered_map<kit::RowId, Known> _known;
    std::unordered_set<kit::RowId> _dimmed;
    mutable std::unordered_map<std::string, std::string> _iconsByExtension, _kindsByExtension;
};

} // namespace screens
