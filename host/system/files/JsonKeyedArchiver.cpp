// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/files/JsonKeyedArchiver.h"

#include "host/system/files/Base64.h"
#include "host/system/files/JsonFile.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <cmath>
#include <string_view>

namespace host::system {

using nlohmann::json;
using platform::Data;
using platform::Date;
using platform::PropertyArray;
using platform::PropertyDictionary;
using platform::PropertyValue;
using platform::Url;

namespace {

constexpr int formatVersion = 1;
constexpr int maximumDepth = 32;
// A level of a dictionary takes at most three levels of JSON: the object, its list and the pair.
constexpr JsonLimits limits{64 * 1024, 3 * maximumDepth + 3};

json tagged(const char* kind, json content)
{
    return {{"$", kind}, {"v", std::move(content)}};
}

Data bytes(std::string_view text)
{
    const auto* begin = reinterpret_cast<const std::byte*>(text.data());
    return Data(begin, begin + text.size());
}

std::string text(const Data& data)
{
    return std::string(reinterpret_cast<const char*>(data.data()), data.size());
}

json encode(const PropertyValue& value);

json encodeText(const std::string& value)
{
    return platform::isValidUtf8(value) ? json(value) : tagged("bytes", base64Encoded(bytes(value)));
}

json encodeDictionary(const PropertyDictionary& dictionary)
{
    const bool isPlain = std::ranges::all_of(dictionary,
        [](const auto& entry) { return entry.first != "$" && platform::isValidUtf8(entry.first); });
    json object = json::object(), pairs = json::array();
    for (const auto& [key, value] : dictionary) {
        if (isPlain)
            object.emplace(key, encode(value));
        else
            pairs.push_back(json::array({encodeText(key), encode(value)}));
    }
    return isPlain ? object : tagged("pairs", std::move(pairs));
}

json encodeReal(double value)
{
    if (std::isfinite(value))
        return value;
    return tagged("real", std::isnan(value) ? "nan" : value > 0 ? "inf" : "-inf");
}

json encode(const PropertyValue& value)
{
    if (const auto* boolean = value.get<bool>())
        return *boolean;
    if (const auto* integer = value.get<std::int64_t>())
        return *integer;
    if (const auto* integer = value.get<std::uint64_t>())
        return tagged("unsigned", *integer);
    if (const auto* real = value.get<double>())
        return encodeReal(*real);
    if (const auto* string = value.get<std::string>())
        return encodeText(*string);
    if (const auto* data = value.get<Data>())
        return tagged("data", base64Encoded(*data));
    if (const auto* date = value.get<Date>())
        return tagged("date", date->nanoseconds);
    if (const auto* url = value.get<Url>())
        return tagged("url", url->absoluteString());
    if (const auto* dictionary = value.get<PropertyDictionary>())
        return encodeDictionary(*dictionary);
    json array = json::array();
    if (const auto* elements = value.get<PropertyArray>()) {
        for (const auto& element : *elements)
            array.push_back(encode(element));
        return array;
    }
    return nullptr;
}

using Decoded = std::optional<PropertyValue>;
Decoded decode(const json& value, int depth);

std::optional<std::string> decodeText(const json& value)
{
    if (value.is_string())
        return value.get<std::string>();
    if (!value.is_object() || value.value("$", json()) != "bytes" || !value.contains("v")
        || !value["v"].is_string())
        return std::nullopt;
    const auto data = base64Decoded(value["v"].get<std::string>());
    return data ? std::optional(text(*data)) : std::nullopt;
}

Decoded decodeArray(const json& array, int depth)
{
    PropertyArray elements;
    for (const auto& element : array) {
        auto decoded = decode(element, depth + 1);
        if (!decoded)
            return std::nullopt;
        elements.push_back(std::move(*decoded));
    }
    return PropertyValue(std::move(elements));
}

Decoded decodeObject(const json& object, int depth)
{
    PropertyDictionary dictionary;
    for (const auto& [key, value] : object.items()) {
        auto decoded = decode(value, depth + 1);
        if (!decoded)
            return std::nullopt;
        dictionary.emplace(key, std::move(*decoded));
    }
    return PropertyValue(std::move(dictionary));
}

Decoded decodePairs(const json& pairs, int depth)
{
    PropertyDictionary dictionary;
    for (const auto& pair : pairs) {
        if (!pair.is_array() || pair.size() != 2)
            return std::nullopt;
        auto key = decodeText(pair[0]);
        auto value = decode(pair[1], depth + 1);
        if (!key || !value)
            return std::nullopt;
        dictionary.emplace(std::move(*key), std::move(*value));
    }
    return PropertyValue(std::move(dictionary));
}

Decoded decodeTextual(const std::string& kind, const std::string& content)
{
    if (kind == "url") {
        auto url = Url::parse(content);
        return url ? Decoded(std::move(*url)) : std::nullopt;
    }
    if (kind == "real")
        return content == "nan" ? Decoded(std::nan("")) : Decoded(content == "inf" ? HUGE_VAL : -HUGE_VAL);
    auto data = base64Decoded(content);
    if (!data || (kind != "data" && kind != "bytes"))
        return std::nullopt;
    return kind == "data" ? Decoded(std::move(*data)) : Decoded(text(*data));
}

Decoded decodeTagged(const json& object, int depth)
{
    if (!object["$"].is_string() || !object.contains("v"))
        return std::nullopt;
    const auto kind = object["$"].get<std::string>();
    const auto& content = object["v"];
    if (kind == "pairs" && content.is_array())
        return decodePairs(content, depth);
    if (kind == "unsigned" && content.is_number_unsigned())
        return PropertyValue(content.get<std::uint64_t>());
    if (kind == "date" && content.is_number_integer())
        return PropertyValue(Date{content.get<std::int64_t>()});
    return content.is_string() ? decodeTextual(kind, content.get<std::string>()) : std::nullopt;
}

Decoded decode(const json& value, int depth)
{
    if (value.is_structured() && depth > maximumDepth)
        return std::nullopt;
    if (value.is_null())
        return PropertyValue();
    if (value.is_boolean())
        return PropertyValue(value.get<bool>());
    if (value.is_number_integer())
        return PropertyValue(value.get<std::int64_t>());
    if (value.is_number_float())
        return PropertyValue(value.get<double>());
    if (value.is_string())
        return PropertyValue(value.get<std::string>());
    if (value.is_array())
        return decodeArray(value, depth);
    return value.contains("$") ? decodeTagged(value, depth) : decodeObject(value, depth);
}

} // namespace

Data JsonKeyedArchiver::archive(const PropertyValue& value) const
{
    return bytes(jsonText({{"version", formatVersion}, {"root", encode(value)}}));
}

std::optional<PropertyValue> JsonKeyedArchiver::unarchive(const Data& data) const
{
    const auto archive = parseJson(text(data), limits);
    if (!archive || !archive->is_object() || !archive->contains("root"))
        return std::nullopt;
    const auto version = archive->find("version");
    if (version == archive->end() || *version != formatVersion)
        return std::nullopt;
    return decode((*archive)["root"], 1);
}

} // namespace host::system
