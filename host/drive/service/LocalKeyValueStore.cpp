// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/service/LocalKeyValueStore.h"

#include "host/drive/records/JsonObject.h"
#include "host/drive/records/SmallFile.h"
#include "platform/Log.h"
#include "platform/Weakly.h"

#include <utility>

namespace host::drive {

namespace {

using nlohmann::json;
using platform::PropertyArray;
using platform::PropertyDictionary;
using platform::PropertyValue;
using platform::weakly;

PropertyValue valueOf(const json& value);

PropertyDictionary dictionaryOf(const json& object)
{
    PropertyDictionary dictionary;
    for (const auto& [key, value] : object.items())
        dictionary.emplace(key, valueOf(value));
    return dictionary;
}

PropertyArray arrayOf(const json& list)
{
    PropertyArray array;
    for (const auto& value : list)
        array.push_back(valueOf(value));
    return array;
}

PropertyValue valueOf(const json& value)
{
    switch (value.type()) {
    case json::value_t::boolean:
        return value.get<bool>();
    case json::value_t::number_unsigned:
        return value.get<std::uint64_t>();
    case json::value_t::number_integer:
        return value.get<std::int64_t>();
    case json::value_t::number_float:
        return value.get<double>();
    case json::value_t::string:
        return value.get<std::string>();
    case json::value_t::array:
        return arrayOf(value);
    case json::value_t::object:
        return dictionaryOf(value);
    default:
        return {};
    }
}

PropertyDictionary readValues(const std::string& path)
{
    static constexpr platform::Operation op{"-[LocalKeyValueStore readValues]"};
    const auto text = readSmallFile(path, LocalKeyValueStore::maximumFileSize);
    if (!text) {
        if (!text.error->is(platform::FileErrorCode::NoSuchItem))
            op.error("Cannot read %@: %{public}@", path, reasonOf(*text.error));
        return {};
    }
    const auto object = parseJsonObject(*text);
    if (!object)
        op.error("%@ is damaged: it is no JSON object", path);
    return object ? dictionaryOf(*object) : PropertyDictionary();
}

} // namespace

std::shared_ptr<LocalKeyValueStore> LocalKeyValueStore::create(
    const DriveLayout& layout, const DriveDependencies& dependencies)
{
    std::shared_ptr<LocalKeyValueStore> store(new LocalKeyValueStore(layout, dependencies));
    store->begin(dependencies);
    return store;
}

LocalKeyValueStore::LocalKeyValueStore(DriveLayout layout, const DriveDependencies& dependencies)
    : _layout(std::move(layout))
    , _notifications(dependencies.notificationCenter)
{
}

void LocalKeyValueStore::begin(const DriveDependencies& dependencies)
{
    const auto read = [weak = weak_from_this(), path = _layout.keyValueStore(),
                          isWanted = _isWanted]() -> FollowedFile::Deliver {
        if (!*isWanted)
            return [] {};
        return weakly(weak, &LocalKeyValueStore::valuesRead, readValues(path));
    };
    _file = FollowedFile::follow(
        dependencies.dispatch, _layout.keyValueStore(), "TarrowDriveAppID.keyvalue", read);
}

void LocalKeyValueStore::valuesRead(PropertyDictionary values)
{
    {
        const std::lock_guard lock(_mutex);
        if (_values == values)
            return;
        _values = std::move(values);
    }
    _notifications->post(platform::Notification::KeyValueStoreDidChangeExternally);
}

std::optional<PropertyValue> LocalKeyValueStore::objectForKey(const std::string& key) const
{
    const std::lock_guard lock(_mutex);
    if (!_values) {
        *_isWanted = true; // set before the reading, so that no change is missed in between
        _values = readValues(_layout.keyValueStore());
    }
    const auto* value = find(*_values, key);
    return value ? std::optional(*value) : std::nullopt;
}

} // namespace host::drive
