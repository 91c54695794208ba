// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PropertyValue.h"

#include <functional>
#include <memory>
#include <string_view>

namespace platform {

/// The notices that travel through the notification center.
enum class Notification {
    ApplicationDidBecomeActive,
    ApplicationWillResignActive,
    ApplicationWillTerminate, ///< nothing that is put in a queue now will run
    CloudIdentityDidChange,
    StorageOfferDidChange,
    DownloadsDidChange, ///< one began, got on or ended; user information: "url", the document's
    ActivityOffersDidChange, ///< what other devices hand over; see ActivityHandOver
    KeyValueStoreDidChangeExternally,
    KeyboardWillShow, ///< user information: "height" in points
    KeyboardWillHide,
};

/// Keeps an observer registered for as long as it lives. Destroying it stops the calls at once.
class Observation {
public:
    Observation() = default;
    explicit Observation(std::shared_ptr<void> registration)
        : _registration(std::move(registration))
    {
    }

private:
    std::shared_ptr<void> _registration;
};

/// Tells observers of notices, in the order in which they registered, on the thread that posts.
/// Registering and posting are main-thread affairs.
class NotificationCenter {
public:
    using Observer = std::function<void(const PropertyDictionary& userInfo)>;

    NotificationCenter();
    ~NotificationCenter();

    [[nodiscard]] Observation observe(Notification notification, Observer observer);
    /// An observer that is added while a notice is delivered first hears the next one.
    void post(Notification notification, const PropertyDictionary& userInfo = {});

private:
    struct Registry;
    std::shared_ptr<Registry> _registry;
};

} // namespace platform
