// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/listing/WatchedListing.h"

#include "host/system/listing/FolderRevising.h"
#include "platform/Weakly.h"

#include <sys/stat.h>

#include <algorithm>
#include <iterator>
#include <utility>

namespace host::system {

using platform::Duration;
using platform::FolderSnapshot;
using platform::ListingStage;
using platform::weakly;

namespace {

// A program that saves makes several changes at once, so the list waits a little after the first.
constexpr Duration namesSettle = std::chrono::milliseconds(10);
// A folder that disappears may be about to be replaced.
constexpr Duration lossSettles = std::chrono::milliseconds(50);
// A folder that changes all the time must not keep the machine busy. Between two looks the list has time to
// show the first one's result, and the looks take a fifth of the time at most.
constexpr Duration shortestRest = std::chrono::milliseconds(40);
constexpr int restFactor = 4;
// A file that is being written is looked at only so often, because the writing may take hours.
constexpr Duration betweenLooksAtWriting = std::chrono::milliseconds(500);
// From about so many names on, reading the whole folder is quicker.
constexpr std::size_t manyNames = 4096;
// The measured time is limited, because the clock may be set meanwhile.
constexpr Duration longestWork = std::chrono::seconds(1);

} // namespace

/// Holds the readings' results for the main thread. Only the newest result waits in it.
class WatchedListing::Inbox {
public:
    void folderOpened(const std::optional<Identity>& identity)
    {
        const std::lock_guard lock(_mutex);
        _folder = identity;
    }
    std::optional<Identity> folder() const
    {
        const std::lock_guard lock(_mutex);
        return _folder;
    }
    /// Answers whether nothing was waiting, so that the main thread must be told.
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
    mutable std::mutex _mutex;
    std::shared_ptr<const FolderSnapshot> _newest;
    std::optional<Identity> _folder;
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
    _mustRead = true;
    _isResting = false;
    work();
}

/// Begins the next work, unless work is under way or a pause has not ended.
void WatchedListing::work()
{
    if (_reading || _isRevising || _isResting || (!_mustRead && _names.empty()))
        return;
    _workBegan = _dispatch->now();
    if (_mustRead || !_latest || isTooMuch())
        startReading();
    else
        startRevising();
}

/// Pauses: no work begins before the end.
void WatchedListing::restFor(Duration pause)
{
    _isResting = true;
    _dispatch->after(pause, _dispatch->mainQueue(), weakly(this, &WatchedListing::restEnded, ++_rest));
}

void WatchedListing::restEnded(std::uint64_t rest)
{
    if (_rest != rest)
        return;
    _isResting = false;
    if (std::exchange(_mustSettle, false))
        restFor(lossSettles);
    else
        work();
}

void WatchedListing::workEnded()
{
    const Duration took(_dispatch->now().nanoseconds - _workBegan.nanoseconds);
    restFor(std::max(shortestRest, restFactor * std::min(took, longestWork)));
}

void WatchedListing::folderChanged(const Names& names)
{
    bool isLoss = false;
    for (const auto& name : names) {
        isLoss = isLoss || name.empty();
        if (!name.empty() && mayBeListed(name))
            _names.insert(name);
    }
    const bool mustReadNow = isLoss || isTooMuch();
    if (mustReadNow)
        _names.clear();
    // The pause begins at the first loss only, because a stream of losses would otherwise extend it for ever.
    if (mustReadNow && !std::exchange(_mustRead, true))
        _mustSettle = true;
    if (!_isResting && (_mustRead || !_names.empty()))
        restFor(namesSettle);
}

void WatchedListing::watch()
{
    if (_watcher)
        return;
    _watcher = std::make_shared<FolderWatcher>(
        weakly(this, &WatchedListing::folderChanged), weakly(this, &WatchedListing::filesWritten));
}

void WatchedListing::filesWritten(const Names& names)
{
    const bool isWaiting = !_written.empty();
    std::ranges::copy_if(names, std::inserter(_written, _written.end()), mayBeListed);
    if (isWaiting || _written.empty())
        return;
    _dispatch->after(betweenLooksAtWriting, _dispatch->mainQueue(), weakly(this, [](WatchedListing& self) {
        const auto written = std::exchange(self._written, {});
        self.folderChanged({written.begin(), written.end()});
    }));
}

bool WatchedListing::isTooMuch() const
{
    return _names.size() > manyNames + (_latest ? _latest->count() / 4 : 0);
}

void WatchedListing::startReading()
{
    _mustRead = false;
    _names.clear();
    watch();
    const auto put = [inbox = _inbox, queue = _dispatch->mainQueue(),
                         deliver = weakly(this, &WatchedListing::deliver)](
                         std::shared_ptr<const FolderSnapshot> snapshot) {
        if (inbox->put(std::move(snapshot)))
            queue->async(deliver);
    };
    // The watch begins before the reading, so that no change is missed in between.
    const auto opened = [watcher = _watcher, inbox = _inbox](const FileDescriptor& folder) {
        watcher->watch(folder);
        inbox->folderOpened(identityOf(folder));
    };
    _reading = std::make_shared<FolderReading>(_tools, _subject, FolderReading::Handlers{opened, put});
    _reading->start();
}

void WatchedListing::deliver()
{
    const auto snapshot = _inbox->take();
    if (!snapshot)
        return;
    const auto keepsSelf = shared_from_this();
    const bool isEnd = snapshot->stage() != ListingStage::FirstRows;
    if (isEnd) {
        _reading = nullptr;
        _latest = snapshot->stage() == ListingStage::Complete ? snapshot : nullptr;
    }
    _update(snapshot);
    if (isEnd)
        workEnded();
}

std::optional<WatchedListing::Identity> WatchedListing::identityOf(const FileDescriptor& folder)
{
    struct stat status;
    if (::fstat(folder.get(), &status) != 0)
        return std::nullopt;
    return Identity{status.st_dev, status.st_ino};
}

void WatchedListing::startRevising()
{
    _isRevising = true;
    const Names names(_names.begin(), _names.end());
    _names.clear();
    _tools->queue->addOperation([weak = weak_from_this(), before = _latest, names, tools = _tools,
                                    subject = _subject, inbox = _inbox, queue = _dispatch->mainQueue()] {
        const auto folder = openFolder(subject.folder.path());
        const bool isSame = folder && inbox->folder() == identityOf(*folder);
        auto after = isSame ? revisedList(*tools, subject.grouping, *folder, before, names) : nullptr;
        queue->async(weakly(weak, &WatchedListing::revisingEnded, before, std::move(after)));
    });
}

void WatchedListing::revisingEnded(const Snapshot& before, const Snapshot& after)
{
    const auto keepsSelf = shared_from_this();
    _isRevising = false;
    // The folder is read anew when another folder has taken its place, or when the list wastes memory.
    _mustRead = _mustRead || !after || after->isMostlyWaste();
    if (after && after != before) {
        _latest = after;
        _update(after);
    }
    workEnded();
}

} // namespace host::system
