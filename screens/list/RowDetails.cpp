// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/list/RowDetails.h"

#include "platform/CloudDocumentService.h"
#include "platform/FileCoordinator.h"
#include "platform/FileSystem.h"
#include "platform/Formatters.h"
#include "platform/Localization.h"
#include "platform/Services.h"
#include "screens/DetailText.h"
#include "screens/DisplayName.h"

#include <filesystem>
#include <system_error>

namespace screens {

namespace {

constexpr AttributeKey detailKeys[] = {AttributeKey::LocalizedName, AttributeKey::ContentModificationDate,
    AttributeKey::FileSize, AttributeKey::IsShared, AttributeKey::DownloadingStatus,
    AttributeKey::IsDirectory, AttributeKey::IsPackage};

PromisedItems& promisedItems()
{
    return services().cloudDocumentService().promisedItems();
}

/// Answers whether a name in a folder stands for an item that the folder's list shows.
bool isListed(const std::filesystem::path& path)
{
    const auto name = path.filename();
    return !name.native().starts_with('.') || promisedItems().isItemPromise(Url::fileURL(path.native()));
}

std::optional<std::int64_t> numberOfItems(const Url& folder)
{
    std::error_code error;
    std::filesystem::directory_iterator entry(folder.path(), error);
    std::int64_t count = 0;
    for (; !error && entry != std::filesystem::directory_iterator(); entry.increment(error))
        count += isListed(entry->path()) ? 1 : 0;
    return error ? std::nullopt : std::optional(count);
}

/// Answers where a symbolic link leads, by the name that it holds; the target itself is not looked at.
std::string linkText(const Url& link)
{
    const auto target = services().fileSystem().destinationOfSymbolicLink(link.path());
    const auto name =
        target ? std::filesystem::path(*target.value).lexically_normal().filename().native() : "";
    return name.empty() ? localized("Link") : localized("Link to “%@”", {displayName(name)});
}

std::string sizeText(const Url& url, FolderEntryKind kind, const AttributeMap& values)
{
    if (kind == FolderEntryKind::Link)
        return linkText(url);
    if (opensAsFolder(kind)) {
        const auto count = numberOfItems(url);
        return count ? localizedPlural(".DICT.ITEMS.%d", {*count}) : std::string();
    }
    const auto* size = values.get<std::uint64_t>(AttributeKey::FileSize);
    return size ? services().formatters().byteCount(*size, ByteCountStyle::File, ByteCountUnit::Included)
                : std::string();
}

void describe(RowDetails& details, const Url& url, FolderEntryKind kind, const AttributeMap& values)
{
    details.name = values.optional<std::string>(AttributeKey::LocalizedName);
    if (const auto* date = values.get<Date>(AttributeKey::ContentModificationDate))
        details.text = services().formatters().date(*date, DateStyle::Medium, DateStyle::None);
    details.text = joinedDetails(details.text, sizeText(url, kind, values));
    if (values.flag(AttributeKey::IsShared))
        details.text = joinedDetails(details.text, localized("Shared"));
    const auto* status = values.get<DownloadingStatus>(AttributeKey::DownloadingStatus);
    if (status && *status == DownloadingStatus::NotDownloaded)
        details.download = kit::DownloadState::InCloud;
    details.isFolderInCloud = details.download == kit::DownloadState::InCloud
        && values.flag(AttributeKey::IsDirectory) && !values.flag(AttributeKey::IsPackage);
    if (kind == FolderEntryKind::Document && details.download == kit::DownloadState::Present)
        details.modified = values.optional<Date>(AttributeKey::ContentModificationDate);
}

} // namespace

RowDetails readRowDetails(const Url& url, FolderEntryKind kind)
{
    RowDetails details;
    details.isContainer = opensAsFolder(kind);
    services().fileCoordinator().coordinateReading(
        url, ReadingOptions::ImmediatelyAvailableMetadataOnly, [&](const Url& location) {
            auto reading = promisedItems().readItem(location, detailKeys);
            if (reading.values)
                describe(details, location, kind, *reading.values);
            details.tagNames = std::move(reading.tagNames);
        });
    return details;
}

} // namespace screens
