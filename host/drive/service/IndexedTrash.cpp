// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/service/IndexedTrash.h"

#include "platform/Dispatch.h"
#include "platform/NotificationCenter.h"
#include "platform/Weakly.h"

#include <chrono>

namespace host::drive {

using platform::Error;
using platform::ItemVersion;
using platform::Result;

namespace {

// A thousand items that are moved at once, and the steps of one item, are told of together.
constexpr platform::Duration noticeDelay = std::chrono::milliseconds(200);

} // namespace

std::shared_ptr<IndexedTrash> IndexedTrash::create(const DriveLayout& layout,
    const std::shared_ptr<LocalItemChanges>& changes, const std::shared_ptr<CloudStore>& store,
    std::shared_ptr<LocalDocumentIdentifiers> identifiers, const DriveDependencies& dependencies)
{
    std::shared_ptr<IndexedTrash> trash(
        new IndexedTrash(layout, changes, store, std::move(identifiers), dependencies));
    trash->begin(layout);
    return trash;
}

IndexedTrash::IndexedTrash(const DriveLayout& layout, const std::shared_ptr<LocalItemChanges>& changes,
    const std::shared_ptr<CloudStore>& store, std::shared_ptr<LocalDocumentIdentifiers> identifiers,
    const DriveDependencies& dependencies)
    : LocalTrash(layout, changes, store)
    , _identifiers(std::move(identifiers))
    , _dispatch(dependencies.dispatch)
    , _notifications(dependencies.notificationCenter)
{
}

void IndexedTrash::begin(const DriveLayout& layout)
{
    _folder = FollowedFolder::follow(_dispatch, layout.trash(), FollowedFolder::IfMissing::Make,
        platform::weakly(this, [](IndexedTrash& self, const auto&) { self.announceLater(); }));
}

void IndexedTrash::announceLater()
{
    if (_isAnnounced.exchange(true))
        return;
    _dispatch->after(noticeDelay, _dispatch->mainQueue(), platform::weakly(this, [](IndexedTrash& self) {
        self._isAnnounced = false;
        self._notifications->post(platform::Notification::TrashDidChange);
    }));
}

Result<platform::TrashedItem> IndexedTrash::moveToTrash(
    const std::string& path, const std::optional<ItemVersion>& unchangedSince)
{
    auto item = LocalTrash::moveToTrash(path, unchangedSince);
    announceLater();
    return item;
}

Result<std::string> IndexedTrash::restore(
    const std::string& identifier, const std::optional<std::string>& target)
{
    auto path = LocalTrash::restore(identifier, target);
    // The index kept the item's place while it was away. Across file systems another file came back.
    if (path)
        _identifiers->moved(*path, *path);
    announceLater();
    return path;
}

std::optional<Error> IndexedTrash::remove(const std::string& identifier)
{
    auto error = LocalTrash::remove(identifier);
    announceLater();
    return error;
}

} // namespace host::drive
