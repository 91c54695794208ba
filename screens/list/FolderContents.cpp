// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/list/FolderContents.h"

#include "platform/Services.h"
#include "platform/Weakly.h"

#include <algorithm>
#include <utility>

namespace screens {

namespace {

/// When so many revisions wait, comparing with the list of the last one is quicker than applying them all.
constexpr std::size_t mostWaiting = 8;

FolderContentsUpdate updateBetween(
    const DocumentRows& before, const std::shared_ptr<const FolderSnapshot>& snapshot, const ListOrder& order)
{
    return {DocumentRows::step(before, snapshot, order), snapshot->stage(), snapshot->error()};
}

} // namespace

std::shared_ptr<FolderContents> FolderContents::create(Url folder, Update update)
{
    return std::make_shared<FolderContents>(std::move(folder), std::move(update));
}

FolderContents::FolderContents(Url folder, Update update)
    : _folder(std::move(folder))
    , _update(std::move(update))
    , _rows(DocumentRows::make(FolderSnapshot::Builder(_folder).finish(ListingStage::Complete)))
    , _queue(services().dispatch().makeOperationQueue("folder contents", QualityOfService::UserInitiated))
{
}

void FolderContents::start(std::vector<FolderSnapshot::ExtraItem> extraItems, const ListOrder& order)
{
    _order = order;
    _waiting.clear();
    _listing = services().folderLister().list(
        _folder, std::move(extraItems), order.grouping, weakly(this, &FolderContents::snapshotArrived));
}

void FolderContents::snapshotArrived(Snapshot snapshot)
{
    // The beginning of a new listing is skipped when the list that is shown already holds more rows.
    const bool isBeginning = snapshot->stage() == ListingStage::FirstRows;
    // In an order that is not the lister's own, the first rows are known only when all rows are.
    if (isBeginning && (_rows->count() >= snapshot->count() || !_order.isListersOwn()))
        return;
    if (_isWorking)
        wait(std::move(snapshot));
    else
        workOut(snapshot);
}

void FolderContents::wait(Snapshot snapshot)
{
    // A whole list replaces every waiting one. A revision has to be applied after those before it.
    if (!snapshot->revision() || _waiting.size() >= mostWaiting)
        _waiting.clear();
    _waiting.push_back(std::move(snapshot));
}

void FolderContents::workOut(const Snapshot& snapshot)
{
    if (std::max(snapshot->count(), _rows->count()) <= immediateRows && !_order.needsLooks())
        adopt(updateBetween(*_rows, snapshot, _order));
    else
        workOutInBackground(snapshot);
}

void FolderContents::workOutInBackground(const Snapshot& snapshot)
{
    _isWorking = true;
    const auto main = services().dispatch().mainQueue();
    _queue->addOperation([weak = weak_from_this(), before = _rows, snapshot, order = _order, main] {
        const auto update =
            std::make_shared<const FolderContentsUpdate>(updateBetween(*before, snapshot, order));
        main->async(weakly(weak, [update](FolderContents& self) { self.workEnded(*update); }));
    });
}

void FolderContents::workEnded(const FolderContentsUpdate& update)
{
    _isWorking = false;
    adopt(update);
    if (_waiting.empty() || _isWorking)
        return;
    const auto next = std::move(_waiting.front());
    _waiting.pop_front();
    workOut(next);
}

void FolderContents::adopt(const FolderContentsUpdate& update)
{
    _rows = update.rows;
    if (_update)
        _update(update);
}

} // namespace screens
