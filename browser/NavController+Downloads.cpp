// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file downloads documents and removes their downloads, and shows what is being downloaded.

#include "browser/DownloadRemoval.h"
#include "browser/DownloadsScreen.h"
#include "browser/NavController.h"
#include "browser/RunningChanges.h"
#include "items/Downloads.h"
#include "items/ItemContents.h"
#include "platform/Dispatch.h"
#include "platform/Localization.h"
#include "platform/Log.h"
#include "prompts/UIUtils.h"
#include "screens/list/DocumentListController.h"

namespace tarrow {

using platform::localized;
using platform::localizedPlural;
using platform::weakly;

void NavController::beginDownloads()
{
    _downloads = Downloads::create({.changed = weakly(this, &NavController::downloadsChanged),
        .ended = weakly(this, &NavController::downloadsEnded)});
}

screens::DownloadVerbs NavController::downloadVerbs()
{
    return {.download = weakly(this, &NavController::downloadItems),
        .remove = weakly(this, &NavController::removeDownloadsOfItems),
        .showRunning = weakly(this, &NavController::showDownloads)};
}

void NavController::downloadItems(const std::vector<Url>& items)
{
    static constexpr Operation op{"-[NavController downloadItems:]"};
    op.userAction("Download");
    op.info("Download of %d items", items.size());
    auto& dispatch = services().dispatch();
    const auto queue = dispatch.makeSerialQueue("TarrowDriveAppID.finddownloads");
    const AccountSession asked;
    const auto found = weakly(this, [asked](NavController& self, const FoundDocuments& documents) {
        if (asked.isCurrent())
            self.downloadFound(documents);
    });
    queue->async([queue, items, asked, found, main = dispatch.mainQueue()] {
        auto documents = findDocuments(items, ContentPlace::Cloud, [&] { return asked.isSignedIn(); });
        main->async([found, documents = std::move(documents)] { found(documents); });
    });
}

void NavController::downloadFound(const FoundDocuments& found)
{
    const auto count = static_cast<std::int64_t>(found.errors.size());
    if (count > 0)
        UIUtils::showErrorsTitleParentViewController(
            found.errors, localizedPlural(".DICT.CANNOT_DOWNLOAD_ITEMS.%d", {count}), topViewController());
    else if (found.documents.empty())
        return tell(localized("Everything is downloaded already"));
    _downloads->add(found.documents);
}

void NavController::removeDownloadsOfItems(const std::vector<Url>& items)
{
    static constexpr Operation op{"-[NavController removeDownloadsOfItems:]"};
    op.userAction("Remove Download");
    op.info("Remove the downloads of %d items", items.size());
    const AccountSession asked;
    changeBegun(ItemChange::begin(asked, items, removeDownloads,
        weakly(this, [asked](NavController& self, const RemovedDownloads& outcome) {
            self.changeEnded();
            if (asked.isCurrent())
                self.downloadsRemoved(outcome);
        })));
}

void NavController::downloadsRemoved(const RemovedDownloads& outcome)
{
    const auto failed = static_cast<std::int64_t>(outcome.errors.size());
    const auto removed = static_cast<std::int64_t>(outcome.removed);
    if (removed > 0)
        tell(localizedPlural(".DICT.DOWNLOADS_REMOVED.%d", {removed}));
    else if (failed == 0 && outcome.isWhole)
        tell(localized("There is no download to remove"));
    if (failed > 0)
        UIUtils::showErrorsTitleParentViewController(outcome.errors,
            localizedPlural(".DICT.CANNOT_REMOVE_DOWNLOADS.%d", {failed}), topViewController());
}

void NavController::showDownloads()
{
    if (!presentedViewController())
        _downloadsScreen = DownloadsScreen::present(self(), _downloads);
}

void NavController::downloadsChanged()
{
    if (const auto shown = _downloadsScreen.lock())
        shown->update();
    if (_downloads->count().all == 0) {
        _downloadsSince.reset();
    } else if (!_downloadsSince) {
        // A short download shows in its row alone.
        _downloadsSince = services().dispatch().now();
        auto& dispatch = services().dispatch();
        dispatch.after(RunningChanges::longTime, dispatch.mainQueue(),
            weakly(this, &NavController::showProgressInLists));
    }
    showProgressInLists();
}

void NavController::downloadsEnded(std::size_t, const std::vector<Error>& errors)
{
    const auto failed = static_cast<std::int64_t>(errors.size());
    if (failed > 0)
        UIUtils::showErrorsTitleParentViewController(
            errors, localizedPlural(".DICT.CANNOT_DOWNLOAD_ITEMS.%d", {failed}), visibleViewController());
}

std::optional<ShownProgress> NavController::progressOfDownloads() const
{
    if (!_downloadsSince || !RunningChanges::isLong(*_downloadsSince))
        return std::nullopt;
    const auto count = _downloads->count();
    const auto text = count.all == 1
        ? localized("Downloading…")
        : localized("Downloading: %1$d of %2$d",
            {static_cast<std::int64_t>(count.done), static_cast<std::int64_t>(count.all)});
    return ShownProgress{text, weakly(_downloads, &Downloads::cancelAll)};
}

} // namespace tarrow
