// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/FileUtils.h"

#include "platform/Dispatch.h"
#include "platform/FileSystem.h"

namespace tarrow {

bool FileUtils::exists(const Url& url)
{
    return services().fileSystem().typeOfItem(url.path()).has_value();
}

bool FileUtils::isFile(const Url& url)
{
    const auto type = services().fileSystem().typeOfItem(url.path());
    return type && *type != platform::FileType::Directory;
}

bool FileUtils::isDir(const Url& url)
{
    return services().fileSystem().typeOfItem(url.path()) == platform::FileType::Directory;
}

std::optional<Url> FileUtils::docDir()
{
    const auto folder = services().fileSystem().userDocumentsFolder();
    return folder ? std::optional(Url::fileURL(folder->path(), platform::PathKind::Directory)) : std::nullopt;
}

std::optional<AttributeValue> FileUtils::getResourceValueForURL(
    AttributeKey key, const std::optional<Url>& url)
{
    if (!url)
        return std::nullopt;
    const auto& items = services().cloudDocumentService().promisedItems();
    const AttributeKey keys[] = {key};
    auto values = items.promisedItemResourceValues(*url, keys);
    if (!values || !values->has(key))
        values = items.resourceValues(*url, keys);
    return values && values->has(key) ? std::optional(values->value(key)) : std::nullopt;
}

void FileUtils::logFileAttributes(const std::string& path)
{
    static constexpr Operation op{"+[FileUtils logFileAttributes:]"};
    const auto attributes = services().fileSystem().attributesOfItem(path);
    if (!attributes) {
        const auto& error = attributes.error;
        op.error("Cannot get attributes of %@: %@", path,
            error ? error->text(platform::errorKey::localizedDescription) : std::nullopt);
        return;
    }
    const auto now = services().dispatch().now();
    const auto age = [&](const Date& date) {
        return static_cast<double>(now.nanoseconds - date.nanoseconds) / 1e9;
    };
    op.debug("Date Created: %@ (%lf seconds ago)", attributes->creationDate,
        attributes->creationDate ? age(*attributes->creationDate) : 0.0);
    op.debug("Date Modified: %@ (%lf seconds ago)", attributes->modificationDate,
        age(attributes->modificationDate));
    op.debug("Size: %@ bytes", attributes->size);
}

} // namespace tarrow
