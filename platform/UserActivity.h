// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PropertyValue.h"

#include <string>
#include <string_view>

namespace platform {

/// Something that the user does here, or was doing elsewhere (on another device, in the search of the
/// desktop) and continues here.
struct UserActivity {
    /// Which kind of activity it is: one of `activityType`, or the program's own for a previewed document.
    std::string type;
    /// What is needed to continue it, under the keys of `activityKey`. It comes from outside, so it must be
    /// checked.
    PropertyDictionary userInfo{};
    /// Whether the account's other devices may continue it.
    bool isEligibleForHandOff = false;

    bool operator==(const UserActivity&) const = default;
};

/// Types of activities that come from the search of the desktop.
namespace activityType {
/// The person wants to go on searching in the program for what was typed on the desktop.
inline constexpr std::string_view queryContinuation = "app.tarrow.search.continuation";
/// The person chose one of the items that the search found.
inline constexpr std::string_view searchableItem = "app.tarrow.search.item";
} // namespace activityType

/// Keys of an activity's user information; all values are texts.
namespace activityKey {
inline constexpr std::string_view searchQuery = "SearchQueryString"; ///< what was typed
inline constexpr std::string_view searchableItemIdentifier = "SearchableItemIdentifier";
inline constexpr std::string_view documentURL = "DocumentURL"; ///< the bookmark string of the shown document
} // namespace activityKey

/// A shortcut of the launcher that the person chose.
struct ShortcutItem {
    std::string type; ///< ShortcutTypeSearch or ShortcutTypeRecentDocument
    PropertyDictionary userInfo; ///< for a recent document, under the keys below
};

/// The types of the launcher's two shortcuts, and the keys of the second one's user information. The two URLs
/// are archived (see KeyedArchiver) and the identifier is a number. The program takes the first that is
/// there, in the order below.
inline constexpr std::string_view ShortcutTypeSearch = "app.tarrow.Drive.search";
inline constexpr std::string_view ShortcutTypeRecentDocument = "app.tarrow.Drive.recent-document";
inline constexpr std::string_view RecentDocumentAliasURLKey = "RecentDocumentAliasURL";
inline constexpr std::string_view RecentDocumentDocIDKey = "RecentDocumentDocID";
inline constexpr std::string_view RecentDocumentURLKey = "RecentDocumentURL";

} // namespace platform
