// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/ContainerRecord.h"

#include "host/drive/records/JsonObject.h"

namespace host::drive {

namespace {

using nlohmann::json;
using platform::DocumentType;

std::map<std::string, std::string> readNames(const json& object)
{
    std::map<std::string, std::string> names;
    if (!object.is_object())
        return names;
    for (const auto& [language, name] : object.items()) {
        if (auto known = textOf(name); known && !known->empty())
            names.emplace(language, std::move(*known));
    }
    return names;
}

std::vector<DocumentType> readTypes(const json& list)
{
    std::vector<DocumentType> types;
    if (!list.is_array())
        return types;
    for (const auto& entry : list) {
        if (!entry.is_object())
            continue;
        DocumentType type{textOf(member(entry, "name")).value_or(""), {}};
        if (const auto& contents = member(entry, "contentTypes"); contents.is_array()) {
            for (const auto& content : contents)
                type.contentTypes.push_back(textOf(content));
        }
        types.push_back(std::move(type));
    }
    return types;
}

std::vector<std::string> readTexts(const json& list)
{
    std::vector<std::string> texts;
    if (!list.is_array())
        return texts;
    for (const auto& entry : list) {
        if (auto known = textOf(entry))
            texts.push_back(std::move(*known));
    }
    return texts;
}

} // namespace

std::optional<ContainerRecord> ContainerRecord::parse(const std::string& content)
{
    const auto object = parseJsonObject(content);
    if (!object)
        return std::nullopt;
    ContainerRecord record;
    record.names = readNames(member(*object, "names"));
    record.documentTypes = readTypes(member(*object, "documentTypes"));
    record.supportedFolderLevels = textOf(member(*object, "supportedFolderLevels"));
    record.owningApps = readTexts(member(*object, "owningApps"));
    record.iconName = textOf(member(*object, "icon"));
    return record;
}

std::string ContainerRecord::toJson() const
{
    json object{{"version", 1}, {"names", names}, {"owningApps", owningApps}};
    auto& types = object["documentTypes"] = json::array();
    for (const auto& type : documentTypes) {
        auto contents = json::array();
        for (const auto& content : type.contentTypes)
            contents.push_back(content ? json(*content) : json());
        types.push_back({{"name", type.name}, {"contentTypes", std::move(contents)}});
    }
    if (supportedFolderLevels)
        object["supportedFolderLevels"] = *supportedFolderLevels;
    if (iconName)
        object["icon"] = *iconName;
    return object.dump(2, ' ', false, json::error_handler_t::replace) + '\n';
}

std::string ContainerRecord::nameIn(const std::vector<std::string>& languages) const
{
    for (const auto& language : languages) {
        // "de" serves "de_AT", but not the other way round.
        for (const auto& known : {language, language.substr(0, language.find('_'))}) {
            if (const auto found = names.find(known); found != names.end())
                return found->second;
        }
    }
    if (const auto english = names.find("en"); english != names.end())
        return english->second;
    return names.empty() ? std::string() : names.begin()->second;
}

} // namespace host::drive
