// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/listing/FolderReading.h"
#include "host/system/listing/FolderWatcher.h"
#include "platform/FolderLister.h"

#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <unordered_set>
#include <vector>

namespace host::system {

/// Keeps one folder's list up to date. It reads the whole folder once and then looks only at the names that
/// the kernel reports. When notices were lost or are too many, it reads the whole folder again. Only one
/// piece of work runs at a time, and the pauses between them grow with their duration. Main thread, except
/// for the results of the work.
class WatchedListing : public platform::FolderListing, public std::enable_shared_from_this<WatchedListing> {
public:
    WatchedListing(std::shared_ptr<platform::Dispatch> dispatch, std::shared_ptr<const ListingTools> tools,
        FolderReading::Subject subject, platform::FolderLister::Update update);
    ~WatchedListing() override;

    void refresh() override;

private:
    class Inbox;
    /// Identifies the folder that was read, so that a list is not continued with the content of another
    /// folder in the same place.
    struct Identity {
        std::uint64_t device = 0, inode = 0;
        bool operator==(const Identity&) const = default;
    };
    using Snapshot = std::shared_ptr<const platform::FolderSnapshot>;
    using Names = std::vector<std::string>;

    void watch();
    void folderChanged(const Names& names);
    void filesWritten(const Names& names);
    void restFor(platform::Duration pause);
    void restEnded(std::uint64_t rest);
    void work();
    void startReading();
    void deliver();
    void startRevising();
    void revisingEnded(const Snapshot& before, const Snapshot& after);
    void workEnded();
    bool isTooMuch() const;
    static std::optional<Identity> identityOf(const FileDescriptor& folder);

    const std::shared_ptr<platform::Dispatch> _dispatch;
    const std::shared_ptr<const ListingTools> _tools;
    const FolderReading::Subject _subject;
    const platform::FolderLister::Update _update;
    std::shared_ptr<FolderWatcher> _watcher;
    std::shared_ptr<Inbox> _inbox;
    std::shared_ptr<FolderReading> _reading; ///< null while none is under way
    Snapshot _latest; ///< the list on which revisions build; null: the folder must be read
    std::unordered_set<std::string> _names; ///< names that were reported and not looked at since
    std::unordered_set<std::string>
        _written; ///< names of files that are being written, which are looked at now and then
    platform::Date _workBegan;
    std::uint64_t _rest = 0; ///< number of the pauses; only the last one counts
    bool _isRevising = false, _mustRead = false, _mustSettle = false, _isResting = false;
};

} // namespace host::system
