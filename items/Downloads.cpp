// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/Downloads.h"

#include "platform/CloudItems.h"
#include "platform/Localization.h"
#include "platform/Weakly.h"
#include "screens/DisplayName.h"

#include <algorithm>
#include <utility>

namespace tarrow {

using platform::localized;
using platform::weakly;

namespace {

platform::CloudItems& cloudItems()
{
    return services().cloudDocumentService().items();
}

/// Answers the error with a sentence that names the document.
Error named(const Url& url, const Error& error)
{
    if (error.text(platform::errorKey::localizedDescription))
        return error;
    const auto name = screens::displayName(url.lastPathComponent());
    auto sentence = localized("“%@” couldn’t be downloaded.", {name});
    return Error(error.domain(), error.code(),
        {{std::string(platform::errorKey::localizedDescription), std::move(sentence)},
            {std::string(platform::errorKey::filePath), url.path()}});
}

} // namespace

std::shared_ptr<Downloads> Downloads::create(Handlers handlers)
{
    const auto made = std::make_shared<Downloads>(std::move(handlers));
    made->_observation = services().notificationCenter().observe(
        platform::Notification::DownloadsDidChange, weakly(made, &Downloads::downloadsDidChange));
    return made;
}

std::vector<Downloads::Entry> Downloads::entries() const
{
    auto running = _running;
    // One that was begun just now is told of a little later.
    for (const auto& [path, download] : _asked)
        running.try_emplace(path);
    std::vector<Entry> entries;
    entries.reserve(running.size() + _waiting.size());
    for (const auto& [path, progress] : running)
        entries.push_back({Url::fileURL(path), progress});
    for (const auto& url : _waiting)
        entries.push_back({url, std::nullopt});
    return entries;
}

void Downloads::add(const std::vector<Url>& documents)
{
    for (const auto& url : documents) {
        if (_asked.contains(url.path()) || !_waitingPaths.insert(url.path()).second)
            continue;
        _waiting.push_back(url);
        ++_count.all;
    }
    beginMore();
    _handlers.changed();
}

void Downloads::beginMore()
{
    while (_asked.size() < mostAtOnce && !_waiting.empty()) {
        const auto url = std::move(_waiting.front());
        _waiting.pop_front();
        _waitingPaths.erase(url.path());
        _asked.emplace(
            url.path(), cloudItems().startDownload(url, {{}, weakly(this, &Downloads::ended, url)}));
    }
}

void Downloads::ended(const Url& url, const std::optional<Error>& error)
{
    _asked.erase(url.path());
    ++_count.done;
    if (!error)
        ++_arrived;
    else if (!error->is(FileErrorCode::Cancelled))
        _errors.push_back(named(url, *error));
    beginMore();
    finishIfDone();
}

void Downloads::finishIfDone()
{
    if (_asked.empty() && _waiting.empty() && _count.all > 0) {
        _count = {};
        const auto errors = std::exchange(_errors, {});
        _handlers.ended(std::exchange(_arrived, 0), errors);
    }
    _handlers.changed();
}

void Downloads::downloadsDidChange(const PropertyDictionary& userInfo)
{
    const auto* value = platform::find(userInfo, "url");
    const auto* url = value ? value->get<Url>() : nullptr;
    if (!url)
        return;
    if (const auto progress = cloudItems().downloadProgress(*url))
        _running.insert_or_assign(url->path(), *progress);
    else
        _running.erase(url->path());
    _handlers.changed();
}

void Downloads::cancel(const Url& url)
{
    if (_waitingPaths.erase(url.path()) == 0)
        return cloudItems().cancelDownload(url);
    std::erase(_waiting, url);
    ++_count.done;
    finishIfDone();
}

void Downloads::cancelAll()
{
    _count.done += _waiting.size();
    _waiting.clear();
    _waitingPaths.clear();
    for (const auto& entry : entries())
        cloudItems().cancelDownload(entry.url);
    finishIfDone();
}

void Downloads::forget()
{
    _waiting.clear();
    _waitingPaths.clear();
    _asked.clear();
    _errors.clear();
    _arrived = 0;
    _count = {};
    _handlers.changed();
}

} // namespace tarrow
