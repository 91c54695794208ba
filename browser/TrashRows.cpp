// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "browser/TrashRows.h"

#include "platform/Localization.h"
#include "screens/DetailText.h"
#include "screens/DisplayName.h"
#include "screens/DocumentIcon.h"
#include "screens/FolderPlaces.h"

#include <functional>
#include <map>

namespace tarrow {

using platform::FileType;
using platform::localized;
using Reason = TrashedItem::Reason;

namespace {

/// Answers in a few words why an item is in the trash; empty when the user has moved it there.
std::string shortReason(Reason reason)
{
    switch (reason) {
    case Reason::Trashed:
        return {};
    case Reason::NotPutBack:
        return localized("Could not be put back");
    case Reason::KeptCopy:
        return localized("Kept version");
    case Reason::ContentWithoutPromise:
        return localized("Without a name");
    }
    return {};
}

std::string sentenceAbout(Reason reason)
{
    switch (reason) {
    case Reason::Trashed:
        return {};
    case Reason::NotPutBack:
        return localized("It could not be put back in its place after an interruption, because its name was "
                         "taken or its folder was gone.");
    case Reason::KeptCopy:
        return localized(
            "Another program saved a new document in its place while it was being moved to the trash.");
    case Reason::ContentWithoutPromise:
        return localized("Its content is in the cloud, but nothing in the drive leads to it any more, so its "
                         "name is lost. Restore puts it into the folder “%@”.",
            {localized("Documents")});
    }
    return {};
}

constexpr const char* linkIcon = "emblem-symbolic-link";

/// Answers the name for the screen. The ending of an alias says nothing to the user.
std::string shownName(const TrashedItem& item)
{
    const std::string_view name = item.name;
    const auto ending = item.standsForAnother ? screens::nameExtension(name).size() + 1 : 0;
    return screens::displayName(name.substr(0, name.size() - ending));
}

std::string iconOf(const TrashedItem& item)
{
    if (item.standsForAnother)
        return linkIcon;
    switch (item.type) {
    case FileType::Directory:
        return "folder";
    case FileType::SymbolicLink:
        return linkIcon;
    case FileType::Regular:
    case FileType::Other:
        break;
    }
    return screens::documentIconName({}, item.name);
}

std::string dateText(const TrashedItem& item, DateStyle time)
{
    return item.trashed ? services().formatters().date(*item.trashed, DateStyle::Medium, time)
                        : std::string();
}

} // namespace

kit::RowId TrashRow::id() const
{
    return std::hash<std::string>()(item.identifier);
}

kit::ListRow TrashRow::listRow() const
{
    kit::ListRow row;
    row.id = id();
    row.title = name;
    row.image = platform::Image::named(iconOf(item));
    row.detail = screens::joinedDetails(
        shortReason(item.reason), screens::joinedDetails(place, dateText(item, DateStyle::None)));
    row.download = item.isPromise ? kit::DownloadState::InCloud : kit::DownloadState::Present;
    return row;
}

std::string TrashRow::description() const
{
    std::string text;
    const auto add = [&text](const std::string& line) {
        if (!line.empty())
            text += text.empty() ? line : '\n' + line;
    };
    add(place.empty() ? std::string() : localized("It was in “%@”.", {place}));
    add(item.trashed ? localized("In the trash since %@", {dateText(item, DateStyle::Short)})
                     : std::string());
    add(sentenceAbout(item.reason));
    return text;
}

TrashContent readTrash()
{
    auto items = services().trash().items();
    TrashContent content{{}, std::move(items.error)};
    std::map<std::string, std::string> places;
    for (auto& item : items.value.value_or(std::vector<TrashedItem>())) {
        TrashRow row{{}, shownName(item), {}};
        if (!item.origin.empty()) {
            const auto url = Url::fileURL(item.origin);
            // Most items come from a few folders.
            auto& place = places[url.deletingLastPathComponent().path()];
            if (place.empty())
                place = screens::placeText(url);
            row.place = place;
        }
        row.item = std::move(item);
        content.rows.push_back(std::move(row));
    }
    return content;
}

} // namespace tarrow
