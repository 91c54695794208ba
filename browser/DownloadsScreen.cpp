// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "browser/DownloadsScreen.h"

#include "kit/controllers/AlertController.h"
#include "kit/controllers/NavigationController.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/views/ListView.h"
#include "platform/Formatters.h"
#include "platform/Localization.h"
#include "platform/Weakly.h"
#include "screens/DisplayName.h"
#include "screens/DocumentIcon.h"
#include "screens/FolderPlaces.h"
#include "screens/PlaceholderView.h"

namespace tarrow {

using kit::BarButtonItem;
using kit::ListView;
using kit::RowId;
using platform::localized;
using platform::weakly;

namespace {

RowId idOf(const Downloads::Entry& entry)
{
    return std::hash<std::string>()(entry.url.path());
}

std::vector<RowId> idsOf(const std::vector<Downloads::Entry>& entries)
{
    std::vector<RowId> ids;
    for (const auto& entry : entries)
        ids.push_back(idOf(entry));
    return ids;
}

std::string bytesText(std::uint64_t bytes)
{
    return services().formatters().byteCount(
        bytes, platform::ByteCountStyle::File, platform::ByteCountUnit::Included);
}

std::string progressText(const Downloads::Entry& entry)
{
    if (!entry.progress)
        return localized("Waiting");
    if (!entry.progress->total)
        return localized("Downloading…");
    return localized(
        "Downloading %1$@ of %2$@", {bytesText(entry.progress->done), bytesText(*entry.progress->total)});
}

} // namespace

std::shared_ptr<DownloadsScreen> DownloadsScreen::present(
    const std::shared_ptr<kit::ViewController>& parent, const std::shared_ptr<Downloads>& downloads)
{
    auto screen = std::make_shared<DownloadsScreen>(downloads);
    const auto stack = std::make_shared<kit::NavigationController>();
    stack->setViewControllers({screen}, false);
    stack->setPresentationStyle(kit::PresentationStyle::OverCurrentContext);
    parent->presentViewController(stack, true);
    return screen;
}

DownloadsScreen::DownloadsScreen(std::shared_ptr<Downloads> downloads)
    : _downloads(std::move(downloads))
{
    setTitle(localized("Downloads"));
}

std::shared_ptr<DownloadsScreen> DownloadsScreen::self()
{
    return std::static_pointer_cast<DownloadsScreen>(shared_from_this());
}

void DownloadsScreen::loadView()
{
    const auto view = std::make_shared<kit::View>();
    _listView = std::make_shared<ListView>();
    _listView->setAccessibility({.label = localized("Downloads"), .hint = {}});
    _placeholder = screens::PlaceholderView::create();
    _placeholder->setContent({.iconName = "folder-download-symbolic",
        .title = localized("Nothing is being downloaded"),
        .message = localized("What you download appears here until it has arrived.")});
    for (const auto& part :
        {std::static_pointer_cast<kit::View>(_listView), std::static_pointer_cast<kit::View>(_placeholder)}) {
        part->setAutoresizing({.flexibleWidth = true, .flexibleHeight = true});
        part->setFrame(view->bounds());
        view->addSubview(part);
    }
    setView(view);
}

void DownloadsScreen::viewDidLoad()
{
    view()->setBackground(platform::Color::white());
    navigationItem().setLeftItems({std::make_shared<BarButtonItem>(kit::SystemItem::Done,
        weakly(this, [](DownloadsScreen& screen) { screen.dismissViewController(true); }))});
    _listView->setDataSource(self());
    _listView->setListDelegate(self());
    showRows();
    _listView->reloadAll();
}

void DownloadsScreen::showRows()
{
    _entries = _downloads->entries();
    _placeholder->setHidden(!_entries.empty());
    if (_entries.empty())
        return navigationItem().setRightItem(nullptr);
    if (navigationItem().rightItems().empty())
        navigationItem().setRightItem(std::make_shared<BarButtonItem>(
            localized("Cancel All"), weakly(_downloads, &Downloads::cancelAll)));
}

void DownloadsScreen::update()
{
    if (!isViewLoaded())
        return;
    const auto before = idsOf(_entries);
    showRows();
    auto changes = kit::ListChanges::between(before, idsOf(_entries));
    changes.changed = {{0, _entries.size()}};
    _listView->apply(changes);
}

std::size_t DownloadsScreen::numberOfRows(const ListView&) const
{
    return _entries.size();
}

RowId DownloadsScreen::rowIdAtIndex(const ListView&, std::size_t index) const
{
    return idOf(_entries[index]);
}

kit::ListRow DownloadsScreen::rowAtIndex(const ListView&, std::size_t index) const
{
    const auto& entry = _entries[index];
    kit::ListRow row;
    row.id = idOf(entry);
    row.title = screens::displayName(entry.url.lastPathComponent());
    row.detail = progressText(entry);
    row.download = entry.progress ? kit::DownloadState::Downloading : kit::DownloadState::InCloud;
    if (entry.progress && entry.progress->total && *entry.progress->total > 0)
        row.downloadProgress =
            static_cast<double>(entry.progress->done) / static_cast<double>(*entry.progress->total);
    return row;
}

/// Asks before a download is cancelled, because a row is touched easily.
void DownloadsScreen::rowActivated(ListView&, std::size_t index)
{
    const auto url = _entries[index].url;
    const auto question = std::make_shared<kit::AlertController>(
        screens::displayName(url.lastPathComponent()), std::string(), kit::AlertStyle::Alert);
    question->addAction(std::make_shared<kit::AlertAction>(localized("Cancel Download"),
        kit::AlertActionStyle::Destructive, weakly(_downloads, &Downloads::cancel, url)));
    question->addAction(
        std::make_shared<kit::AlertAction>(localized("Continue"), kit::AlertActionStyle::Cancel));
    presentViewController(question, true);
}

kit::Menu DownloadsScreen::menuForRow(ListView&, std::size_t index)
{
    return {{.title = localized("Cancel Download"),
        .handler = weakly(_downloads, &Downloads::cancel, _entries[index].url),
        .image = {}}};
}

bool DownloadsScreen::rowCommand(ListView&, std::size_t index, kit::RowCommand command)
{
    if (command != kit::RowCommand::Delete)
        return false;
    _downloads->cancel(_entries[index].url);
    return true;
}

} // namespace tarrow
