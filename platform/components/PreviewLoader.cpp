#include "platform/components/PreviewLoader.h"

#include "platform/CloudDocumentService.h"
#include "platform/FileCoordinator.h"
#include "platform/FileSystem.h"
#include "platform/Formatters.h"
#include "platform/ImageLoader.h"
#include "platform/Localization.h"
#include "platform/Services.h"
#include "platform/TypeRegistry.h"
#include "platform/components/DisplayName.h"
#include "platform/components/ErrorWords.h"
#include "platform/components/TextDecoding.h"
#include "platform/ui/Screen.h"

#include <fstream>
#include <utility>

namespace platform::components {

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
    auto note = textOf(values, AttributeKey::LocalizedTypeDescription);
    const auto* size = values.get<std::uint64_t>(AttributeKey::FileSize);
    if (!size)
        return note;
    if (!note.empty())
        note += " · ";
    return note + services().formatters().byteCount(*size, ByteCountStyle::File, ByteCountUnit::Included);
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

PreviewContent imageContent(PreviewContent content, const std::string& path, const PreviewLimits& limits)
{
    const auto loaded = services().imageLoader().load(path,
        {.maxWidth = limits.maxImageWidth, .maxHeight = limits.maxImageHeight, .scale = limits.imageScale});
    if (!loaded.value)
        return failure(std::move(content),
            loaded.error ? errorWords(*loaded.error) : localized("It could not be read."));
    content.kind = Kind::Image;
    content.image = loaded.value;
    return content;
}

PreviewContent textContent(
    PreviewContent content, const std::string& path, const PreviewLimits& limits, bool isPlain)
{
    std::ifstream file(path, std::ios::binary);
    // One byte more than is shown tells whether there is more.
    std::string bytes(limits.maxTextBytes + 1, '\0');
    file.read(bytes.data(), static_cast<std::streamsize>(bytes.size()));
    if (file.bad() || (file.fail() && !file.eof()))
        return failure(std::move(content), localized("It could not be read."));
    const auto count = static_cast<std::size_t>(file.gcount());
    const bool isCut = count > limits.maxTextBytes;
    bytes.resize(isCut ? limits.maxTextBytes : count);
    content.kind = Kind::Text;
    content.text = decodedText(bytes, isCut ? TextEnd::Cut : TextEnd::Whole);
    content.isMonospaced = !isPlain;
    content.note = isCut ? localized("Only the beginning of this document is shown.") : std::string();
    return content;
}

PreviewContent readContent(const Url& url, const AttributeMap& values, const PreviewLimits& limits)
{
    auto content = summary(url, values);
    if (isInCloud(values)) {
        content.kind = Kind::InCloud;
        content.note = localized("This document is in the cloud. It is not downloaded yet.");
        return content;
    }
    // Opening anything but a regular file could wait for ever.
    const auto type = services().fileSystem().typeOfItem(url.path());
    if (!type)
        return failure(std::move(content), localized("It is no longer there."));
    if (*type != FileType::Regular)
        return content;
    if (isOfKind(values, typeIdentifier::image))
        return imageContent(std::move(content), url.path(), limits);
    if (isOfKind(values, typeIdentifier::text)) {
        const auto* identifier = values.get<std::string>(AttributeKey::TypeIdentifier);
        return textContent(std::move(content), url.path(), limits, *identifier == "public.plain-text");
    }
    return content;
}

} // namespace

PreviewLimits previewLimitsForMainScreen()
{
    PreviewLimits limits;
    const auto& screen = ui::Screen::main();
    if (!screen)
        return limits;
    limits.imageScale = screen->scale;
    limits.maxImageWidth = static_cast<int>(screen->bounds.width * screen->scale * 2);
    limits.maxImageHeight = static_cast<int>(screen->bounds.height * screen->scale * 2);
    return limits;
}

PreviewContent loadPreview(const Url& url, const PreviewLimits& limits)
{
    PreviewContent content;
    const auto refused = services().fileCoordinator().coordinateReading(
        url, ReadingOptions::ImmediatelyAvailableMetadataOnly, [&](const Url& location) {
            const auto values = services().cloudDocumentService().promisedItems().promisedItemResourceValues(
                location, previewKeys);
            content = values.value
                ? readContent(location, *values, limits)
                : failure(summary(location, {}),
                    values.error ? errorWords(*values.error) : localized("It could not be read."));
        });
    return refused ? failure(summary(url, {}), errorWords(*refused)) : content;
}

} // namespace platform::components
