// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/NotificationCenter.h"

#include <algorithm>
#include <mutex>
#include <vector>

namespace platform {

struct NotificationCenter::Registry {
    struct Entry {
        Notification notification;
        Observer observer;
    };
    std::mutex mutex;
    std::vector<std::weak_ptr<Entry>> entries;
};

NotificationCenter::NotificationCenter()
    : _registry(std::make_shared<Registry>())
{
}

NotificationCenter::~NotificationCenter() = default;

Observation NotificationCenter::observe(Notification notification, Observer observer)
{
    auto entry = std::make_shared<Registry::Entry>(Registry::Entry{notification, std::move(observer)});
    const std::lock_guard lock(_registry->mutex);
    std::erase_if(_registry->entries, [](const auto& known) { return known.expired(); });
    _registry->entries.push_back(entry);
    return Observation(std::move(entry));
}

void NotificationCenter::post(Notification notification, const PropertyDictionary& userInfo)
{
    // A copy, because an observer may register or drop others; one that was dropped meanwhile is not called.
    const auto entries = [this] {
        const std::lock_guard lock(_registry->mutex);
        return _registry->entries;
    }();
    for (const auto& known : entries) {
        const auto entry = known.lock();
        if (entry && entry->notification == notification)
            entry->observer(userInfo);
    }
}

} // namespace platform
