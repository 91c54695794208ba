// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/service/LocalDownload.h"
#include "platform/NotificationCenter.h"

#include <functional>
#include <map>
#include <memory>
#include <mutex>
#include <optional>
#include <string>

namespace host::drive {

/// The downloads that are under way, one for each document however many callers ask for it. Posts
/// Notification::DownloadsDidChange when one begins, progresses or ends. Any thread.
class RunningDownloads : public std::enable_shared_from_this<RunningDownloads> {
public:
    RunningDownloads(
        LocalDownload::Setting setting, std::shared_ptr<platform::NotificationCenter> notifications);

    /// Joins the document's download, which begins with its first listener and ends with its last.
    std::unique_ptr<platform::ItemDownload> start(
        const std::string& path, platform::DownloadHandlers handlers);
    /// Joins the document's download without a handle to keep.
    void startUnkept(
        const std::string& path, std::function<void(const std::optional<platform::Error>&)> completion);

    std::optional<platform::DownloadProgress> progress(const std::string& path) const;
    /// Ends the download. All its listeners are told FileErrorCode::Cancelled.
    void cancel(const std::string& path);

private:
    using Ticket = std::uint64_t;
    struct Running {
        platform::DownloadProgress progress;
        std::map<Ticket, platform::DownloadHandlers> listeners;
        std::unique_ptr<LocalDownload> work;
    };
    class Handle;

    Ticket join(const std::string& path, platform::DownloadHandlers handlers);
    void leave(const std::string& path, Ticket ticket);
    void arrived(const std::string& path, const platform::DownloadProgress& progress);
    void ended(const std::string& path, const std::optional<platform::Error>& error);
    std::map<Ticket, platform::DownloadHandlers> listenersOf(const std::string& path) const;
    bool listens(const std::string& path, Ticket ticket) const;
    void tellSoon(const std::string& path);
    void tell(const std::string& path);

    const LocalDownload::Setting _setting;
    const std::shared_ptr<platform::NotificationCenter> _notifications;
    mutable std::mutex _mutex;
    std::map<std::string, Running> _running; ///< by path
    Ticket _lastTicket = 0;
};

} // namespace host::drive
