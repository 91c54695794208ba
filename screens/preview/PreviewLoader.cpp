// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/preview/PreviewLoader.h"

#include "kit/values/Screen.h"
#include "platform/CloudDocumentService.h"
#include "platform/FileChanges.h"
#include "platform/FileCoordinator.h"
#include "platform/FileSystem.h"
#include "platform/Formatters.h"
#include "platform/Localization.h"
#include "platform/Services.h"
#include "platform/TypeRegistry.h"
#include "screens/DetailText.h"
#include "screens/DisplayName.h"
#include "screens/ErrorWords.h"
#include "screens/preview/TextDecoding.h"

#include <filesystem>
#include <fstream>
#include <system_error>
#include <utility>

namespace screens {

namespace {

using Kind = PreviewContent::Kind;

constexpr AttributeKey previewKeys[] = {AttributeKey::LocalizedName, AttributeKey::TypeIdentifier,
    AttributeKey::LocalizedTypeDescription, AttributeKey::FileSize, AttributeKey::DownloadingStatus,
    AttributeKey::IsDirectory};

std::string textOf(const AttributeMap& values, AttributeKey key)
{
    return values.optional<std::string>(key).value_or(std::string());
}

std::string kindAndSize(const AttributeMap& values)
{
    auto kind = textOf(values, AttributeKey::LocalizedTypeDescription);
    const auto* size = values.get<std::uint64_t>(AttributeKey::FileSize);
    if (!size)
        return kind;
    return joinedDetails(
        kind, services().formatters().byteCount(*size, ByteCountStyle::File, ByteCountUnit::Included));
}

PreviewContent summary(const Url& url, const AttributeMap& values)
{
    const auto type = textOf(values, AttributeKey::TypeIdentifier);
    const auto name = values.optional<std::string>(AttributeKey::LocalizedName);
    PreviewContent content;
    content.iconName = type.empty() ? "text-x-generic" : services().typeRegistry().iconName(type);
    content.title = displayName(name.value_or(url.lastPathComponent()));
    content.note = kindAndSize(values);
    return content;
}

PreviewContent failure(PreviewContent summary, const std::string& words)
{
    summary.kind = Kind::Failure;
    summary.iconName = "dialog-warning-symbolic";
    summary.note = words;
    return summary;
}

std::string unreadableWords(const std::string& path)
{
    std::error_code problem;
    if (!std::filesystem::exists(path, problem) && !problem)
        return localized("It is no longer there.");
    return localized("You do not have permission to see it.");
}

PreviewContent unreadable(PreviewContent content)
{
    const auto words = unreadableWords(content.path);
    return failure(std::move(content), words);
}

bool isOfKind(const AttributeMap& values, std::string_view type)
{
    const auto* own = values.get<std::string>(AttributeKey::TypeIdentifier);
    return own && services().typeRegistry().conformsTo(*own, type);
}

bool isInCloud(const AttributeMap& values)
{
    const auto* status = values.get<DownloadingStatus>(AttributeKey::DownloadingStatus);
    return status && *status == DownloadingStatus::NotDownloaded;
}

/// One reading of one document.
struct Reading {
    const PreviewLimits& limits;
    const std::function<bool()>& isCancelled;
};

PreviewContent imageContent(PreviewContent content, const Reading& reading)
{
    const auto& limits = reading.limits;
    const auto loaded = services().imageLoader().loadPicture(content.path,
        {.maxWidth = limits.maxImageWidth,
            .maxHeight = limits.maxImageHeight,
            .scale = limits.imageScale,
            .maxPixels = limits.maxImagePixels},
        reading.isCancelled);
    if (!loaded.value)
        return failure(std::move(content),
            loaded.error ? errorWords(*loaded.error) : localized("It could not be read."));
    content.kind = Kind::Image;
    content.picture = *loaded.value;
    content.note =
        loaded->breaksOff ? localized("The picture is damaged. Not all of it can be shown.") : std::string();
    return content;
}

std::string textNote(bool isEmpty, bool isCut, bool hasLongLines)
{
    if (isEmpty)
        return localized("This document is empty.");
    if (isCut)
        return localized("Only the beginning of this document is shown.");
    return hasLongLines ? localized("Only the beginnings of very long lines are shown.") : std::string();
}

PreviewContent textContent(PreviewContent content, const Reading& reading, bool isPlain)
{
    const auto limit = reading.limits.maxTextBytes;
    std::ifstream file(content.path, std::ios::binary);
    // One byte more than the limit is read, to see whether the file has more.
    std::string bytes(limit + 1, '\0');
    file.read(bytes.data(), static_cast<std::streamsize>(bytes.size()));
    if (!file.is_open() || file.bad() || (file.fail() && !file.eof()))
        return unreadable(std::move(content));
    const auto count = static_cast<std::size_t>(file.gcount());
    const bool isCut = count > limit;
    bytes.resize(isCut ? limit : count);
    content.kind = Kind::Text;
    const auto decoded = decodedText(bytes, isCut ? TextEnd::Cut : TextEnd::Whole, services().textDecoder());
    content.text = withoutLongLines(decoded, reading.limits.maxLineBytes);
    content.isSource = !isPlain;
    content.note = textNote(count == 0, isCut, content.text != decoded);
    return content;
}

PreviewContent pagesContent(PreviewContent content)
{
    content.version = services().fileChanges().versionOfItem(content.path);
    const auto opened = services().pagedDocumentOpener().open(content.path);
    if (!opened.value)
        return failure(std::move(content),
            opened.error ? errorWords(*opened.error) : localized("It could not be read."));
    content.kind = Kind::Pages;
    content.pages = *opened.value;
    content.firstPage = content.pages->pageSize(0);
    content.rights = content.pages->rights();
    content.note.clear();
    return content;
}

PreviewContent mediaContent(PreviewContent content, Kind kind)
{
    // The player reads the file by itself, but its message for an unreadable file is less clear, so this is
    // checked first.
    if (!std::ifstream(content.path, std::ios::binary).is_open())
        return unreadable(std::move(content));
    content.kind = kind;
    return content;
}

PreviewContent readContent(const Url& url, const AttributeMap& values, const Reading& reading)
{
    auto content = summary(url, values);
    if (isInCloud(values)) {
        content.kind = Kind::InCloud;
        content.note = localized("This document is in the cloud. It is not downloaded yet.");
        return content;
    }
    // Only a regular file is opened, because opening a pipe or a device could block for ever.
    const auto type = services().fileSystem().typeOfItem(url.path());
    if (!type)
        return failure(std::move(content), localized("It is no longer there."));
    if (*type != FileType::Regular || reading.isCancelled())
        return content;
    content.path = url.path();
    content.fileName = url.lastPathComponent();
    if (isOfKind(values, typeIdentifier::image))
        return imageContent(std::move(content), reading);
    if (isOfKind(values, typeIdentifier::pdf))
        return pagesContent(std::move(content));
    if (isOfKind(values, typeIdentifier::text)) {
        const auto* identifier = values.get<std::string>(AttributeKey::TypeIdentifier);
        return textContent(std::move(content), reading, *identifier == "public.plain-text");
    }
    if (isOfKind(values, typeIdentifier::movie))
        return mediaContent(std::move(content), Kind::Film);
    if (isOfKind(values, typeIdentifier::audio))
        return mediaContent(std::move(content), Kind::Sound);
    return content;
}

} // namespace

PreviewLimits previewLimitsForMainScreen()
{
    PreviewLimits limits;
    const auto& screen = kit::Screen::main();
    if (!screen)
        return limits;
    limits.imageScale = screen->scale;
    limits.maxImageWidth = static_cast<int>(screen->bounds.width * screen->scale);
    limits.maxImageHeight = static_cast<int>(screen->bounds.height * screen->scale);
    return limits;
}

PreviewLimits previewLimitsForCloseLook()
{
    PreviewLimits limits;
    if (const auto& screen = kit::Screen::main())
        limits.imageScale = screen->scale;
    constexpr int longestSide = 32'000;
    limits.maxImageWidth = limits.maxImageHeight = longestSide;
    limits.maxImagePixels = 24'000'000;
    return limits;
}

PreviewContent loadPreview(
    const Url& url, const PreviewLimits& limits, const std::function<bool()>& isCancelled)
{
    static const std::function<bool()> never = [] { return false; };
    const Reading reading{limits, isCancelled ? isCancelled : never};
    PreviewContent content;
    const auto refused = services().fileCoordinator().coordinateReading(
        url, ReadingOptions::ImmediatelyAvailableMetadataOnly, [&](const Url& location) {
            const auto values = services().cloudDocumentService().promisedItems().promisedItemResourceValues(
                location, previewKeys);
            content = values.value
                ? readContent(location, *values, reading)
                : failure(summary(location, {}),
                    values.error ? errorWords(*values.error) : localized("It could not be read."));
        });
    return refused ? failure(summary(url, {}), errorWords(*refused)) : content;
}

} // namespace screens
