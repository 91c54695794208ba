// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/list/DocumentRowSource.h"

#include "kit/views/ListView.h"
#include "platform/CloudDocumentService.h"
#include "platform/Localization.h"
#include "platform/Services.h"
#include "platform/TypeRegistry.h"
#include "platform/Weakly.h"
#include "screens/DetailText.h"
#include "screens/DisplayName.h"
#include "screens/DocumentIcon.h"
#include "screens/list/RowThumbnail.h"

#include <algorithm>
#include <utility>

namespace screens {

namespace {

constexpr const char* folderIcon = "folder";
constexpr const char* plainDocumentIcon = "text-x-generic";
constexpr const char* linkIcon = "emblem-symbolic-link";

std::string spokenDescription(
    const kit::ListRow& row, const std::string& kind, const std::vector<std::string>& tagNames)
{
    std::string spoken = row.title;
    const auto add = [&spoken](const std::string& part) {
        if (!part.empty())
            spoken += ", " + part;
    };
    add(kind);
    add(row.detail);
    if (row.download == kit::DownloadState::Downloading)
        add(localized("Downloading"));
    if (row.download == kit::DownloadState::InCloud)
        add(localized("In the cloud"));
    for (const auto& name : tagNames)
        add(name);
    return spoken;
}

} // namespace

std::shared_ptr<DocumentRowSource> DocumentRowSource::create(const std::shared_ptr<kit::ListView>& list)
{
    const auto source = std::make_shared<DocumentRowSource>(list);
    source->_loader = std::make_shared<Loader>(
        "row details", QualityOfService::UserInitiated,
        [](const RowRequest& request) { return readRowDetails(request.url, request.kind); },
        weakly(source, &DocumentRowSource::detailsArrived));
    source->_thumbnails = std::make_shared<ThumbnailLoader>(
        "row thumbnails", QualityOfService::Utility,
        [](const RowRequest& request) { return readRowThumbnail(request.url); },
        weakly(source, &DocumentRowSource::thumbnailArrived));
    source->followDownloads();
    source->followTagTable();
    return source;
}

DocumentRowSource::DocumentRowSource(const std::shared_ptr<kit::ListView>& list)
    : _list(list)
{
}

std::size_t DocumentRowSource::numberOfRows(const kit::ListView&) const
{
    return _rows ? _rows->count() : 0;
}

kit::RowId DocumentRowSource::rowIdAtIndex(const kit::ListView&, std::size_t index) const
{
    return _rows->ids()[index];
}

std::optional<std::size_t> DocumentRowSource::rowBeginningWith(
    const kit::ListView&, std::string_view text, std::size_t from) const
{
    return _rows ? _rows->rowBeginningWith(text, from) : std::nullopt;
}

kit::ListRow DocumentRowSource::rowAtIndex(const kit::ListView&, std::size_t index) const
{
    const auto entry = _rows->entry(index);
    kit::ListRow row;
    row.id = _rows->ids()[index];
    row.isDimmed = _dimmed.contains(row.id);
    row.image = iconFor(index, entry);
    row.title = displayName(entry.name);
    row.accessory = opensAsFolder(entry.kind) ? kit::RowAccessory::Disclosure : kit::RowAccessory::None;
    if (_offersMenus)
        row.menuName = localized("Actions for “%@”", {row.title});
    row.download = entry.isPromise ? kit::DownloadState::InCloud : kit::DownloadState::Present;
    const auto known = _known.find(row.id);
    const bool isKnown = known != _known.end();
    if (isKnown)
        complete(row, known->second.details);
    const bool isFolderInCloud = isKnown && known->second.details.isFolderInCloud;
    if (isFolderInCloud)
        row.image = Image::named(folderIcon);
    if (row.download == kit::DownloadState::InCloud)
        showDownload(row, index);
    if (isKnown && known->second.thumbnail)
        row.image = known->second.thumbnail;
    if (_places)
        row.detail = joinedDetails(_places(_rows->url(index)), row.detail);
    row.accessibleDescription =
        spokenDescription(row, isFolderInCloud ? localized("Folder") : spokenKind(entry),
            isKnown ? known->second.details.tagNames : std::vector<std::string>());
    return row;
}

void DocumentRowSource::complete(kit::ListRow& row, const RowDetails& details) const
{
    if (details.name && !details.name->empty())
        row.title = displayName(*details.name);
    row.detail = details.text;
    if (row.download == kit::DownloadState::Present)
        row.download = details.download;
    if (_tagDots && !details.tagNames.empty())
        row.tagDots = _tagDots(details.tagNames);
}

void DocumentRowSource::followDownloads()
{
    _onDownloads = services().notificationCenter().observe(Notification::DownloadsDidChange,
        weakly(this, [](DocumentRowSource& self, const PropertyDictionary& userInfo) {
            const auto url = userInfo.find("url");
            if (self._rows && url != userInfo.end())
                self.tellIfVisible(self._rows->idFor(*url->second.get<Url>()));
        }));
}

void DocumentRowSource::followTagTable()
{
    // The rows are told a turn later, because those who answer the dots may hear of the change after this.
    _onTagTable = services().notificationCenter().observe(Notification::KeyValueStoreDidChangeExternally,
        weakly(this, [](DocumentRowSource& self, const PropertyDictionary&) {
            services().dispatch().mainQueue()->async(weakly(&self, &DocumentRowSource::tagTableDidChange));
        }));
}

void DocumentRowSource::tagTableDidChange() const
{
    const auto list = _list.lock();
    const bool haveTags =
        std::ranges::any_of(_known, [](const auto& known) { return !known.second.details.tagNames.empty(); });
    if (!list || !_rows || !haveTags)
        return;
    // Invisible rows are told, too, because a window may keep them filled.
    for (std::size_t row = 0; row < _rows->count(); ++row) {
        const auto known = _known.find(_rows->ids()[row]);
        if (known != _known.end() && !known->second.details.tagNames.empty())
            list->rowChanged(row);
    }
}

void DocumentRowSource::showDownload(kit::ListRow& row, std::size_t index) const
{
    const auto progress = services().cloudDocumentService().items().downloadProgress(_rows->url(index));
    if (!progress)
        return;
    row.download = kit::DownloadState::Downloading;
    if (progress->total && *progress->total > 0)
        row.downloadProgress = static_cast<double>(progress->done) / static_cast<double>(*progress->total);
}

Image DocumentRowSource::iconFor(std::size_t index, const FolderEntry& entry) const
{
    if (const auto* extra = _rows->extraItem(index); extra && !extra->iconName.empty())
        return Image::named(extra->iconName);
    if (opensAsFolder(entry.kind))
        return Image::named(folderIcon);
    const auto& icon = documentIcon(entry.name);
    // A link whose name has no known type shows the icon of links.
    const bool isPlainLink = entry.kind == FolderEntryKind::Link && icon == plainDocumentIcon;
    return Image::named(isPlainLink ? linkIcon : icon);
}

const std::string& DocumentRowSource::documentIcon(std::string_view name) const
{
    const std::string extension(nameExtension(name));
    const auto known = _iconsByExtension.find(extension);
    if (known != _iconsByExtension.end())
        return known->second;
    return _iconsByExtension.emplace(extension, documentIconName({}, name)).first->second;
}

const std::string& DocumentRowSource::documentKind(std::string_view name) const
{
    const std::string extension(nameExtension(name));
    const auto known = _kindsByExtension.find(extension);
    if (known != _kindsByExtension.end())
        return known->second;
    const auto& types = services().typeRegistry();
    const auto type = types.typeForExtension(extension);
    auto described = type ? types.description(*type).value_or(std::string()) : std::string();
    return _kindsByExtension.emplace(extension, std::move(described)).first->second;
}

/// Answers the kind of item that a screen reader says beside its name.
std::string DocumentRowSource::spokenKind(const FolderEntry& entry) const
{
    switch (entry.kind) {
    case FolderEntryKind::Library:
        return localized("App library");
    case FolderEntryKind::Folder:
        return localized("Folder");
    case FolderEntryKind::Link:
        return {}; // the details say so
    default:
        return documentKind(entry.name);
    }
}

std::optional<platform::Rect> DocumentRowSource::visiblePlaceOf(const Url& url) const
{
    const auto list = _list.lock();
    const auto [first, count] = list ? list->visibleRows() : kit::RowRange{};
    for (std::size_t index = first; _rows && index < std::min(first + count, _rows->count()); ++index) {
        if (_rows->url(index) != url)
            continue;
        const double top = static_cast<double>(index) * list->rowHeight() - list->contentOffset().y;
        const auto& frame = list->frame();
        return platform::Rect{frame.x, frame.y + top, frame.width, list->rowHeight()};
    }
    return std::nullopt;
}

void DocumentRowSource::visibleRowsDidChange()
{
    const auto list = _list.lock();
    if (!list || !_rows)
        return;
    _loader->setWanted(visibleRowsThat([](const Known* known) { return !known || known->isStale; }));
    forgetDetailsOutside(list->visibleRows());
    fetchThumbnails();
}

std::vector<RowRequest> DocumentRowSource::visibleRowsThat(
    const std::function<bool(const Known* known)>& lackSomething) const
{
    std::vector<RowRequest> requests;
    const auto list = _list.lock();
    const auto range = list && _rows ? list->visibleRows() : kit::RowRange();
    for (auto row = range.first; row < range.end() && row < _rows->count(); ++row) {
        const auto id = _rows->ids()[row];
        const auto known = _known.find(id);
        if (lackSomething(known == _known.end() ? nullptr : &known->second))
            requests.push_back({id, _rows->url(row), _rows->entry(row).kind});
    }
    return requests;
}

void DocumentRowSource::fetchThumbnails()
{
    _thumbnails->setWanted(visibleRowsThat([](const Known* known) {
        return known && known->details.modified && known->details.modified != known->thumbnailOf;
    }));
}

void DocumentRowSource::thumbnailArrived(kit::RowId id, std::optional<Image> thumbnail)
{
    const auto known = _known.find(id);
    if (known == _known.end())
        return;
    const bool isNews = thumbnail || known->second.thumbnail;
    known->second.thumbnail = std::move(thumbnail);
    known->second.thumbnailOf = known->second.details.modified;
    if (isNews)
        tellIfVisible(id);
}

void DocumentRowSource::invalidateDetails(const std::optional<std::vector<kit::RowId>>& rows)
{
    for (auto& [id, known] : _known)
        known.isStale = known.isStale || !rows || known.details.isContainer;
    if (!rows)
        return _loader->cancelAll();
    for (const auto id : *rows) {
        if (const auto known = _known.find(id); known != _known.end())
            known->second.isStale = true;
        _loader->cancel(id);
    }
}

void DocumentRowSource::detailsArrived(kit::RowId id, RowDetails details)
{
    auto& known = _known[id];
    const bool isNews = known.isNew || !(known.details == details);
    known.details = std::move(details);
    known.isStale = known.isNew = false;
    if (isNews)
        tellIfVisible(id);
    fetchThumbnails();
}

void DocumentRowSource::setDimmed(std::unordered_set<kit::RowId> rows)
{
    const auto before = std::exchange(_dimmed, std::move(rows));
    const auto list = _list.lock();
    const auto range = list && _rows ? list->visibleRows() : kit::RowRange();
    for (auto row = range.first; row < range.end() && row < _rows->count(); ++row) {
        const auto id = _rows->ids()[row];
        if (before.contains(id) != _dimmed.contains(id))
            list->rowChanged(row);
    }
}

void DocumentRowSource::tellIfVisible(kit::RowId id) const
{
    const auto list = _list.lock();
    if (!list)
        return;
    const auto range = list->visibleRows();
    for (auto row = range.first; row < range.end() && row < _rows->count(); ++row) {
        if (_rows->ids()[row] == id)
            list->rowChanged(row);
    }
}

void DocumentRowSource::forgetDetailsOutside(const kit::RowRange& range)
{
    if (_known.size() <= keptDetails)
        return;
    std::unordered_map<kit::RowId, Known> kept;
    for (auto row = range.first; row < range.end() && row < _rows->count(); ++row) {
        if (auto known = _known.extract(_rows->ids()[row]))
            kept.insert(std::move(known));
    }
    _known = std::move(kept);
}

} // namespace screens
