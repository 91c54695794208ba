// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/service/RunningDownloads.h"

#include "platform/Url.h"
#include "platform/Weakly.h"

#include <utility>

namespace host::drive {

using platform::DownloadHandlers;
using platform::DownloadProgress;
using platform::Error;
using platform::weakly;

/// The handle that a caller of start() holds.
class RunningDownloads::Handle : public platform::ItemDownload {
public:
    Handle(std::weak_ptr<RunningDownloads> downloads, std::string path, Ticket ticket)
        : _downloads(std::move(downloads))
        , _path(std::move(path))
        , _ticket(ticket)
    {
    }
    ~Handle() override { cancel(); }
    void cancel() override
    {
        if (const auto downloads = _downloads.lock())
            downloads->leave(_path, _ticket);
    }

private:
    std::weak_ptr<RunningDownloads> _downloads;
    std::string _path;
    Ticket _ticket;
};

RunningDownloads::RunningDownloads(
    LocalDownload::Setting setting, std::shared_ptr<platform::NotificationCenter> notifications)
    : _setting(std::move(setting))
    , _notifications(std::move(notifications))
{
}

std::unique_ptr<platform::ItemDownload> RunningDownloads::start(
    const std::string& path, DownloadHandlers handlers)
{
    return std::make_unique<Handle>(weak_from_this(), path, join(path, std::move(handlers)));
}

void RunningDownloads::startUnkept(
    const std::string& path, std::function<void(const std::optional<Error>&)> completion)
{
    join(path, {{}, std::move(completion)});
}

RunningDownloads::Ticket RunningDownloads::join(const std::string& path, DownloadHandlers handlers)
{
    const std::lock_guard lock(_mutex);
    const auto [running, isNew] = _running.try_emplace(path);
    running->second.listeners.emplace(++_lastTicket, std::move(handlers));
    if (isNew) {
        running->second.work = LocalDownload::start(_setting, path,
            {weakly(this, &RunningDownloads::arrived, path), weakly(this, &RunningDownloads::ended, path)});
        tellSoon(path);
    }
    return _lastTicket;
}

void RunningDownloads::leave(const std::string& path, Ticket ticket)
{
    // The handlers are destroyed after the lock is released, because the objects that they hold may call here
    // when they are destroyed.
    decltype(_running)::node_type ended;
    decltype(Running::listeners)::node_type listener;
    const std::lock_guard lock(_mutex);
    const auto running = _running.find(path);
    if (running == _running.end())
        return;
    listener = running->second.listeners.extract(ticket);
    if (!listener || !running->second.listeners.empty())
        return;
    ended = _running.extract(running); // and its work with it
    tellSoon(path);
}

std::optional<DownloadProgress> RunningDownloads::progress(const std::string& path) const
{
    const std::lock_guard lock(_mutex);
    const auto running = _running.find(path);
    return running == _running.end() ? std::nullopt : std::optional(running->second.progress);
}

void RunningDownloads::cancel(const std::string& path)
{
    {
        const std::lock_guard lock(_mutex);
        const auto running = _running.find(path);
        if (running == _running.end())
            return;
        running->second.work->cancel();
    }
    _setting.mainQueue->async(
        weakly(this, &RunningDownloads::ended, path, Error(platform::FileErrorCode::Cancelled)));
}

std::map<RunningDownloads::Ticket, DownloadHandlers> RunningDownloads::listenersOf(
    const std::string& path) const
{
    const std::lock_guard lock(_mutex);
    const auto running = _running.find(path);
    return running == _running.end() ? std::map<Ticket, DownloadHandlers>() : running->second.listeners;
}

bool RunningDownloads::listens(const std::string& path, Ticket ticket) const
{
    const std::lock_guard lock(_mutex);
    const auto running = _running.find(path);
    return running != _running.end() && running->second.listeners.contains(ticket);
}

void RunningDownloads::arrived(const std::string& path, const DownloadProgress& progress)
{
    {
        const std::lock_guard lock(_mutex);
        if (const auto running = _running.find(path); running != _running.end())
            running->second.progress = progress;
    }
    for (const auto& [ticket, handlers] : listenersOf(path)) {
        // An earlier handler may have cancelled this one's handle.
        if (handlers.progress && listens(path, ticket))
            handlers.progress(progress);
    }
    tell(path);
}

void RunningDownloads::ended(const std::string& path, const std::optional<Error>& error)
{
    const auto keepsSelf = shared_from_this();
    const auto listeners = listenersOf(path);
    for (const auto& [ticket, handlers] : listeners) {
        if (handlers.completion && listens(path, ticket))
            handlers.completion(error);
    }
    for (const auto& [ticket, handlers] : listeners)
        leave(path, ticket);
}

void RunningDownloads::tellSoon(const std::string& path)
{
    _setting.mainQueue->async(weakly(this, &RunningDownloads::tell, path));
}

void RunningDownloads::tell(const std::string& path)
{
    if (_notifications)
        _notifications->post(
            platform::Notification::DownloadsDidChange, {{"url", platform::Url::fileURL(path)}});
}

} // namespace host::drive
