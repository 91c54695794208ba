// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/ContainerRecord.h"
#include "host/drive/records/DriveLayout.h"
#include "platform/DocumentContainers.h"
#include "platform/FileChanges.h"

#include <map>
#include <mutex>
#include <string_view>

namespace host::drive {

/// The containers of the local store, which are the folders of the documents area. Small files describe them
/// and are read again when they change. A container whose description is damaged or missing has its folder's
/// name.
class LocalContainers : public platform::DocumentContainers {
public:
    /// `languages` are the user's, the preferred one first ("de_DE", "de", ...).
    LocalContainers(DriveLayout layout, std::vector<std::string> languages,
        std::shared_ptr<platform::FileChanges> changes);

    std::string defaultContainerIdentifier() const override;
    std::optional<platform::Url> defaultContainerURL() const override;
    bool isContainerTopFolder(const platform::Url& url) const override;
    platform::Result<std::shared_ptr<const platform::DocumentContainer>> containerForItem(
        const platform::Url& url) const override;
    std::optional<std::string> containerIdentifierInURL(const platform::Url& url) const override;
    std::shared_ptr<const platform::DocumentContainer> containerWithIdentifier(
        const std::string& identifier) const override;
    std::optional<std::string> pathRelativeToSyncedRoot(const platform::Url& url) const override;
    bool canMoveWithoutDownloading(const platform::DocumentContainer& source,
        const platform::DocumentContainer& destination) const override;
    std::optional<platform::Error> deleteContents(const platform::DocumentContainer& container) override;
    std::vector<std::shared_ptr<const platform::DocumentContainer>> allContainers() const override;

private:
    /// The attributes that tell one version of a description from another.
    struct Signature {
        std::uint64_t inode = 0, size = 0;
        std::int64_t modified = 0;
        bool hasDocuments = false;
        bool operator==(const Signature&) const = default;
    };
    struct Known {
        Signature signature;
        std::shared_ptr<const platform::DocumentContainer> container;
        std::optional<platform::Error> damage;
    };

    std::string_view belowDocuments(const platform::Url& url) const;
    Signature signature(const std::string& identifier) const;
    Known known(const std::string& identifier) const;
    Known read(const std::string& identifier, const Signature& signature) const;

    DriveLayout _layout;
    std::vector<std::string> _languages;
    std::shared_ptr<platform::FileChanges> _changes;
    mutable std::mutex _mutex;
    mutable std::map<std::string, Known> _known;
};

} // namespace host::drive
