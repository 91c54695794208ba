// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Attributes.h"
#include "platform/ThumbnailMaker.h"
#include "platform/Url.h"

#include <condition_variable>
#include <cstdint>
#include <memory>
#include <mutex>
#include <optional>
#include <set>
#include <string>

namespace host::drive {

class ThumbnailFiles;
struct ThumbnailVersion;

/// The thumbnails of documents in the desktop's shared thumbnail cache. One of 1024 pixels that is missing is
/// made and written there. Any thread, but not the main thread, because that takes as long as it takes; who
/// asks for a document whose thumbnail another thread makes waits for that.
///
/// A document that is damaged or too large is not tried again before it changes. One at which the process
/// ends or hangs is tried a few times only. What this machine cannot do is tried again by the next process.
class ThumbnailCache {
public:
    static constexpr int pixelSize = 1024;
    /// A picture with more pixels gets no thumbnail, because decoding it would take too much memory.
    static constexpr std::int64_t mostPixels = 100'000'000;
    static constexpr int mostAttempts = 3;

    /// `folder` is the cache's root, `$XDG_CACHE_HOME/thumbnails`. Without a maker thumbnails are made of
    /// pictures alone.
    ThumbnailCache(std::string folder, std::shared_ptr<const platform::ThumbnailMaker> maker);
    ~ThumbnailCache();
    ThumbnailCache(const ThumbnailCache&) = delete;
    ThumbnailCache& operator=(const ThumbnailCache&) = delete;
    /// Answers the cache's root in this environment.
    static std::string sharedFolder();

    /// Answers the largest thumbnail of a file's current version, made of its content when there is none of
    /// 1024 pixels; empty when there is none at all.
    platform::ThumbnailMap thumbnails(
        const platform::Url& url, platform::Date modified, platform::ThumbnailContent content);

private:
    class Turn;

    std::optional<platform::Image> made(
        const std::string& path, const ThumbnailVersion& version, platform::ThumbnailContent content);
    platform::Result<platform::Image> make(const std::string& path, platform::ThumbnailContent content) const;
    void noteFailure(const ThumbnailVersion& version, const platform::Error& error);
    bool isRefused(const ThumbnailVersion& version) const;

    std::unique_ptr<const ThumbnailFiles> _files;
    std::shared_ptr<const platform::ThumbnailMaker> _maker;
    mutable std::mutex _mutex;
    std::condition_variable _ended;
    std::set<std::string> _beingMade; ///< URIs
    std::set<std::string> _refused; ///< URIs with times, for as long as the process lives
};

} // namespace host::drive
