// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "drawing/FileTags.h"

#include "items/PlatformNames.h"
#include "platform/KeyValueStore.h"
#include "platform/NotificationCenter.h"

#include <memory>
#include <mutex>

namespace tarrow {

using platform::Color;
using platform::find;

namespace {

// The desktop's file manager keeps the table under these names.
constexpr auto tableKey = "PathwellTagDict";
constexpr auto versionKey = "PathwellTagDictVersion";
constexpr auto entriesKey = "PathwellTags";
constexpr auto nameKey = "n";
constexpr auto colorKey = "l";
constexpr std::uint64_t tableVersion = 2;

struct Tags {
    FileTags::ColorsByTag colors;
    std::vector<std::string> names;
};

/// Holds the table that was read last. It is replaced as a whole, so that a reader sees either the old or the
/// new table.
class Current {
public:
    /// Readings take turns, so that the table of an earlier one never replaces that of a later one.
    std::mutex reading;

    std::shared_ptr<const Tags> tags() const
    {
        const std::lock_guard lock(_mutex);
        return _tags;
    }
    void replace(std::shared_ptr<const Tags> tags)
    {
        const std::lock_guard lock(_mutex);
        _tags = std::move(tags);
    }

private:
    mutable std::mutex _mutex;
    std::shared_ptr<const Tags> _tags = std::make_shared<const Tags>();
};

Current& current()
{
    static Current instance;
    return instance;
}

std::uint64_t unsignedUnder(const PropertyDictionary& dictionary, std::string_view key)
{
    const auto* value = find(dictionary, key);
    return value ? value->asUnsigned().value_or(0) : 0;
}

void add(Tags& tags, const PropertyValue& value)
{
    const auto* entry = value.get<PropertyDictionary>();
    const auto* nameValue = entry ? find(*entry, nameKey) : nullptr;
    const auto* name = nameValue ? nameValue->get<std::string>() : nullptr;
    if (!name)
        return;
    const auto& colors = FileTags::_tagBlipColors();
    const auto index = unsignedUnder(*entry, colorKey);
    tags.names.push_back(*name);
    tags.colors.insert_or_assign(*name, colors[index < colors.size() ? index : 0]);
}

void observe()
{
    static const auto observation =
        services().notificationCenter().observe(platform::Notification::KeyValueStoreDidChangeExternally,
            [](const auto&) { FileTags::_tagColorsDidChange(); });
}

/// Answers the table. The first call reads it and begins to follow the store.
std::shared_ptr<const Tags> currentTags()
{
    static std::once_flag once;
    std::call_once(once, [] {
        observe();
        FileTags::_tagColorsDidChange();
    });
    return current().tags();
}

} // namespace

const std::array<Color, 8>& FileTags::_tagBlipColors()
{
    static constexpr std::array<Color, 8> colors{
        Color::gray(0.8F), Color::gray(0.56F), {0.20F, 0.73F, 0.36F, 1}, // green
        {0.64F, 0.34F, 0.85F, 1}, // purple
        {0.11F, 0.48F, 0.95F, 1}, // blue
        {0.96F, 0.78F, 0.10F, 1}, // yellow
        {0.91F, 0.22F, 0.22F, 1}, // red
        {0.97F, 0.55F, 0.11F, 1}, // orange
    };
    return colors;
}

std::optional<Color> FileTags::colorOfTag(std::string_view name)
{
    const auto tags = currentTags();
    const auto found = tags->colors.find(name);
    return found == tags->colors.end() ? std::nullopt : std::optional(found->second);
}

FileTags::ColorsByTag FileTags::tagColorsByTag()
{
    return currentTags()->colors;
}

std::vector<std::string> FileTags::allTags()
{
    return currentTags()->names;
}

void FileTags::_tagColorsDidChange()
{
    static constexpr Operation op{"+[FileTags _tagColorsDidChange]"};
    const std::lock_guard lock(current().reading);
    const auto stored = services().keyValueStore().objectForKey(tableKey);
    const auto* table = stored ? stored->get<PropertyDictionary>() : nullptr;
    if (const auto version = table ? unsignedUnder(*table, versionKey) : tableVersion;
        version != tableVersion) {
        op.debug("Pathwell tag dictionary has incorrect version (%lu, should be 2)", version);
        table = nullptr;
    }
    if (!table || table->empty())
        op.warning("Pathwell tag dictionary is empty");
    const auto* value = table ? find(*table, entriesKey) : nullptr;
    const auto* entries = value ? value->get<PropertyArray>() : nullptr;
    auto tags = std::make_shared<Tags>();
    for (const auto& entry : entries ? *entries : PropertyArray())
        add(*tags, entry);
    current().replace(std::move(tags));
}

} // namespace tarrow
