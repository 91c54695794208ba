// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/list/FolderContents.h"

#include "platform/Services.h"

#include <algorithm>
#include <utility>

namespace screens {

namespace {

/// Of so many revisions that wait the last alone says it sooner.
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
        _folder, std::move(extraItems), order.grouping, [weak = weak_from_this()](Snapshot snapshot) {
            if (const auto self = weak.lock())
                self->snapshotArrived(std::move(snapshot));
        });
}

void FolderContents::snapshotArrived(Snapshot snapshot)
{
    // After the first rows of a listing anew, the complete list that is shown already says more.
    const bool isBeginning = snapshot->stage() == ListingStage::FirstRows;
    // The first rows of another order than the lister's are not known before all rows are.
    if (isBeginning && (_rows->count() >= snapshot->count() || !_order.isListersOwn()))
        return;
    if (_isWorking)
        wait(std::move(snapshot));
    else
        workOut(std::move(snapshot));
}

void FolderContents::wait(Snapshot snapshot)
{
    // A list that was read whole needs none of those before it; a revision is understood after them only.
    if (!snapshot->revision() || _waiting.size() >= mostWaiting)
        _waiting.clear();
    _waiting.push_back(std::move(snapshot));
}

void FolderContents::workOut(Snapshot snapshot)
{
    if (std::max(snapshot->count(), _rows->count()) <= immediateRows && !_order.needsLooks())
        adopt(updateBetween(*_rows, std::move(snapshot), _order));
    else
        workOutInBackground(std::move(snapshot));
}

void FolderContents::workOutInBackground(Snapshot snapshot)
{
    _isWorking = true;
    const auto main = services().dispatch().mainQueue();
    _queue->addOperation([weak = weak_from_this(), before = _rows, snapshot, order = _order, main] {
        const auto update =
            std::make_shared<const FolderContentsUpdate>(updateBetween(*before, snapshot, order));
        main->async([weak, update] {
            const auto self = weak.lock();
            if (!self)
                return;
            self->_isWorking = false;
            self->adopt(*update);
            if (self->_waiting.empty() || self->_isWorking)
                return;
            const auto next = std::move(self->_waiting.front());
            self->_waiting.pop_front();
            self->workOut(next);
        });
    });
}

void FolderContents::adopt(const FolderContentsUpdate& update)
{
    _rows = update.rows;
    if (_update)
        _update(update);
}

} // namespace screens
