// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/DriveLayout.h"
#include "host/drive/service/ItemAttributes.h"
#include "platform/PromisedItems.h"

#include <memory>

namespace host::drive {

class LocalDocumentIdentifiers;
class ThumbnailCache;

/// The items of the local store: real files, and hidden promise files beside the items' places. When both
/// exist the real file counts. A promise's file name says to which item it belongs; names inside the promise
/// are never used as paths.
class LocalPromisedItems : public platform::PromisedItems {
public:
    LocalPromisedItems(DriveLayout layout, ItemAttributes attributes,
        std::shared_ptr<ThumbnailCache> thumbnails, std::shared_ptr<LocalDocumentIdentifiers> identifiers);

    std::optional<platform::Error> checkPromisedItemIsReachable(const platform::Url& url) const override;
    platform::Result<platform::AttributeMap> promisedItemResourceValues(
        const platform::Url& url, platform::AttributeKeys keys) const override;
    platform::ItemReading readItem(const platform::Url& url, platform::AttributeKeys keys) const override;
    platform::Result<platform::AttributeMap> resourceValues(
        const platform::Url& url, platform::AttributeKeys keys) const override;
    platform::Url physicalURLForPromise(const platform::Url& url) const override;
    bool isItemPromise(const platform::Url& url) const override;
    platform::Url logicalURLForPromise(const platform::Url& url) const override;
    bool isExternalDocumentReference(const platform::Url& url) const override;
    platform::Result<platform::Url> resolveExternalDocumentReference(const platform::Url& url) const override;
    platform::Result<platform::Url> resolveAliasFile(const platform::Url& url) const override;

private:
    platform::AttributeMap values(
        const platform::Url& url, const ItemFacts& facts, platform::AttributeKeys keys) const;
    void fill(platform::AttributeMap& map, const platform::Url& url, const ItemFacts& facts,
        platform::AttributeKeys keys) const;

    DriveLayout _layout;
    ItemAttributes _attributes;
    std::shared_ptr<ThumbnailCache> _thumbnails;
    std::shared_ptr<LocalDocumentIdentifiers> _identifiers;
};

} // namespace host::drive
