// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/FileUtils.h"

#include "platform/CharacterData.h"
#include "platform/TypeRegistry.h"

#include <algorithm>
#include <array>
#include <bit>

namespace tarrow {

namespace {

namespace typeIdentifier = platform::typeIdentifier;

/// Answers the content types that a container's documents may have, each once, in the order of their
/// declaration.
std::vector<std::optional<std::string>> declaredContentTypes(const DocumentContainer& container)
{
    std::vector<std::optional<std::string>> types;
    for (const auto& documentType : container.documentTypes) {
        for (const auto& type : documentType.contentTypes) {
            if (std::ranges::find(types, type) == types.end())
                types.push_back(type);
        }
    }
    return types;
}

bool accepts(const DocumentContainer& container, const std::string& extension, const std::string& type)
{
    static constexpr Operation op{"+[FileUtils isValidExtensionForContainer:]"};
    // NOLINTNEXTLINE(readability-use-anyofallof): the loop also logs what it meets
    for (const auto& declared : declaredContentTypes(container)) {
        if (!declared) {
            op.error("Expected array of strings");
        } else if (*declared == typeIdentifier::data || *declared == typeIdentifier::content) {
            op.info("Container supports all UTIs");
            return true;
        } else if (services().typeRegistry().conformsTo(type, *declared)) {
            op.info("Extension %@ conforms to UTI %@", extension, *declared);
            return true;
        }
    }
    return false;
}

/// Removes the first code point of a well-formed text and answers it.
char32_t takeCodePoint(std::string_view& text)
{
    const auto lead = static_cast<unsigned char>(text.front());
    const auto length = static_cast<std::size_t>(std::max(1, std::countl_one(lead)));
    auto point = static_cast<char32_t>(length == 1 ? lead : lead & (0x7f >> length));
    for (const char c : text.substr(1, length - 1))
        point = (point << 6) | (static_cast<unsigned char>(c) & 0x3f);
    text.remove_prefix(length);
    return point;
}

bool isLineBreak(char32_t point)
{
    return (point >= 0x0a && point <= 0x0d) || point == 0x85 || point == 0x2028 || point == 0x2029;
}

bool isAllowedInFilename(char32_t point)
{
    const auto& characters = services().characterData();
    return point != U'/' && point != U':' && !characters.isIllegal(point)
        && !characters.isControlOrFormat(point) && !isLineBreak(point);
}

} // namespace

std::optional<std::string> FileUtils::fileUTI(const Url& url)
{
    const auto extension = url.pathExtension();
    return extension.empty() ? std::nullopt : services().typeRegistry().typeForExtension(extension);
}

bool FileUtils::isAudioVideoImageFile(const Url& url)
{
    static constexpr Operation op{"+[FileUtils isAudioVideoImageFile:]"};
    const auto type = fileUTI(url);
    if (!type || type->empty())
        return false;
    for (const auto media : {std::string_view("public.image"), std::string_view("public.movie"),
             std::string_view("public.audio"), typeIdentifier::pdf}) {
        if (services().typeRegistry().conformsTo(*type, media)) {
            op.debug("isAudioVideoImageFile: Extension %@ is %@ which conforms to UTI %@",
                url.pathExtension(), *type, media);
            return true;
        }
    }
    op.debug("isAudioVideoImageFile: Extension %@ is %@ which is not.", url.pathExtension(), *type);
    return false;
}

bool FileUtils::isValidExtensionForContainer(const Url& url)
{
    const auto type = fileUTI(url);
    if (!type)
        return true;
    const auto& containers = services().cloudDocumentService().containers();
    const auto container = containers.containerForItem(url);
    if (!container || !*container)
        return false;
    if ((*container)->identifier == containers.defaultContainerIdentifier())
        return true;
    if (!(*container)->documentsURL)
        return false;
    return (*container)->documentTypes.empty() || accepts(**container, url.pathExtension(), *type);
}

bool FileUtils::isValidFilename(std::string_view name)
{
    if (name.empty() || name.starts_with('.') || !platform::isValidUtf8(name))
        return false;
    while (!name.empty()) {
        if (!isAllowedInFilename(takeCodePoint(name)))
            return false;
    }
    return true;
}

} // namespace tarrow
