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
/// One that is missing is made for pictures: at once on a background thread; on the main thread it is left to
/// the background, and a later question finds it.
class ThumbnailCache : public std::enable_shared_from_this<ThumbnailCache> {
public:
    static constexpr int pixelSize = 1024;
    /// A picture with more pixels gets no thumbnail: decoding it would take too much memory.
    static constexpr std::int64_t mostPixels = 100'000'000;

    enum class IfMissing { Nothing, MakeFromPicture };

    /// `folder`: the cache's root, `$XDG_CACHE_HOME/thumbnails`.
    static std::shared_ptr<ThumbnailCache> create(
        std::string folder, std::shared_ptr<platform::Dispatch> dispatch);
    /// The root that the environment gives.
    static std::string sharedFolder();

    /// The thumbnails of a file's present version; empty when there are none.
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
