// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/identity/BookmarkMaking.h"

#include "host/drive/records/AccountRecord.h"
#include "host/drive/records/ItemFacts.h"
#include "host/drive/records/LinkRecords.h"
#include "host/drive/records/RealPath.h"
#include "host/drive/records/SmallFile.h"
#include "host/system/texts/Translate.h"

#include <string_view>

namespace host::drive {

namespace {

using host::system::textKey;
using platform::Result;
using platform::Url;

platform::Error notBookmarkable(const Url& url)
{
    return cloudError(CloudErrorCode::NotBookmarkable, url.path(),
        textKey("The document can’t be opened on your other devices."));
}

/// Answers whether a path is below a folder, and shortens it to the part below.
bool takeFolder(std::string_view& path, std::string_view folder)
{
    if (!path.starts_with(folder) || path.size() <= folder.size() + 1 || path[folder.size()] != '/')
        return false;
    path.remove_prefix(folder.size() + 1);
    return true;
}

/// Answers the container and the path below its documents folder. The path is empty when the item is not a
/// document of a container.
Bookmark placeOf(const DriveLayout& layout, const std::string& path)
{
    std::string_view rest = path;
    if (!takeFolder(rest, layout.documents()))
        return {};
    Bookmark place;
    place.container = rest.substr(0, rest.find('/'));
    rest = path;
    if (takeFolder(rest, layout.containerDocuments(place.container)) && isPlainRelativePath(rest))
        place.path = rest;
    return place;
}

} // namespace

Result<std::string> makeBookmark(const DriveLayout& layout, const Url& url, const IdentifyDocument& identify)
{
    const auto real = url.isFileURL() ? realPathOfEntry(url.path()) : std::nullopt;
    auto bookmark = real ? placeOf(layout, *real) : Bookmark();
    const auto account = AccountRecord::read(layout);
    if (bookmark.path.empty() || !account)
        return notBookmarkable(url);
    if (lookAtItem(*real).presence == ItemFacts::Presence::Missing)
        return notBookmarkable(url);
    bookmark.account = account->identity;
    bookmark.documentIdentifier = identify(real->substr(layout.home().size() + 1));
    // A name may be any bytes but a bookmark's text must be UTF-8, so such a document can be named by its
    // identifier alone.
    if (bookmark.documentIdentifier == 0 && !platform::isValidUtf8(bookmark.path))
        return notBookmarkable(url);
    auto text = bookmark.encoded();
    return text.size() <= Bookmark::maximumLength ? Result(std::move(text)) : notBookmarkable(url);
}

} // namespace host::drive
