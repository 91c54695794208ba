// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/DRItem.h"
#include "items/UrlResolution.h"

#include "platform/FileSystem.h"
#include "platform/TypeRegistry.h"

namespace tarrow {

namespace {

std::optional<Url> linkDestinationURL(const std::string& destination, const Url& folder)
{
    return services().cloudDocumentService().items().urlOfPath(
        destination.starts_with('/') ? destination : folder.path() + '/' + destination);
}

std::uint64_t promisedSize(const Url& url)
{
    static constexpr AttributeKey keys[] = {AttributeKey::FileSize};
    const auto values =
        services().cloudDocumentService().promisedItems().promisedItemResourceValues(url, keys);
    const auto* size = values ? values->get<std::uint64_t>(AttributeKey::FileSize) : nullptr;
    return size ? *size : 0;
}

} // namespace

bool DRItem::initFromAttributes()
{
    const auto attributes = services().fileSystem().attributesOfItem(_url.path());
    if (!attributes)
        return false;
    _localizedName = _url.lastPathComponent();
    _parentDirectoryURL = _url.deletingLastPathComponent();
    if (!readFileType(attributes->type))
        return false;
    if (_resolvedURL)
        _promiseURL = services().cloudDocumentService().promisedItems().physicalURLForPromise(*_resolvedURL);
    if (auto description = services().typeRegistry().description(_typeIdentifier))
        _localizedTypeDescription = std::move(*description);
    setSize(attributes->size);
    _creationDate = attributes->creationDate;
    _contentModificationDate = attributes->modificationDate;
    _hasHiddenExtension = attributes->extensionHidden;
    return !_localizedName.empty();
}

bool DRItem::readFileType(platform::FileType type)
{
    switch (type) {
    case platform::FileType::SymbolicLink:
        _typeIdentifier = platform::typeIdentifier::symlink;
        _isSymlink = true;
        readLinkDestination();
        return true;
    case platform::FileType::Directory:
        _typeIdentifier = platform::typeIdentifier::directory;
        _isDirectory = true;
        return true;
    case platform::FileType::Regular:
        return true;
    case platform::FileType::Other:
        break;
    }
    return false;
}

void DRItem::readLinkDestination()
{
    auto destination = services().fileSystem().destinationOfSymbolicLink(_url.path());
    if (!destination)
        return;
    _symlinkTarget = std::move(*destination.value);
    _resolvedURL = linkDestinationURL(_symlinkTarget, *_parentDirectoryURL);
}

std::uint64_t DRItem::sizeOfPackage(const std::optional<Url>& url)
{
    static constexpr Operation op{"-[DRItem sizeOfPackage:]"};
    using Continue = platform::FileSystem::Continue;
    if (!url) {
        op.error("sizeOfPackage: null URL");
        return 0;
    }
    std::uint64_t sum = 0;
    services().fileSystem().enumerateDeeply(
        *url,
        [&](const Url& entry, platform::FileType) {
            sum += promisedSize(trw_URLByResolvingPromise(entry));
            return Continue::Yes;
        },
        [](const Url& entry, const Error& error) {
            op.info("Error enumerating %@: %@", entry, error);
            return Continue::Yes;
        });
    return sum;
}

} // namespace tarrow
