// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/service/LocalPromisedItems.h"

#include "host/drive/identity/LocalDocumentIdentifiers.h"
#include "host/drive/records/LinkRecords.h"
#include "host/drive/records/SmallFile.h"
#include "host/drive/service/ThumbnailCache.h"

#include <algorithm>

namespace host::drive {

namespace {

using platform::AttributeKey;
using platform::AttributeMap;
using platform::Error;
using platform::Result;
using platform::Url;

bool isReferenceName(const Url& url)
{
    const std::string_view path = url.path();
    return path.size() > referenceExtension.size() + 2 && path.ends_with(referenceExtension)
        && path[path.size() - referenceExtension.size() - 1] == '.'
        && path[path.size() - referenceExtension.size() - 2] != '/';
}

} // namespace

LocalPromisedItems::LocalPromisedItems(DriveLayout layout, ItemAttributes attributes,
    std::shared_ptr<ThumbnailCache> thumbnails, std::shared_ptr<LocalDocumentIdentifiers> identifiers)
    : _layout(std::move(layout))
    , _attributes(std::move(attributes))
    , _thumbnails(std::move(thumbnails))
    , _identifiers(std::move(identifiers))
{
}

std::optional<Error> LocalPromisedItems::checkPromisedItemIsReachable(const Url& url) const
{
    // A promise exists even when it cannot be used.
    auto facts = lookAtItem(url.path());
    return facts.presence == ItemFacts::Presence::Missing ? std::move(facts.error) : std::nullopt;
}

Result<AttributeMap> LocalPromisedItems::promisedItemResourceValues(
    const Url& url, platform::AttributeKeys keys) const
{
    const auto facts = lookAtItem(url.path());
    return facts.error ? Result<AttributeMap>(*facts.error) : values(url, facts, keys);
}

platform::ItemReading LocalPromisedItems::readItem(const Url& url, platform::AttributeKeys keys) const
{
    auto facts = lookAtItem(url.path());
    if (facts.presence == ItemFacts::Presence::Missing)
        return {std::move(facts.error), {}, url, {}};
    const bool isPromised = facts.presence == ItemFacts::Presence::Promised;
    platform::ItemReading reading{{}, {}, isPromised ? Url::fileURL(facts.promisePath) : url, {}};
    if (facts.error) {
        reading.values.error = std::move(facts.error);
        return reading;
    }
    fill(reading.values.value.emplace(), url, facts, keys);
    // Rows are read again when their folder changes, so moves by other programs are noticed here.
    if (const auto identifier =
            isPromised ? facts.promise.documentIdentifier : facts.marks.documentIdentifier)
        _identifiers->seen(identifier, url.path());
    reading.tagNames = std::move(isPromised ? facts.promise.tags : facts.marks.tags);
    return reading;
}

Result<AttributeMap> LocalPromisedItems::resourceValues(const Url& url, platform::AttributeKeys keys) const
{
    const auto facts = lookAtFile(url.path());
    return facts.error ? Result<AttributeMap>(*facts.error) : values(url, facts, keys);
}

AttributeMap LocalPromisedItems::values(
    const Url& url, const ItemFacts& facts, platform::AttributeKeys keys) const
{
    AttributeMap map;
    fill(map, url, facts, keys);
    return map;
}

void LocalPromisedItems::fill(
    AttributeMap& map, const Url& url, const ItemFacts& facts, platform::AttributeKeys keys) const
{
    _attributes.fill(map, url, facts, keys);
    if (std::ranges::find(keys, AttributeKey::ThumbnailMap) == keys.end())
        return;
    const auto modified = facts.modified();
    if (!modified)
        return;
    const auto content = _attributes.thumbnailContent(url, facts);
    if (auto thumbnails = _thumbnails->thumbnails(url, *modified, content); !thumbnails.empty())
        map.set(AttributeKey::ThumbnailMap, std::move(thumbnails));
}

Url LocalPromisedItems::physicalURLForPromise(const Url& url) const
{
    if (existsOnDisk(url.path()).value_or(true))
        return url;
    auto promise = PromiseRecord::pathFor(url.path());
    return existsOnDisk(promise).value_or(false) ? Url::fileURL(promise) : url;
}

bool LocalPromisedItems::isItemPromise(const Url& url) const
{
    // A promise that cannot be looked at stands for its item all the same.
    return PromiseRecord::itemPathFor(url.path()) && existsOnDisk(url.path()).value_or(true);
}

Url LocalPromisedItems::logicalURLForPromise(const Url& url) const
{
    const auto item = PromiseRecord::itemPathFor(url.path());
    return item && isItemPromise(url) ? Url::fileURL(*item) : url;
}

bool LocalPromisedItems::isExternalDocumentReference(const Url& url) const
{
    return isReferenceName(url) && readReference(url.path(), _layout);
}

Result<Url> LocalPromisedItems::resolveExternalDocumentReference(const Url& url) const
{
    if (!isReferenceName(url))
        return cloudError(
            CloudErrorCode::DamagedRecord, url.path(), "The item doesn’t stand for another one.");
    return readReference(url.path(), _layout);
}

Result<Url> LocalPromisedItems::resolveAliasFile(const Url& url) const
{
    auto target = readAlias(url.path(), _layout);
    if (!target)
        return target;
    if (const auto missing = checkPromisedItemIsReachable(*target))
        return *missing;
    return target;
}

} // namespace host::drive
