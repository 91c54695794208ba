// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/service/ItemAttributes.h"

#include "host/system/files/FileVersion.h"
#include "host/system/files/ItemPaths.h"
#include "host/system/texts/DisplayableText.h"

#include <algorithm>

namespace host::drive {

namespace {

using platform::AttributeKey;
using platform::AttributeMap;
using platform::AttributeValue;
using platform::DownloadingStatus;
using platform::Url;

template <typename T>
AttributeValue valueOf(const std::optional<T>& value)
{
    return value ? AttributeValue(*value) : AttributeValue();
}

bool isPromised(const ItemFacts& facts)
{
    return facts.presence == ItemFacts::Presence::Promised;
}

bool isLink(const ItemFacts& facts)
{
    return !isPromised(facts) && S_ISLNK(facts.status.stx_mode);
}

bool isRegularFile(const ItemFacts& facts)
{
    return isPromised(facts) ? facts.promise.kind == PromiseRecord::Kind::File
                             : S_ISREG(facts.status.stx_mode);
}

AttributeValue fileSize(const ItemFacts& facts)
{
    if (isPromised(facts))
        return valueOf(facts.promise.size);
    if (!isRegularFile(facts) && !isLink(facts))
        return {};
    return static_cast<std::uint64_t>(facts.status.stx_size);
}

AttributeValue creationDate(const ItemFacts& facts)
{
    return valueOf(facts.created());
}

AttributeValue downloadingStatus(const ItemFacts& facts)
{
    return isPromised(facts) ? AttributeValue(DownloadingStatus::NotDownloaded) : valueOf(facts.marks.status);
}

AttributeValue sharedRole(const ItemFacts& facts)
{
    return valueOf(isPromised(facts) ? facts.promise.role : facts.marks.role);
}

AttributeValue documentIdentifier(const ItemFacts& facts)
{
    const auto identifier =
        isPromised(facts) ? facts.promise.documentIdentifier : facts.marks.documentIdentifier;
    return identifier == 0 ? AttributeValue() : AttributeValue(std::uint64_t{identifier});
}

bool extensionHidden(const ItemFacts& facts)
{
    return isPromised(facts) ? facts.promise.extensionHidden : facts.marks.extensionHidden;
}

// Answers whether an extension is one of the drive's own small files, which means nothing to a person.
bool standsForAnother(std::string_view extension)
{
    return extension == system::referenceExtension || extension == system::aliasExtension;
}

// Answers the extension like Url::pathExtension(), without copying the name, because this runs for every row.
std::string_view extensionOf(const std::string& path)
{
    const std::string_view name = system::lastName(path);
    const auto dot = name.rfind('.');
    if (dot == std::string_view::npos || dot == 0 || name.find(' ', dot) != std::string_view::npos)
        return {};
    return name.substr(dot + 1);
}

// Replaces bytes that are not UTF-8 by the replacement character, for the screen only.
std::string displayable(std::string name)
{
    const bool isAscii = std::ranges::all_of(name, [](char c) { return static_cast<signed char>(c) >= 0; });
    if (isAscii || platform::isValidUtf8(name))
        return name;
    return system::displayableText(name);
}

} // namespace

ItemAttributes::ItemAttributes(std::shared_ptr<const platform::TypeRegistry> types,
    std::shared_ptr<const platform::DocumentContainers> containers,
    std::shared_ptr<const platform::Localization> localization, Url defaultContainer)
    : _types(std::move(types))
    , _containers(std::move(containers))
    , _localization(std::move(localization))
    , _defaultContainer(std::move(defaultContainer))
{
}

void ItemAttributes::fill(
    AttributeMap& map, const Url& url, const ItemFacts& facts, platform::AttributeKeys keys) const
{
    auto itemKind = kind(url, facts);
    bool wantsType = false;
    for (const auto key : keys) {
        wantsType = wantsType || key == AttributeKey::TypeIdentifier;
        set(map, key, url, facts, itemKind);
    }
    // The type is set last, because its text can then be moved instead of copied.
    if (wantsType)
        map.set(AttributeKey::TypeIdentifier, std::move(itemKind.type));
}

ItemAttributes::Kind ItemAttributes::kind(const Url& url, const ItemFacts& facts) const
{
    namespace types = platform::typeIdentifier;
    if (isLink(facts))
        return {std::string(types::symlink), false, false};
    const bool isDirectory = facts.isDirectory();
    if (!isDirectory && !isRegularFile(facts))
        return {std::string(types::data), false, false};
    const auto extension = extensionOf(url.path());
    if (!isDirectory && extension == aliasExtension)
        return {std::string(aliasType), false, false};
    auto named = isPromised(facts) ? facts.promise.type : std::string();
    if (named.empty() && !extension.empty())
        named = _types->typeForExtension(extension).value_or("");
    if (!isDirectory)
        return {named.empty() ? std::string(types::data) : std::move(named), false, false};
    const bool isPackage = (isPromised(facts) && facts.promise.kind == PromiseRecord::Kind::Package)
        || (!named.empty() && _types->conformsTo(named, types::package));
    if (!isPackage)
        return {std::string(types::directory), true, false};
    return {named.empty() ? std::string(types::package) : std::move(named), true, true};
}

platform::ThumbnailContent ItemAttributes::thumbnailContent(const Url& url, const ItemFacts& facts) const
{
    using platform::ThumbnailContent;
    namespace types = platform::typeIdentifier;
    if (facts.presence != ItemFacts::Presence::Here || !isRegularFile(facts))
        return ThumbnailContent::None;
    const auto type = kind(url, facts).type;
    const std::pair<std::string_view, ThumbnailContent> contents[] = {
        {types::image, ThumbnailContent::Picture}, {types::pdf, ThumbnailContent::Pages},
        {types::movie, ThumbnailContent::Film}};
    const auto* const found = std::ranges::find_if(
        contents, [&](const auto& content) { return _types->conformsTo(type, content.first); });
    return found == std::end(contents) ? ThumbnailContent::None : found->second;
}

std::optional<std::string> ItemAttributes::description(const std::string& type) const
{
    // The logic recognises aliases by this name, so it is never translated.
    if (type == aliasType)
        return "Alias";
    return _types->description(type);
}

std::string ItemAttributes::localizedName(const Url& url, const ItemFacts& facts) const
{
    if (facts.isDirectory()) {
        if (_containers->isContainerTopFolder(url)) {
            if (const auto container = _containers->containerForItem(url))
                return (*container)->localizedName;
            // A folder whose name is no identifier has no container, so it shows its own name.
            if (auto identifier = _containers->containerIdentifierInURL(url))
                return displayable(std::move(*identifier));
        }
        const auto& top = _defaultContainer.path();
        const std::string_view below =
            std::string_view(url.path())
                .substr(url.path().starts_with(top) ? std::min(top.size(), url.path().size()) : 0);
        if (_localization && (below == "/Desktop" || below == "/Documents"))
            return _localization->text(std::string(below.substr(1)));
    }
    auto name = url.lastPathComponent();
    if (const auto extension = extensionOf(url.path());
        !extension.empty() && (extensionHidden(facts) || standsForAnother(extension)))
        name.resize(name.size() - extension.size() - 1);
    return displayable(std::move(name));
}

void ItemAttributes::set(
    AttributeMap& map, AttributeKey key, const Url& url, const ItemFacts& facts, const Kind& kind) const
{
    switch (key) {
    case AttributeKey::Name:
        return map.set(key, url.lastPathComponent());
    case AttributeKey::LocalizedName:
        return map.set(key, localizedName(url, facts));
    case AttributeKey::LocalizedTypeDescription:
        if (auto text = description(kind.type))
            map.set(key, std::move(*text));
        return;
    case AttributeKey::FileSize:
    case AttributeKey::TotalFileSize:
        return map.set(key, fileSize(facts));
    case AttributeKey::CreationDate:
        return map.set(key, creationDate(facts));
    case AttributeKey::ContentModificationDate:
        if (const auto modified = facts.modified())
            map.set(key, *modified);
        return;
    case AttributeKey::IsDirectory:
        return map.set(key, kind.isDirectory);
    case AttributeKey::IsRegularFile:
        return map.set(key, isRegularFile(facts));
    case AttributeKey::IsPackage:
        return map.set(key, kind.isPackage);
    case AttributeKey::HasHiddenExtension:
        return map.set(key, extensionHidden(facts));
    case AttributeKey::ParentDirectoryURL:
        return map.set(key, url.deletingLastPathComponent());
    case AttributeKey::IsShared:
        return map.set(key, isPromised(facts) ? facts.promise.shared : facts.marks.shared);
    case AttributeKey::SharedItemRole:
        return map.set(key, sharedRole(facts));
    case AttributeKey::DownloadingStatus:
        return map.set(key, downloadingStatus(facts));
    case AttributeKey::DocumentIdentifier:
        return map.set(key, documentIdentifier(facts));
    case AttributeKey::TypeIdentifier:
    case AttributeKey::ThumbnailMap:
        return; // the callers set it
    }
}

} // namespace host::drive
