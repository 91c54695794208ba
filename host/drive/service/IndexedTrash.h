// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/identity/LocalDocumentIdentifiers.h"
#include "host/drive/records/DriveDependencies.h"
#include "host/drive/records/FollowedFolder.h"
#include "host/drive/trash/LocalTrash.h"

#include <atomic>

namespace host::drive {

/// The trash that tells the document index of what comes back, and observers of every change. Make and
/// destroy it on the main thread.
class IndexedTrash : public LocalTrash, public std::enable_shared_from_this<IndexedTrash> {
public:
    static std::shared_ptr<IndexedTrash> create(const DriveLayout& layout,
        const std::shared_ptr<LocalItemChanges>& changes, const std::shared_ptr<CloudStore>& store,
        std::shared_ptr<LocalDocumentIdentifiers> identifiers, const DriveDependencies& dependencies);

    platform::Result<platform::TrashedItem> moveToTrash(
        const std::string& path, const std::optional<platform::ItemVersion>& unchangedSince) override;
    platform::Result<std::string> restore(
        const std::string& identifier, const std::optional<std::string>& target) override;
    std::optional<platform::Error> remove(const std::string& identifier) override;

private:
    IndexedTrash(const DriveLayout& layout, const std::shared_ptr<LocalItemChanges>& changes,
        const std::shared_ptr<CloudStore>& store, std::shared_ptr<LocalDocumentIdentifiers> identifiers,
        const DriveDependencies& dependencies);
    void begin(const DriveLayout& layout);
    void announceLater();

    std::shared_ptr<LocalDocumentIdentifiers> _identifiers;
    std::shared_ptr<platform::Dispatch> _dispatch;
    std::shared_ptr<platform::NotificationCenter> _notifications;
    std::shared_ptr<FollowedFolder> _folder;
    std::atomic_bool _isAnnounced = false; ///< a notice is on its way
};

} // namespace host::drive
