// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PropertyValue.h"

#include <string>
#include <string_view>

namespace platform {

/// Something that the user does here, or was doing elsewhere (on another device, in the system search) and
/// goes on with here.
struct UserActivity {
    std::string type;
    PropertyDictionary userInfo{};
    bool isEligibleForHandOff = false; ///< whether the account's other devices may go on with it

    bool operator==(const UserActivity&) const = default;
};

namespace activityType {
inline constexpr std::string_view queryContinuation = "app.tarrow.search.continuation";
inline constexpr std::string_view searchableItem = "app.tarrow.search.item";
} // namespace activityType

namespace activityKey {
inline constexpr std::string_view searchQuery = "SearchQueryString";
inline constexpr std::string_view searchableItemIdentifier = "SearchableItemIdentifier";
inline constexpr std::string_view documentURL = "DocumentURL";
} // namespace activityKey

/// A shortcut of the launcher that was chosen.
struct ShortcutItem {
    std::string type;
    PropertyDictionary userInfo;
};

// Constants of the cloud document service for the two shortcuts, with the keys of a recent document's
// information.
inline constexpr std::string_view ShortcutTypeSearch = "app.tarrow.Drive.search";
inline constexpr std::string_view ShortcutTypeRecentDocument = "app.tarrow.Drive.recent-document";
inline constexpr std::string_view RecentDocumentAliasURLKey = "RecentDocumentAliasURL";
inline constexpr std::string_view RecentDocumentDocIDKey = "RecentDocumentDocID";
inline constexpr std::string_view RecentDocumentURLKey = "RecentDocumentURL";

} // namespace platform
