// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "browser/RecentDocument.h"

#include "items/AccountSession.h"
#include "items/DRItem.h"
#include "platform/CloudDocumentService.h"
#include "platform/Dispatch.h"
#include "platform/LauncherShortcuts.h"
#include "platform/Services.h"
#include "platform/UserDefaults.h"

#include <optional>
#include <string>

namespace tarrow {

using platform::ShortcutItem;

namespace {

PropertyValue archived(const Url& url)
{
    return services().keyedArchiver().archive(PropertyValue(url));
}

/// Answers the shortcut to a document. An alias is named only when the document was opened through one,
/// because the shortcut would otherwise lead to the document's old place, and not to the document.
ShortcutItem shortcutTo(
    const Url& document, const std::optional<Url>& alias, std::optional<std::uint32_t> identifier)
{
    ShortcutItem shortcut{std::string(platform::ShortcutTypeRecentDocument), {}};
    auto& information = shortcut.userInfo;
    if (alias)
        information.emplace(platform::RecentDocumentAliasURLKey, archived(*alias));
    if (identifier)
        information.emplace(platform::RecentDocumentDocIDKey, std::uint64_t{*identifier});
    information.emplace(platform::RecentDocumentURLKey, archived(document));
    return shortcut;
}

} // namespace

RecentDocument::RecentDocument()
    : _queue(services().dispatch().makeSerialQueue("TarrowDriveAppID.recentdocument"))
{
}

void RecentDocument::opened(const DRItem& item)
{
    const auto document = item.resolvedURL().value_or(item.url());
    const auto alias = item.isBookmark() ? std::optional(item.url()) : std::nullopt;
    _queue->async([document, alias, session = AccountSession()] {
        const auto identifier = services().cloudDocumentService().documentIdentifiers().identify(document);
        services().dispatch().mainQueue()->async([document, alias, identifier = identifier.value, session] {
            if (session.isCurrent())
                services().launcherShortcuts().keepRecentDocument(
                    document, shortcutTo(document, alias, identifier));
        });
    });
}

void RecentDocument::forget()
{
    services().launcherShortcuts().forgetRecentDocument();
}

} // namespace tarrow
