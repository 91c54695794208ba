#include "host/system/WatchedListing.h"

#include <algorithm>
#include <utility>

namespace host::system {

using platform::Duration;
using platform::FolderSnapshot;
using platform::ListingStage;

namespace {

// A program that saves makes several changes at once; and a folder that changes all the time must not keep
// the machine busy: it may be read a fifth of the time.
constexpr Duration changesSettle = std::chrono::milliseconds(50);
constexpr int pauseFactor = 4;

} // namespace

/// Where readings leave what they have for the main thread. Only the newest waits there.
class WatchedListing::Inbox {
public:
    /// Whether nothing waited, so that the main thread must be told.
    bool put(std::shared_ptr<const FolderSnapshot> snapshot)
    {
        const std::lock_guard lock(_mutex);
        return !std::exchange(_newest, std::move(snapshot));
    }
    std::shared_ptr<const FolderSnapshot> take()
    {
        const std::lock_guard lock(_mutex);
        return std::exchange(_newest, nullptr);
    }

private:
    std::mutex _mutex;
    std::shared_ptr<const FolderSnapshot> _newest;
};

WatchedListing::WatchedListing(std::shared_ptr<platform::Dispatch> dispatch,
    std::shared_ptr<const ListingTools> tools, FolderReading::Subject subject,
    platform::FolderLister::Update update)
    : _dispatch(std::move(dispatch))
    , _tools(std::move(tools))
    , _subject(std::move(subject))
    , _update(std::move(update))
    , _inbox(std::make_shared<Inbox>())
{
}

WatchedListing::~WatchedListing()
{
    if (_reading)
        _reading->cancel();
}

void WatchedListing::refresh()
{
    if (_reading)
        _mustReadAgain = true;
    else
        startReading();
}

void WatchedListing::startReading()
{
    _mustReadAgain = false;
    _readingBegan = _dispatch->now();
    if (!_watcher)
        _watcher = std::make_shared<FolderWatcher>([weak = weak_from_this()](const auto&) {
            if (const auto self = weak.lock())
                self->folderChanged();
        });
    const auto put = [inbox = _inbox, queue = _dispatch->mainQueue(), weak = weak_from_this()](
                         std::shared_ptr<const FolderSnapshot> snapshot) {
        if (inbox->put(std::move(snapshot)))
            queue->async([weak] {
                if (const auto self = weak.lock())
                    self->deliver();
            });
    };
    // The watch begins before the reading, so that no change falls between them.
    const auto watch = [watcher = _watcher](const FileDescriptor& folder) { watcher->watch(folder); };
    _reading = std::make_shared<FolderReading>(_tools, _subject, FolderReading::Handlers{watch, put});
    _reading->start();
}

void WatchedListing::deliver()
{
    const auto snapshot = _inbox->take();
    if (!snapshot)
        return;
    if (snapshot->stage() != ListingStage::FirstRows)
        readingEnded();
    _update(snapshot);
}

void WatchedListing::readingEnded()
{
    _reading = nullptr;
    _readingTook = Duration(_dispatch->now().nanoseconds - _readingBegan.nanoseconds);
    if (_mustReadAgain)
        startReading();
}

void WatchedListing::folderChanged()
{
    if (std::exchange(_isReadingSoon, true))
        return;
    const Duration sinceReading(
        _dispatch->now().nanoseconds - _readingBegan.nanoseconds - _readingTook.count());
    const auto pause = std::max(changesSettle, pauseFactor * _readingTook - sinceReading);
    _dispatch->after(pause, _dispatch->mainQueue(), [weak = weak_from_this()] {
        if (const auto self = weak.lock()) {
            self->_isReadingSoon = false;
            self->refresh();
        }
    });
}

} // namespace host::system
