// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/LocalItemChanges.h"
#include "host/drive/identity/LocalDocumentIdentifiers.h"

namespace host::drive {

/// Changes the drive's items and tells the document index of each change.
class IndexedItemChanges : public LocalItemChanges {
public:
    IndexedItemChanges(const DriveLayout& layout, std::shared_ptr<CloudStore> store,
        std::shared_ptr<LocalDocumentIdentifiers> identifiers, IsPackage isPackage)
        : LocalItemChanges(layout, std::move(store), std::move(isPackage))
        , _identifiers(std::move(identifiers))
    {
    }

    std::optional<platform::Error> removeItem(
        const std::string& path, const std::optional<platform::ItemVersion>& unchangedSince) override;
    std::optional<platform::Error> moveItem(const std::string& from, const std::string& to) override;
    platform::Result<std::vector<std::string>> editTags(
        const std::string& path, const TagEdit& edit) override;
    std::optional<platform::Error> evictItem(const std::string& path) override;
    platform::Result<platform::ItemVersion> replaceContent(
        const std::string& path, const platform::FileContent& before, std::string_view content) override;

private:
    std::shared_ptr<LocalDocumentIdentifiers> _identifiers;
};

} // namespace host::drive
