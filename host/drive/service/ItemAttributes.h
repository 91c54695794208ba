// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/ItemFacts.h"
#include "host/system/files/DriveNames.h"
#include "platform/DocumentContainers.h"
#include "platform/Localization.h"
#include "platform/ThumbnailMaker.h"
#include "platform/TypeRegistry.h"

#include <memory>

namespace host::drive {

/// Turns the facts of an item into the values of its attributes.
class ItemAttributes {
public:
    /// The extension of alias files. Their kind is called "Alias" in every language.
    static constexpr std::string_view aliasExtension = system::aliasExtension;
    static constexpr std::string_view aliasType = system::aliasType;

    /// `localization` may be null; names are not translated then.
    ItemAttributes(std::shared_ptr<const platform::TypeRegistry> types,
        std::shared_ptr<const platform::DocumentContainers> containers,
        std::shared_ptr<const platform::Localization> localization, platform::Url defaultContainer);

    /// Puts the values of the keys into a map, for an item that is downloaded or promised. A key without a
    /// value for the item is left out, and so is the thumbnail map.
    void fill(platform::AttributeMap& map, const platform::Url& url, const ItemFacts& facts,
        platform::AttributeKeys keys) const;

    /// Answers what a thumbnail of the item can be made of, judged by its name; nothing for an item that is
    /// not downloaded.
    platform::ThumbnailContent thumbnailContent(const platform::Url& url, const ItemFacts& facts) const;

private:
    struct Kind {
        std::string type;
        bool isDirectory;
        bool isPackage;
    };
    Kind kind(const platform::Url& url, const ItemFacts& facts) const;
    std::string localizedName(const platform::Url& url, const ItemFacts& facts) const;
    std::optional<std::string> description(const std::string& type) const;
    void set(platform::AttributeMap& map, platform::AttributeKey key, const platform::Url& url,
        const ItemFacts& facts, const Kind& kind) const;

    std::shared_ptr<const platform::TypeRegistry> _types;
    std::shared_ptr<const platform::DocumentContainers> _containers;
    std::shared_ptr<const platform::Localization> _localization;
    platform::Url _defaultContainer;
};

} // namespace host::drive
