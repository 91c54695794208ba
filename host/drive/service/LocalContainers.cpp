// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/service/LocalContainers.h"

#include "host/drive/records/SmallFile.h"
#include "host/system/files/DirectoryReader.h"
#include "host/system/files/FileVersion.h"
#include "platform/Log.h"

#include <fcntl.h>
#include <glib.h>
#include <sys/stat.h>

#include <algorithm>

namespace host::drive {

namespace {

using platform::DocumentContainer;
using platform::PathKind;
using platform::Result;
using platform::Url;
using ContainerPointer = std::shared_ptr<const DocumentContainer>;

// The name of the drive itself when its description has none.
constexpr const char* defaultContainerName = "Tarrow Drive";

bool isIdentifier(std::string_view name)
{
    return !name.empty() && !name.starts_with('.') && platform::isValidUtf8(name);
}

using Text = std::unique_ptr<char, decltype(&g_free)>;

// Answers a key for the user's order of names, without regard to case.
std::string sortKey(const std::string& name)
{
    const Text folded(g_utf8_casefold(name.c_str(), -1), &g_free);
    const Text key(g_utf8_collate_key(folded.get(), -1), &g_free);
    return key.get();
}

} // namespace

LocalContainers::LocalContainers(
    DriveLayout layout, std::vector<std::string> languages, std::shared_ptr<platform::FileChanges> changes)
    : _layout(std::move(layout))
    , _languages(std::move(languages))
    , _changes(std::move(changes))
{
}

std::string LocalContainers::defaultContainerIdentifier() const
{
    return std::string(DriveLayout::defaultContainerIdentifier);
}

std::optional<Url> LocalContainers::defaultContainerURL() const
{
    struct stat account { };
    // Somebody is signed in when the account's file exists, whatever it contains.
    if (::stat(_layout.account().c_str(), &account) != 0)
        return std::nullopt;
    return _layout.defaultContainerURL();
}

// Answers the part of a path below the documents area; empty for a path outside.
std::string_view LocalContainers::belowDocuments(const Url& url) const
{
    const std::string_view path = url.path();
    const auto& root = _layout.documents();
    if (path.size() <= root.size() + 1 || !path.starts_with(root) || path[root.size()] != '/')
        return {};
    return path.substr(root.size() + 1);
}

bool LocalContainers::isContainerTopFolder(const Url& url) const
{
    const auto below = belowDocuments(url);
    const auto slash = below.find('/');
    if (below.empty() || slash == std::string_view::npos)
        return below == DriveLayout::defaultContainerIdentifier;
    return below.substr(slash + 1) == DriveLayout::documentsFolderName
        && below.substr(0, slash) != DriveLayout::defaultContainerIdentifier;
}

std::optional<std::string> LocalContainers::containerIdentifierInURL(const Url& url) const
{
    const auto below = belowDocuments(url);
    const auto identifier = below.substr(0, below.find('/'));
    return isIdentifier(identifier) ? std::optional(std::string(identifier)) : std::nullopt;
}

std::optional<std::string> LocalContainers::pathRelativeToSyncedRoot(const Url& url) const
{
    if (url.path() == _layout.documents())
        return std::string();
    const auto below = belowDocuments(url);
    return below.empty() ? std::nullopt : std::optional(std::string(below));
}

Result<ContainerPointer> LocalContainers::containerForItem(const Url& url) const
{
    const auto identifier = containerIdentifierInURL(url);
    if (!identifier)
        return cloudError(CloudErrorCode::UnknownContainer, url.path(), "The item isn’t in the drive.");
    auto found = known(*identifier);
    if (found.damage)
        return *found.damage;
    return found.container;
}

ContainerPointer LocalContainers::containerWithIdentifier(const std::string& identifier) const
{
    struct stat folder { };
    if (!isIdentifier(identifier) || identifier.find('/') != std::string::npos
        || ::lstat(_layout.container(identifier).c_str(), &folder) != 0 || !S_ISDIR(folder.st_mode))
        return nullptr;
    return known(identifier).container;
}

bool LocalContainers::canMoveWithoutDownloading(const DocumentContainer&, const DocumentContainer&) const
{
    // All containers of the local store share one file system and one cloud, so promises can be moved between
    // them unchanged.
    return true;
}

std::optional<platform::Error> LocalContainers::deleteContents(const DocumentContainer& container)
{
    if (container.identifier == DriveLayout::defaultContainerIdentifier)
        return platform::Error(platform::FileErrorCode::Unsupported);
    // The container's description is kept, so that an app that makes documents again finds its library as it
    // was.
    return _changes->removeItem(_layout.container(container.identifier), std::nullopt);
}

std::vector<ContainerPointer> LocalContainers::allContainers() const
{
    std::vector<ContainerPointer> containers;
    const auto area = host::system::openFolder(_layout.documents());
    if (!area)
        return containers;
    host::system::DirectoryReader reader(*area);
    while (const auto entry = reader.next()) {
        if (auto container = containerWithIdentifier(std::string(entry->name)))
            containers.push_back(std::move(container));
    }
    std::ranges::sort(containers, [](const ContainerPointer& a, const ContainerPointer& b) {
        const bool aIsDefault = a->identifier == DriveLayout::defaultContainerIdentifier;
        const bool bIsDefault = b->identifier == DriveLayout::defaultContainerIdentifier;
        if (aIsDefault != bIsDefault)
            return aIsDefault;
        const auto aName = sortKey(a->localizedName), bName = sortKey(b->localizedName);
        return aName != bName ? aName < bName : a->identifier < b->identifier;
    });
    return containers;
}

LocalContainers::Signature LocalContainers::signature(const std::string& identifier) const
{
    Signature result;
    struct stat status { };
    if (::lstat(_layout.containerDescription(identifier).c_str(), &status) == 0) {
        result.inode = status.st_ino;
        result.size = static_cast<std::uint64_t>(status.st_size);
        result.modified = host::system::nanosecondsOf(status.st_mtim);
    }
    result.hasDocuments =
        ::lstat(_layout.containerDocuments(identifier).c_str(), &status) == 0 && S_ISDIR(status.st_mode);
    return result;
}

LocalContainers::Known LocalContainers::known(const std::string& identifier) const
{
    const auto now = signature(identifier);
    const std::lock_guard lock(_mutex);
    auto& entry = _known[identifier];
    if (!entry.container || entry.signature != now)
        entry = read(identifier, now);
    return entry;
}

LocalContainers::Known LocalContainers::read(const std::string& identifier, const Signature& signature) const
{
    static constexpr platform::Operation op{"-[LocalContainers readContainer:]"};
    const auto path = _layout.containerDescription(identifier);
    const auto text = readSmallFile(path, ContainerRecord::maximumFileSize);
    auto record = text ? ContainerRecord::parse(*text) : std::nullopt;
    Known result{signature, nullptr, {}};
    if (text && !record)
        result.damage = damagedRecord(path, "it does not describe a container");
    else if (!text && !text.error->is(platform::FileErrorCode::NoSuchItem))
        result.damage = *text.error;
    if (result.damage)
        op.error("Cannot use the description %@ of a container: %@", path, reasonOf(*result.damage));

    auto container = std::make_shared<DocumentContainer>();
    container->identifier = identifier;
    const auto shown = record.value_or(ContainerRecord());
    container->localizedName = shown.nameIn(_languages);
    if (container->localizedName.empty())
        container->localizedName =
            identifier == DriveLayout::defaultContainerIdentifier ? defaultContainerName : identifier;
    if (signature.hasDocuments)
        container->documentsURL = Url::fileURL(_layout.containerDocuments(identifier), PathKind::Directory);
    container->documentTypes = shown.documentTypes;
    container->supportedFolderLevels = shown.supportedFolderLevels;
    container->owningApps = shown.owningApps;
    container->iconName = shown.iconName;
    result.container = std::move(container);
    return result;
}

} // namespace host::drive
