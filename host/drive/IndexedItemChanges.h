#pragma once

#include "host/drive/LocalDocumentIdentifiers.h"
#include "host/drive/LocalItemChanges.h"

namespace host::drive {

/// Changes of the drive's items that the document index hears of.
class IndexedItemChanges : public host::system::ItemChanges {
public:
    IndexedItemChanges(const DriveLayout& layout, std::shared_ptr<CloudStore> store,
        std::shared_ptr<LocalDocumentIdentifiers> identifiers)
        : _changes(layout, std::move(store))
        , _identifiers(std::move(identifiers))
    {
    }

    std::optional<platform::ItemVersion> versionOfItem(const std::string& path) const override;
    std::optional<platform::Error> createFolder(const std::string& path) override;
    std::optional<platform::Error> removeItem(
        const std::string& path, const std::optional<platform::ItemVersion>& unchangedSince) override;
    std::optional<platform::Error> moveItem(const std::string& from, const std::string& to) override;
    platform::Result<platform::FileContent> contentToReplace(
        const std::string& path, std::size_t maximumBytes) const override;
    platform::Result<platform::ItemVersion> replaceContent(
        const std::string& path, const platform::FileContent& before, std::string_view content) override;
    std::optional<platform::Error> addDocument(
        const std::string& path, const std::string& like, std::string_view content) override;
    /// As LocalItemChanges::evictItem().
    std::optional<platform::Error> evictItem(const std::string& path);

private:
    LocalItemChanges _changes;
    std::shared_ptr<LocalDocumentIdentifiers> _identifiers;
};

} // namespace host::drive
