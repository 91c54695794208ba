#include "platform/components/ListOrder.h"

#include "platform/CloudDocumentService.h"
#include "platform/FileSystem.h"
#include "platform/Services.h"
#include "platform/TypeRegistry.h"
#include "platform/components/DisplayName.h"

#include <algorithm>
#include <limits>
#include <map>
#include <numeric>
#include <string>
#include <utility>

namespace platform::components {

namespace {

/// What cannot be known sorts before everything that can.
constexpr std::int64_t unknown = std::numeric_limits<std::int64_t>::min();

bool isFolder(FolderEntryKind kind)
{
    return kind == FolderEntryKind::Folder || kind == FolderEntryKind::Library;
}

std::int64_t sizeOf(std::uint64_t bytes)
{
    constexpr auto most = static_cast<std::uint64_t>(std::numeric_limits<std::int64_t>::max());
    return static_cast<std::int64_t>(std::min(bytes, most));
}

std::int64_t lookAtPromise(const Url& url, OrderKey key)
{
    constexpr AttributeKey keys[] = {AttributeKey::ContentModificationDate, AttributeKey::FileSize};
    const auto values =
        services().cloudDocumentService().promisedItems().promisedItemResourceValues(url, keys);
    if (!values)
        return unknown;
    const auto* date = values->get<Date>(AttributeKey::ContentModificationDate);
    const auto* size = values->get<std::uint64_t>(AttributeKey::FileSize);
    if (key == OrderKey::Date)
        return date ? date->nanoseconds : unknown;
    return size ? sizeOf(*size) : unknown;
}

std::int64_t lookAt(const FolderSnapshot& snapshot, std::size_t index, OrderKey key)
{
    const auto entry = snapshot.entry(index);
    const auto url = snapshot.url(index);
    if (entry.isPromise)
        return lookAtPromise(url, key);
    const auto attributes = services().fileSystem().attributesOfItem(url.path());
    if (!attributes)
        return unknown;
    if (key == OrderKey::Date)
        return attributes->modificationDate.nanoseconds;
    return isFolder(entry.kind) ? unknown : sizeOf(attributes->size);
}

/// A number for the kind of each entry, in the order of the kinds' descriptions.
class Kinds {
public:
    explicit Kinds(const FolderSnapshot& snapshot)
    {
        for (std::size_t i = 0; i < snapshot.count(); ++i)
            _ranks.try_emplace(nameOf(snapshot.entry(i)));
        std::int64_t rank = 0;
        for (auto& [name, place] : _ranks)
            place = rank++;
    }
    std::int64_t rank(const FolderEntry& entry) { return _ranks.at(nameOf(entry)); }

private:
    const std::string& nameOf(const FolderEntry& entry)
    {
        static const std::string folder = "\x01", link = "\x02";
        if (isFolder(entry.kind))
            return folder;
        if (entry.kind == FolderEntryKind::Link)
            return link;
        const std::string extension(nameExtension(entry.name));
        const auto known = _namesByExtension.find(extension);
        if (known != _namesByExtension.end())
            return known->second;
        const auto& types = services().typeRegistry();
        const auto type = types.typeForExtension(extension);
        const auto described = type ? types.description(*type) : std::nullopt;
        return _namesByExtension.emplace(extension, described.value_or(extension)).first->second;
    }

    std::map<std::string, std::int64_t> _ranks;
    std::map<std::string, std::string> _namesByExtension;
};

std::vector<std::int64_t> keysOf(const FolderSnapshot& snapshot, OrderKey key)
{
    std::vector<std::int64_t> keys(snapshot.count());
    if (key == OrderKey::Name) {
        std::iota(keys.begin(), keys.end(), 0);
    } else if (key == OrderKey::Kind) {
        Kinds kinds(snapshot);
        for (std::size_t i = 0; i < keys.size(); ++i)
            keys[i] = kinds.rank(snapshot.entry(i));
    } else {
        for (std::size_t i = 0; i < keys.size(); ++i)
            keys[i] = lookAt(snapshot, i, key);
    }
    return keys;
}

} // namespace

ListOrder ListOrder::sortedBy(OrderKey chosen) const
{
    const bool largeFirst = chosen == OrderKey::Date || chosen == OrderKey::Size;
    return {chosen, largeFirst ? OrderDirection::Descending : OrderDirection::Ascending, grouping};
}

std::vector<std::uint32_t> orderedIndexes(const FolderSnapshot& snapshot, const ListOrder& order)
{
    const auto keys = keysOf(snapshot, order.key);
    const bool groups = order.grouping == FolderGrouping::FoldersFirst;
    const bool descends = order.direction == OrderDirection::Descending;
    std::vector<bool> isLater(keys.size());
    for (std::size_t i = 0; groups && i < keys.size(); ++i)
        isLater[i] = !isFolder(snapshot.entry(i).kind);
    std::vector<std::uint32_t> indexes(keys.size());
    std::iota(indexes.begin(), indexes.end(), 0U);
    std::ranges::stable_sort(indexes, [&](std::uint32_t a, std::uint32_t b) {
        if (isLater[a] != isLater[b])
            return static_cast<bool>(isLater[b]);
        return descends ? keys[b] < keys[a] : keys[a] < keys[b];
    });
    return indexes;
}

} // namespace platform::components
