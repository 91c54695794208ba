#pragma once

#include "host/drive/DriveEntry.h"
#include "host/system/ItemChanges.h"

namespace host::drive {

/// Changes of the drive's items, here or promised. Every step is taken by name in an open folder beneath the
/// documents area; no link is followed and nothing is replaced. Where an item and its promise lie side by
/// side the item counts, and the promise goes with it.
class LocalItemChanges : public host::system::ItemChanges {
public:
    explicit LocalItemChanges(DriveLayout layout)
        : _layout(std::move(layout))
    {
    }

    std::optional<platform::ItemVersion> versionOfItem(const std::string& path) const override;
    std::optional<platform::Error> createFolder(const std::string& path) override;
    std::optional<platform::Error> removeItem(
        const std::string& path, const std::optional<platform::ItemVersion>& unchangedSince) override;
    std::optional<platform::Error> moveItem(const std::string& from, const std::string& to) override;

    /// Moves the content of a downloaded document to the cloud's folder and leaves a promise. One that is
    /// promised already is no error; folders cannot be evicted (FileErrorCode::Unsupported).
    std::optional<platform::Error> evictItem(const std::string& path);

private:
    int removeHeld(const DriveEntry& entry, const std::string& name, const platform::ItemVersion& version);
    int moveAcross(const DriveEntry& source, const std::string& name, const DriveEntry& target,
        const std::string& newName);
    std::optional<platform::Error> replaceByPromise(const DriveEntry& entry, const struct stat& status);
    void removePromise(const DriveEntry& entry, const std::string& cloudContent);
    std::string cloudContent(const DriveEntry& entry) const;

    DriveLayout _layout;
};

} // namespace host::drive
