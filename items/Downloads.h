// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/PlatformNames.h"
#include "platform/ItemDownload.h"
#include "platform/NotificationCenter.h"

#include <cstddef>
#include <deque>
#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <set>
#include <string>
#include <vector>

namespace tarrow {

/// The downloads of this program: those that the user has asked for, of which a few run at a time, and those
/// that screens have begun. Main thread.
class Downloads : public std::enable_shared_from_this<Downloads> {
public:
    struct Handlers {
        /// A download began, got on or ended, or waits.
        std::function<void()> changed;
        /// The last one that the user asked for has ended: how many have arrived, and why others have not.
        /// Cancelled ones count as neither.
        std::function<void(std::size_t arrived, const std::vector<Error>& errors)> ended;
    };
    static std::shared_ptr<Downloads> create(Handlers handlers);
    explicit Downloads(Handlers handlers)
        : _handlers(std::move(handlers))
    {
    }

    /// A download that runs or waits.
    struct Entry {
        Url url;
        std::optional<platform::DownloadProgress> progress; ///< absent while it waits
    };
    /// Answers those that run, and then those that wait, in the order in which they will run.
    std::vector<Entry> entries() const;

    /// Counts the downloads that the user has asked for since none was left.
    struct Count {
        std::size_t done = 0, all = 0; ///< all is 0 while there are none
    };
    Count count() const { return _count; }

    /// Downloads documents, after those that wait already. One that is downloaded or waits is left out.
    void add(const std::vector<Url>& documents);
    /// Ends a download for everybody who waits for it, or takes one back that waits itself.
    void cancel(const Url& url);
    /// Does so with all.
    void cancelAll();
    /// Ends what the user has asked for without a word, because the account has gone.
    void forget();

private:
    static constexpr std::size_t mostAtOnce = 3;

    void beginMore();
    void ended(const Url& url, const std::optional<Error>& error);
    void downloadsDidChange(const PropertyDictionary& userInfo);
    void finishIfDone();

    const Handlers _handlers;
    platform::Observation _observation;
    std::deque<Url> _waiting;
    std::set<std::string> _waitingPaths;
    std::map<std::string, std::unique_ptr<platform::ItemDownload>> _asked; ///< those that run, by path
    std::map<std::string, platform::DownloadProgress> _running; ///< all that run in the program
    std::vector<Error> _errors;
    std::size_t _arrived = 0;
    Count _count;
};

} // namespace tarrow
