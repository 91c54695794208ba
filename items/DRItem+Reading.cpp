// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/AccessScope.h"
#include "items/DRItem.h"
#include "items/UrlResolution.h"

#include "platform/FileCoordinator.h"
#include "platform/PreviewSupport.h"
#include "platform/TypeRegistry.h"

namespace tarrow {

namespace {

constexpr AttributeKey prefetchedKeys[] = {
    AttributeKey::Name,
    AttributeKey::LocalizedName,
    AttributeKey::TypeIdentifier,
    AttributeKey::LocalizedTypeDescription,
    AttributeKey::FileSize,
    AttributeKey::CreationDate,
    AttributeKey::ContentModificationDate,
    AttributeKey::IsDirectory,
    AttributeKey::IsPackage,
    AttributeKey::HasHiddenExtension,
    AttributeKey::ParentDirectoryURL,
    AttributeKey::IsShared,
    AttributeKey::SharedItemRole,
    AttributeKey::DownloadingStatus,
};

platform::PromisedItems& promisedItems()
{
    return services().cloudDocumentService().promisedItems();
}

std::string textOrEmpty(const AttributeMap& values, AttributeKey key)
{
    const auto* text = values.get<std::string>(key);
    return text ? *text : std::string();
}

bool isSharedByAnother(const AttributeMap& values)
{
    const auto* role = values.get<platform::SharedItemRole>(AttributeKey::SharedItemRole);
    return values.flag(AttributeKey::IsShared) && role && *role == platform::SharedItemRole::Participant;
}

} // namespace

void DRItem::clearValues()
{
    for (auto* url : {&_resolvedURL, &_parentDirectoryURL, &_promiseURL})
        url->reset();
    for (auto* text : {&_localizedName, &_typeIdentifier, &_localizedTypeDescription, &_symlinkTarget})
        text->clear();
    setSize(std::nullopt);
    _creationDate.reset();
    _contentModificationDate.reset();
    _thumbnail.reset();
    _thumbnailFetch.reset();
    _tags.clear();
    for (auto* flag : {&_isContainer, &_isDirectory, &_isPackage, &_thumbnailFetched, &_isBookmark,
             &_isDownloaded, &_isSymlink})
        *flag = false;
    _hasHiddenExtension = _renameable = true;
}

bool DRItem::cacheValues()
{
    clearValues();
    _resolvedURL = trw_URLByResolvingBookmark(_url);
    _isBookmark = promisedItems().isExternalDocumentReference(_url);
    if (!_resolvedURL)
        return true; // the reference is broken, so there is no location to coordinate a read for
    return readCoordinated(Url(*_resolvedURL)) || initFromAttributes();
}

bool DRItem::readCoordinated(const Url& resolved)
{
    const AccessScope access(resolved);
    bool isRead = true;
    services().fileCoordinator().coordinateReading(resolved,
        platform::ReadingOptions::ImmediatelyAvailableMetadataOnly,
        [&](const Url& location) { isRead = readValues(location); });
    if (!_promiseURL)
        _promiseURL = promisedItems().physicalURLForPromise(resolved);
    return isRead;
}

bool DRItem::readValues(const Url& location)
{
    static constexpr Operation op{"-[DRItem cacheValues]"};
    auto reading = promisedItems().readItem(location, prefetchedKeys);
    auto& values = reading.values;
    if (reading.unreachable || (values.error && values.error->is(FileErrorCode::NoSuchItem)))
        return false;
    if (!values) {
        op.warning("promisedItemResourceValuesForKeys failed on %@", location);
        values = promisedItems().resourceValues(location, prefetchedKeys);
        if (!values)
            return false;
    }
    _promiseURL = isResolvedURL(location) ? std::move(reading.physicalURL)
                                          : promisedItems().physicalURLForPromise(*_resolvedURL);
    initFromKeysAndValuesWithURL(*values, location);
    _canPreview = _resolvedURL && services().previewSupport().canPreview(*_resolvedURL);
    if (_resolvedURL)
        _tags = isResolvedURL(location) ? std::move(reading.tagNames)
                                        : promisedItems().readItem(*_resolvedURL, {}).tagNames;
    return true;
}

void DRItem::initFromKeysAndValuesWithURL(const AttributeMap& values, const Url& url)
{
    _localizedName = textOrEmpty(
        values, values.has(AttributeKey::LocalizedName) ? AttributeKey::LocalizedName : AttributeKey::Name);
    readType(values, url);
    _creationDate = values.optional<Date>(AttributeKey::CreationDate);
    _contentModificationDate = values.optional<Date>(AttributeKey::ContentModificationDate);
    _parentDirectoryURL = values.optional<Url>(AttributeKey::ParentDirectoryURL);
    readSize(values);
    _hasHiddenExtension = values.flag(AttributeKey::HasHiddenExtension);
    readContainer(values, url);
    const auto* status = values.get<platform::DownloadingStatus>(AttributeKey::DownloadingStatus);
    _isDownloaded = status && *status != platform::DownloadingStatus::NotDownloaded;
}

bool DRItem::isResolvedURL(const Url& location) const
{
    return _resolvedURL && location.isSameObject(*_resolvedURL);
}

void DRItem::readType(const AttributeMap& values, const Url& location)
{
    _typeIdentifier = textOrEmpty(values, AttributeKey::TypeIdentifier);
    auto description = services().typeRegistry().description(_typeIdentifier);
    _localizedTypeDescription =
        description ? std::move(*description) : textOrEmpty(values, AttributeKey::LocalizedTypeDescription);
    if (_typeIdentifier == platform::typeIdentifier::symlink) {
        _isSymlink = true;
        _resolvedURL = services().cloudDocumentService().items().realURL(location);
    } else if (services().formatters().equalIgnoringCase(_localizedTypeDescription, "Alias")) {
        _isSymlink = true;
        _resolvedURL = resolvePathwellAlias(_url);
    }
}

void DRItem::readSize(const AttributeMap& values)
{
    setSize(values.optional<std::uint64_t>(AttributeKey::FileSize));
    _isPackage = values.flag(AttributeKey::IsPackage);
    _isDirectory = values.flag(AttributeKey::IsDirectory) && !_isPackage;
    if (!_isPackage || _fileSize)
        return;
    if (const auto size = sizeOfPackage(_resolvedURL))
        setSize(size);
}

void DRItem::readContainer(const AttributeMap& values, const Url& location)
{
    const auto& containers = services().cloudDocumentService().containers();
    _isContainer = containers.isContainerTopFolder(location);
    _renameable = !_isContainer && !isSharedByAnother(values);
    if (!_isContainer)
        return;
    const auto container = containers.containerForItem(location);
    if (container && *container && !container.error)
        _localizedName = (*container)->localizedName;
}

void DRItem::setSize(std::optional<std::uint64_t> size)
{
    _fileSize = _friendlySize = size;
    _friendlyFileSize.clear();
}

std::optional<Url> DRItem::resolvePathwellAlias(const Url& url)
{
    static constexpr Operation op{"-[DRItem resolvePathwellAlias:]"};
    if (isPromise())
        op.warning("Pathwell Alias is promised -- unable to determine target without downloading: %@", url);
    auto target = promisedItems().resolveAliasFile(url);
    if (target.error)
        op.warning("Error resolving Alias: %@", *target.error);
    return std::move(target.value);
}

} // namespace tarrow
