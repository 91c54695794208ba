// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/DriveEntry.h"
#include "host/drive/changes/TreeWalk.h"
#include "platform/FileChanges.h"

#include <functional>
#include <memory>

namespace host::drive {

class CloudStore;

/// Changes the drive's items, downloaded or promised. Every step acts by name in an open folder beneath the
/// documents area. It follows no link, enters no mount in a folder, and replaces nothing. When a document and
/// a promise have the same name, the document counts: a promise that adds nothing is removed with it, and a
/// promise with another content stays and becomes visible again.
///
/// An item is moved to another file system by a copy under a temporary name, which is compared, synced and
/// renamed. Only then is the original removed; when that fails, the copy is removed again.
class LocalItemChanges : public platform::FileChanges {
public:
    /// Says whether a folder of this name is a package, which a person sees as one document.
    using IsPackage = std::function<bool(const std::string& name)>;

    LocalItemChanges(
        DriveLayout layout, std::shared_ptr<CloudStore> store,
        IsPackage isPackage = [](const std::string&) { return false; })
        : _layout(std::move(layout))
        , _store(std::move(store))
        , _isPackage(std::move(isPackage))
    {
    }

    std::optional<platform::ItemVersion> versionOfItem(const std::string& path) const override;
    std::optional<platform::Error> createFolder(const std::string& path) override;
    std::optional<platform::Error> removeItem(
        const std::string& path, const std::optional<platform::ItemVersion>& unchangedSince) override;
    std::optional<platform::Error> moveItem(const std::string& from, const std::string& to) override;
    std::optional<platform::Error> evictItem(const std::string& path) override;
    platform::Result<platform::FileContent> contentToReplace(
        const std::string& path, std::size_t maximumBytes) const override;
    platform::Result<platform::ItemVersion> replaceContent(
        const std::string& path, const platform::FileContent& before, std::string_view content) override;
    platform::Result<std::vector<std::string>> editTags(
        const std::string& path, const TagEdit& edit) override;
    std::optional<platform::Error> addDocument(
        const std::string& path, const std::string& like, std::string_view content) override;
    std::optional<platform::Error> addCopy(
        const std::string& from, const std::string& to, const std::function<bool()>& goesOn) override;

    // These work on places that somebody has opened, which may lie in the trash. ECANCELED means that the
    // item is not the one that was located any more.

    /// Removes an item for good, with the contents behind its promises.
    system::SystemError removeLocated(const LocatedItem& item);
    /// Gives an item another place, also on another file system, in the form that a promise of the new name
    /// has. The place must have been found free.
    system::SystemError moveLocated(const LocatedItem& source, const DriveEntry& target);
    /// Renames an item, whatever it is by now. Errors: EXDEV when the target is on another file system.
    static system::SystemError moveWithin(
        const LocatedItem& source, const DriveEntry& target, const std::string& newName);
    /// Copies an item to another file system and removes the original.
    system::SystemError moveAcross(
        const LocatedItem& source, const DriveEntry& target, const std::string& newName);

private:
    system::SystemError removeMoved(
        const LocatedItem& source, const TreeVersions& before, const std::string& copy);
    void withdraw(const DriveEntry& target, const std::string& name, const TreeVersions& copied);
    system::SystemError replaceByPromise(const LocatedItem& item);

    DriveLayout _layout;
    std::shared_ptr<CloudStore> _store;
    IsPackage _isPackage;
};

} // namespace host::drive
