// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/DriveDependencies.h"
#include "host/drive/records/DriveLayout.h"
#include "host/drive/records/FollowedFile.h"
#include "platform/KeyValueStore.h"
#include "platform/NotificationCenter.h"

#include <atomic>
#include <memory>
#include <mutex>

namespace host::drive {

/// The account's key-value store, a JSON object in a file that is watched. A file that cannot be used counts
/// as missing, and one line is logged for each change of it. Make and destroy it on the main thread.
class LocalKeyValueStore : public platform::KeyValueStore,
                           public std::enable_shared_from_this<LocalKeyValueStore> {
public:
    /// Larger files are not read. The limit is in bytes.
    static constexpr std::size_t maximumFileSize = 1024 * 1024;

    static std::shared_ptr<LocalKeyValueStore> create(
        const DriveLayout& layout, const DriveDependencies& dependencies);

    /// The first call reads the file; later changes are read on a queue.
    std::optional<platform::PropertyValue> objectForKey(const std::string& key) const override;

private:
    LocalKeyValueStore(DriveLayout layout, const DriveDependencies& dependencies);

    void begin(const DriveDependencies& dependencies);
    void valuesRead(platform::PropertyDictionary values);

    DriveLayout _layout;
    std::shared_ptr<platform::NotificationCenter> _notifications;
    std::shared_ptr<FollowedFile> _file;
    /// Says whether a value was ever asked for. The file is not read before that.
    const std::shared_ptr<std::atomic_bool> _isWanted = std::make_shared<std::atomic_bool>(false);
    mutable std::mutex _mutex;
    mutable std::optional<platform::PropertyDictionary> _values; ///< absent before the first reading
};

} // namespace host::drive
