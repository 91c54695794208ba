// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/LocalItemChanges.h"
#include "host/drive/trash/TrashPlace.h"
#include "platform/Trash.h"

#include <chrono>
#include <memory>
#include <mutex>
#include <set>

namespace host::drive {

/// The trash as a folder of the drive. Each item that is moved there gets a folder of its own (TrashPlace);
/// what Recovery could not put back lies beside these folders and is listed, restored and removed as well.
///
/// Whoever moves something in or out shares a lock of the trash folder, so a place without an item was left
/// by a process that is gone when the lock can be had alone. Such places are removed by the next listing. An
/// item without a record is listed with what is known of it.
///
/// Contents in the cloud without a promise are listed, too. A search for them reads all promises, so it takes
/// at most a twentieth of the time. One is restored by making a promise of it, and removed by releasing it
/// (CloudStore::release()): neither harms a promise that the search has missed.
class LocalTrash : public platform::Trash {
public:
    LocalTrash(
        DriveLayout layout, std::shared_ptr<LocalItemChanges> changes, std::shared_ptr<CloudStore> store)
        : _layout(std::move(layout))
        , _changes(std::move(changes))
        , _store(std::move(store))
    {
    }

    platform::Result<platform::TrashedItem> moveToTrash(
        const std::string& path, const std::optional<platform::ItemVersion>& unchangedSince) override;
    platform::Result<std::vector<platform::TrashedItem>> items() override;
    platform::Result<std::string> restore(
        const std::string& identifier, const std::optional<std::string>& target) override;
    std::optional<platform::Error> remove(const std::string& identifier) override;
    std::optional<platform::Error> removeOlderThan(platform::Date moment) override;

private:
    /// An item in the trash, and the place that it has unless Recovery brought it.
    struct Found {
        system::FileDescriptor trash; ///< locked
        std::optional<TrashPlace> place;
        LocatedItem item;
    };

    std::vector<platform::TrashedItem> contentsWithoutPromise();
    platform::Result<std::string> restoreContent(
        const std::string& content, const std::optional<std::string>& target);
    system::SystemError promiseContent(const DriveEntry& entry, const std::string& content) const;
    std::optional<platform::Error> removeContent(const std::string& content);
    void forgetContent(const std::string& content);

    platform::Result<Found> find(const std::string& identifier) const;
    system::SystemError take(const LocatedItem& item, const TrashPlace& place);
    void dropEmptyPlaces(const std::vector<std::string>& names) const;
    platform::TrashedItem describe(const std::string& identifier, const LocatedItem& item,
        const std::optional<TrashRecord>& record) const;
    system::SystemResult<std::string> originOf(const Found& found) const;

    DriveLayout _layout;
    std::shared_ptr<LocalItemChanges> _changes;
    std::shared_ptr<CloudStore> _store;
    std::mutex _mutex; ///< guards the fields below
    std::set<std::string> _contents; ///< without a promise, as the last search has found them
    std::chrono::steady_clock::time_point _nextSearch;
};

} // namespace host::drive
