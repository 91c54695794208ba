// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PropertyValue.h"

#include <functional>
#include <memory>
#include <string_view>

namespace platform {

/// The notices that travel through the notification center. Their user information is empty unless a comment
/// says otherwise.
enum class Notification {
    ApplicationDidBecomeActive, ///< the launch ended, or the window is no longer minimised
    ApplicationWillResignActive, ///< the window was minimised or closed, or the process is ending
    ApplicationDidLoseFocus, ///< the user turned to another window, which is a moment to save
    ApplicationWillTerminate, ///< the process ends: work that is put into a queue now does not run any more
    CloudIdentityDidChange, ///< another account, or none, is signed in; see CloudAccount
    StorageOfferDidChange, ///< there is another offer, or none any more; see StorageOfferManager
    DownloadsDidChange, ///< a download began, got on or ended; user information: "url", the document's
    PuttingRightDidChange, ///< the drive puts right what was interrupted, or has done so; see
                           ///< CloudDocumentService
    TrashDidChange, ///< something came into the trash or left it; see Trash
    ActivityOffersDidChange, ///< other devices offer other activities; see ActivityHandOver
    KeyValueStoreDidChangeExternally, ///< another program changed the values; see KeyValueStore
    KeyboardWillShow, ///< the keyboard on the screen appears; user information: "height" in points
    KeyboardWillHide, ///< the keyboard on the screen goes away
};

/// Keeps an observer registered for as long as this object lives. Destroying it, on the main thread, stops
/// the calls at once, also while a notice is being delivered. One that was made without a registration holds
/// nothing.
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

/// Tells observers of notices, in the order in which they registered. Notices are posted on the main thread
/// alone, and observers are called there, before post() returns. Any thread may register an observer, because
/// what needs the first notice may be asked for first anywhere.
class NotificationCenter {
public:
    using Observer = std::function<void(const PropertyDictionary& userInfo)>;

    NotificationCenter();
    ~NotificationCenter();

    /// Registers an observer for one kind of notice. It hears of notices until the answer is destroyed.
    [[nodiscard]] Observation observe(Notification notification, Observer observer);
    /// Delivers a notice to its observers. An observer that registers meanwhile hears only of later ones.
    void post(Notification notification, const PropertyDictionary& userInfo = {});

private:
    struct Registry;
    std::shared_ptr<Registry> _registry;
};

} // namespace platform
