// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Attributes.h"
#include "platform/Dispatch.h"

#include <memory>
#include <mutex>
#include <set>
#include <string>

namespace host::drive {

/// The thumbnails of 1024 pixels in the desktop's shared thumbnail cache (its "xx-large" folder). Any thread.
///
/// Missing thumbnails are made for pictures. On a background thread that happens at once. On the main thread
/// it is left to the background, and a later request finds the thumbnail.
class ThumbnailCache : public std::enable_shared_from_this<ThumbnailCache> {
public:
    static constexpr int pixelSize = 1024;
    /// A picture with more pixels gets no thumbnail, because decoding it would take too much memory.
    static constexpr std::int64_t mostPixels = 100'000'000;

    enum class IfMissing { Nothing, MakeFromPicture };

    /// `folder` is the cache's root, `$XDG_CACHE_HOME/thumbnails`.
    static std::shared_ptr<ThumbnailCache> create(
        std::string folder, std::shared_ptr<platform::Dispatch> dispatch);
    /// Answers the cache's root in this environment.
    static std::string sharedFolder();

    /// Answers the thumbnails of a file's current version; empty when there are none.
    platform::ThumbnailMap thumbnails(const platform::Url& url, platform::Date modified, IfMissing ifMissing);

private:
    ThumbnailCache(std::string folder, std::shared_ptr<platform::Dispatch> dispatch);

    void makeLater(const std::string& path, platform::Date modified);
    void wasMade(const std::string& path);

    std::string _folder;
    std::shared_ptr<platform::Dispatch> _dispatch;
    std::shared_ptr<platform::OperationQueue> _queue;
    std::mutex _mutex;
    std::set<std::string> _beingMade;
};

} // namespace host::drive
