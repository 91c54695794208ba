// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/coordination/LocalFileCoordinator.h"

#include "host/system/files/ItemPaths.h"
#include "host/system/files/SystemErrors.h"
#include "platform/Log.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <system_error>

namespace host::system {

using platform::Error;
using platform::ReadingOptions;
using platform::Url;
using platform::WritingOptions;
using Claims = std::vector<LockFile::Claim>;

namespace {

/// The claims of the current thread in all coordinators. A thread does not ask for a lock that it holds
/// already, because the locks of two open files exclude each other even in one thread.
thread_local Claims claimsOfThread;

/// Adds claims to the thread's for the time of a scope.
class EnteredClaims {
public:
    explicit EnteredClaims(const Claims& claims)
        : _before(claimsOfThread.size())
    {
        claimsOfThread.insert(claimsOfThread.end(), claims.begin(), claims.end());
    }
    EnteredClaims(const EnteredClaims&) = delete;
    EnteredClaims& operator=(const EnteredClaims&) = delete;
    ~EnteredClaims() { claimsOfThread.resize(_before); }

private:
    std::size_t _before;
};

bool isCovered(const LockFile::Claim& claim)
{
    return std::ranges::any_of(claimsOfThread, [&](const auto& had) {
        return had.mode == LockMode::Exclusive ? isPathWithin(claim.path, had.path)
                                               : claim.mode == LockMode::Shared && claim.path == had.path;
    });
}

/// Answers whether the thread would wait for a lock of its own.
bool isBlocked(const LockFile::Claim& claim)
{
    return claim.mode == LockMode::Exclusive && std::ranges::any_of(claimsOfThread, [&](const auto& had) {
        return isPathWithin(had.path, claim.path);
    });
}

/// The moves that were announced in the current write of this thread and have not happened yet.
thread_local std::vector<std::string> announcedMoves;

} // namespace

LocalFileCoordinator::LocalFileCoordinator()
    : LocalFileCoordinator(Settings())
{
}

LocalFileCoordinator::LocalFileCoordinator(Settings settings)
    : _locks(std::move(settings.lockFile))
    , _lockPatience(settings.lockPatience)
    , _notices(std::make_shared<PresenterNotices>(settings.patience, std::move(settings.beforeWaiting)))
{
    if (settings.dispatch && !settings.root.empty())
        _watch = PresenterWatch::create(_notices, std::move(settings.dispatch), std::move(settings.root));
}

LocalFileCoordinator::~LocalFileCoordinator()
{
    if (_watch)
        _watch->stop();
}

std::optional<Error> LocalFileCoordinator::coordinateReading(
    const Url& url, ReadingOptions options, const Accessor& accessor)
{
    if (options == ReadingOptions::ImmediatelyAvailableMetadataOnly) {
        accessor(url);
        return std::nullopt;
    }
    bool isRead = false;
    auto error = runLocked({{url.path(), LockMode::Shared}}, [&] {
        isRead = true;
        accessor(url);
    });
    // When not even the lock file can be written, nobody writes, and there is nothing to wait for.
    if (error && !isRead && (error->code() == EROFS || error->code() == EACCES)) {
        accessor(url);
        return std::nullopt;
    }
    return error;
}

std::optional<Error> LocalFileCoordinator::runLocked(const Claims& claims, const std::function<void()>& body)
{
    static constexpr platform::Operation op{"-[LocalFileCoordinator runLocked:]"};
    Claims missing;
    std::ranges::copy_if(claims, std::back_inserter(missing), [](const auto& c) { return !isCovered(c); });
    for (const auto& claim : missing) {
        if (isBlocked(claim))
            return systemError(EDEADLK, claim.path);
    }
    const auto held = missing.empty() ? FileDescriptor() : _locks.acquire(missing, _lockPatience);
    if (!held) {
        op.warning("Cannot lock %@: %{public}s", missing.front().path,
            std::generic_category().message(held.error.number()));
        return systemError(held.error, missing.front().path);
    }
    const EnteredClaims entered(missing);
    body();
    return std::nullopt;
}

std::optional<Error> LocalFileCoordinator::write(
    std::span<const Target> targets, const std::function<void()>& body)
{
    Claims claims;
    for (const auto& target : targets) {
        claims.push_back({target.url.path(), LockMode::Exclusive});
        if (target.options != WritingOptions::ForDeleting)
            continue;
        if (auto refused = _notices->askForDeletion(target.url)) {
            tellAfterwards(target);
            return refused;
        }
    }
    auto error = runLocked(claims, [&] { runWatched(targets, body); });
    std::ranges::for_each(targets, [this](const auto& target) { tellAfterwards(target); });
    return error;
}

/// Runs a write. The watch does not report it, because this process tells its presenters itself.
void LocalFileCoordinator::runWatched(std::span<const Target> targets, const std::function<void()>& body)
{
    if (!_watch)
        return body();
    std::vector<PresenterWatch::OwnWrite> writes;
    for (const auto& target : targets)
        writes.push_back({target.url.path(), target.options == WritingOptions::ForDeleting});
    _watch->beginOwnWrite(writes);
    body();
    _watch->endOwnWrite(writes);
}

void LocalFileCoordinator::tellAfterwards(const Target& target)
{
    const auto& url = target.url;
    const bool wasOnlyAnnounced = std::erase(announcedMoves, url.path()) > 0;
    const bool isMoveDone = target.options == WritingOptions::ForMoving && !wasOnlyAnnounced;
    const bool isGone = target.options == WritingOptions::ForDeleting && !isItemThere(url.path());
    // The item's own presenters have been told of the move or the deletion, so only the folder has changed.
    if (isMoveDone || isGone)
        _notices->tellOfChange(url.deletingLastPathComponent());
    else
        _notices->tellOfChange(url);
}

std::optional<Error> LocalFileCoordinator::coordinateWriting(
    const Url& url, WritingOptions options, const Accessor& accessor)
{
    const std::array targets{Target{url, options}};
    return write(targets, [&] { accessor(url); });
}

std::optional<Error> LocalFileCoordinator::coordinateWriting(const Url& first, WritingOptions firstOptions,
    const Url& second, WritingOptions secondOptions, const PairAccessor& accessor)
{
    const std::array targets{Target{first, firstOptions}, Target{second, secondOptions}};
    return write(targets, [&] { accessor(first, second); });
}

void LocalFileCoordinator::itemWillMove(const Url& from, const Url& to)
{
    announcedMoves.push_back(from.path());
    _notices->announceMove(from, to);
}

void LocalFileCoordinator::itemDidMove(const Url& from, const Url& to)
{
    std::erase(announcedMoves, from.path());
    _notices->tellOfMove(from, to);
    if (_watch)
        _watch->ownMove(from.path(), to.path());
}

void LocalFileCoordinator::addFilePresenter(const std::shared_ptr<platform::FilePresenter>& presenter)
{
    _notices->add(presenter);
    if (_watch)
        _watch->presentersChanged();
}

void LocalFileCoordinator::removeFilePresenter(const platform::FilePresenter& presenter)
{
    _notices->remove(presenter);
    if (_watch)
        _watch->presentersChanged();
}

} // namespace host::system
