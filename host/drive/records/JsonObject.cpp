// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/JsonObject.h"

#include "host/system/files/JsonFile.h"

namespace host::drive {

using nlohmann::json;

std::optional<json> parseJsonObject(std::string_view text)
{
    auto value = host::system::parseJson(text);
    return value && value->is_object() ? std::optional(std::move(*value)) : std::nullopt;
}

const json& member(const json& object, const char* key)
{
    static const json absent;
    const auto found = object.find(key);
    return found == object.end() ? absent : *found;
}

std::optional<std::string> textOf(const json& value)
{
    return value.is_string() ? std::optional(value.get<std::string>()) : std::nullopt;
}

std::string textMember(const json& object, const char* key)
{
    return textOf(member(object, key)).value_or("");
}

} // namespace host::drive
