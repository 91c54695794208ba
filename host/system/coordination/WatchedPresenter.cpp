// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/coordination/WatchedPresenter.h"

#include "host/system/coordination/PresenterNotices.h"
#include "host/system/files/ItemPaths.h"
#include "host/system/files/PromisedNames.h"
#include "platform/Log.h"

#include <sys/inotify.h>
#include <sys/stat.h>

#include <algorithm>
#include <cerrno>
#include <cstdlib>

namespace host::system {

using platform::FilePresenter;
using platform::Url;
using Finding = PresentedItem::Finding;

namespace {

// When more names than this vanish at once, only the change of the folder itself is reported.
constexpr std::size_t mostVanishedTold = 64;

std::pair<std::uint64_t, std::uint64_t> identityOf(const std::string& path)
{
    struct stat status;
    return ::stat(path.c_str(), &status) == 0
        ? std::pair<std::uint64_t, std::uint64_t>(status.st_dev, status.st_ino)
        : std::pair<std::uint64_t, std::uint64_t>();
}

/// Answers a path by way of the drive's root. The kernel names the real path of a file, but the root may be a
/// link.
std::string pathOnDrive(const std::string& realPath, const std::string& root)
{
    const std::unique_ptr<char, decltype(&std::free)> resolved(::realpath(root.c_str(), nullptr), &std::free);
    const std::string realRoot = resolved ? resolved.get() : root;
    return isPathWithin(realPath, realRoot) ? root + realPath.substr(realRoot.size()) : realPath;
}

} // namespace

WatchedPresenter::WatchedPresenter(std::weak_ptr<FilePresenter> presenter, std::string path, std::string root)
    : _presenter(std::move(presenter))
    , _item(path)
    , _root(std::move(root))
    , _askedPath(std::move(path))
{
}

void WatchedPresenter::start(FolderWatches& watches)
{
    link(watches);
    see();
    if (_item.isFolder())
        link(watches);
}

void WatchedPresenter::stop(FolderWatches& watches)
{
    for (const auto& held : _links)
        watches.release(held.watch);
    _links.clear();
    watches.release(std::exchange(_inside, -1));
}

int WatchedPresenter::hold(FolderWatches& watches, const std::string& folder)
{
    const auto watch = watches.hold(folder);
    if (watch)
        return *watch;
    // A folder that does not exist is noticed in the folder above it.
    _isBlind |= !watch.error.is(ENOENT) && !watch.error.is(ENOTDIR);
    return -1;
}

void WatchedPresenter::link(FolderWatches& watches)
{
    static constexpr platform::Operation op{"-[WatchedPresenter link:]"};
    const bool wasBlind = std::exchange(_isBlind, false);
    const auto former = std::exchange(_links, {});
    const int formerInside = std::exchange(_inside, -1);
    auto path = _item.path();
    bool isAtTop = false;
    while (!isAtTop && path != "/") {
        const auto folder = parentPath(path);
        _links.push_back({hold(watches, folder), std::string(lastName(path))});
        isAtTop = !isPathWithin(path, _root) || path == _root;
        path = folder;
    }
    if (_item.isFolder())
        _inside = hold(watches, _item.path());
    // The former watches are released only now, so that a folder that stays watched is watched without a gap.
    for (const auto& held : former)
        watches.release(held.watch);
    watches.release(formerInside);
    if (_isBlind && !wasBlind)
        op.warning("Cannot watch the folders of %@, looking now and then instead", _item.path());
}

Finding WatchedPresenter::see()
{
    const auto finding = _item.look();
    const bool isPresent = finding == Finding::Same || finding == Finding::Changed;
    if (isPresent && _item.isKnown())
        _rootIdentity = identityOf(_root);
    return finding;
}

void WatchedPresenter::markMissed()
{
    _isDue = true;
    _isInsideChanged |= _item.isFolder();
}

void WatchedPresenter::mark(const Inotify::Event& event, const IsOwn& isOwn)
{
    if (event.mask & IN_Q_OVERFLOW)
        return markMissed();
    if (event.mask & IN_MOVED_TO) // the item stays within the watched folders
        std::erase_if(_vanished, [&](const auto& each) { return each.second == event.cookie; });
    for (auto& each : _links) {
        if (each.watch != event.watch)
            continue;
        _isDue |= event.isLoss() || itemName(event.name) == each.name
            || (isLongPromiseName(event.name) && event.name == promisePath(each.name));
        if (event.mask & IN_IGNORED)
            each.watch = -1;
    }
    if (_inside >= 0 && _inside == event.watch)
        markInside(event, isOwn);
}

void WatchedPresenter::markInside(const Inotify::Event& event, const IsOwn& isOwn)
{
    if (event.mask & IN_IGNORED)
        _inside = -1;
    if (event.isLoss())
        return markMissed();
    auto name = itemName(event.name);
    if (isLongPromiseName(name)) {
        auto promised = promisedName(_item.path() + '/' + name);
        // A promise that is gone says its name no more, so only the change of the folder is told.
        if (!promised) {
            _isDue = _isInsideChanged = true;
            return;
        }
        name = std::move(*promised);
    }
    if (name.empty() || isPassingName(name) || isOwn(_item.path() + '/' + name))
        return;
    _isDue = _isInsideChanged = true;
    if (event.mask & (IN_CREATE | IN_MOVED_TO))
        _appeared.insert(name);
    const bool isLeaving = event.mask & (IN_DELETE | IN_MOVED_FROM);
    if (isLeaving && _appeared.erase(name) == 0 && _vanished.size() < mostVanishedTold)
        _vanished.emplace(name, event.cookie);
}

void WatchedPresenter::look(FolderWatches& watches, std::vector<Notice>& notices)
{
    _isDue = false;
    link(watches);
    const auto finding = see();
    if (finding == Finding::Moved || finding == Finding::Gone)
        return tellMissing(watches, notices);
    _wasMissing = false;
    tellPresent(finding == Finding::Changed, notices);
    if (finding == Finding::Changed)
        link(watches); // another folder may be in its place now
}

/// Answers whether the drive itself exists, because a drive that was taken off has deleted nothing.
bool WatchedPresenter::isOnDrive() const
{
    return !isPathWithin(_item.path(), _root) || identityOf(_root) == _rootIdentity;
}

void WatchedPresenter::tellMissing(FolderWatches& watches, std::vector<Notice>& notices)
{
    static constexpr platform::Operation op{"-[WatchedPresenter tellMissing:notices:]"};
    if (!isOnDrive())
        return op.warning("The drive went away with %@", _item.path());
    if (!std::exchange(_wasMissing, true)) {
        _isDue = true;
        return;
    }
    _wasMissing = false;
    const auto place = _item.whereabouts();
    if (!place && !place.error.is(ENOENT))
        return; // the next look tells more
    if (place) {
        _item.setPath(pathOnDrive(*place, _root));
        _item.look();
        notices.emplace_back([presenter = _presenter, url = Url::fileURL(_item.path())](auto& told) {
            told.tell(presenter, [url](auto& each) { each.presentedItemDidMoveToURL(url); });
        });
    } else {
        _item.forget();
        notices.emplace_back([presenter = _presenter](auto& told) {
            // It is too late to refuse the deletion, and nobody waits for the answer.
            told.tell(presenter,
                [](auto& each) { each.accommodatePresentedItemDeletionWithCompletionHandler([](auto&) {}); });
        });
    }
    link(watches);
}

void WatchedPresenter::tellPresent(bool hasChanged, std::vector<Notice>& notices)
{
    _appeared.clear();
    for (const auto& [name, cookie] : std::exchange(_vanished, {})) {
        const auto path = _item.path() + '/' + name;
        if (isItemThere(path))
            continue;
        notices.emplace_back([presenter = _presenter, url = Url::fileURL(path)](auto& told) {
            told.tell(presenter, [url](auto& each) {
                each.accommodatePresentedSubitemDeletionAtURLCompletionHandler(url, [](auto&) {});
            });
        });
    }
    if (std::exchange(_isInsideChanged, false) || hasChanged)
        notices.emplace_back([presenter = _presenter](auto& told) {
            told.tell(presenter, [](auto& each) { each.presentedItemDidChange(); });
        });
}

void WatchedPresenter::absorb(FolderWatches& watches, Ending ending)
{
    link(watches);
    const auto finding = see();
    _wasMissing = false;
    if (finding == Finding::Changed)
        link(watches);
    if (finding == Finding::Gone && ending == Ending::WasDeleted)
        _item.forget();
    _isDue = _isInsideChanged || (_item.isKnown() && (finding == Finding::Gone || finding == Finding::Moved));
}

} // namespace host::system
