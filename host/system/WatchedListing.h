#pragma once

#include "host/system/FolderReading.h"
#include "host/system/FolderWatcher.h"
#include "platform/FolderLister.h"

#include <memory>
#include <mutex>

namespace host::system {

/// One folder's readings, one at a time, and the watch that asks for the next. Main thread, but for what a
/// reading reports.
class WatchedListing : public platform::FolderListing, public std::enable_shared_from_this<WatchedListing> {
public:
    WatchedListing(std::shared_ptr<platform::Dispatch> dispatch, std::shared_ptr<const ListingTools> tools,
        FolderReading::Subject subject, platform::FolderLister::Update update);
    ~WatchedListing() override;

    void refresh() override;

private:
    class Inbox;
    void folderChanged();
    void startReading();
    void deliver();
    void readingEnded();

    const std::shared_ptr<platform::Dispatch> _dispatch;
    const std::shared_ptr<const ListingTools> _tools;
    const FolderReading::Subject _subject;
    const platform::FolderLister::Update _update;
    std::shared_ptr<FolderWatcher> _watcher;
    std::shared_ptr<Inbox> _inbox;
    std::shared_ptr<FolderReading> _reading; ///< null while none is under way
    platform::Date _readingBegan;
    platform::Duration _readingTook{};
    bool _mustReadAgain = false, _isReadingSoon = false;
};

} // namespace host::system
