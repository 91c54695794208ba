// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/LinkRecords.h"

#include "host/drive/records/JsonObject.h"
#include "host/drive/records/SmallFile.h"

namespace host::drive {

namespace {

using nlohmann::json;
using platform::Result;
using platform::Url;

constexpr std::size_t longestPath = 4096; // PATH_MAX

Result<json> readObject(const std::string& path)
{
    const auto content = readSmallFile(path, maximumLinkRecordSize);
    if (!content)
        return *content.error;
    auto object = parseJsonObject(*content);
    if (!object)
        return damagedRecord(path, "it does not hold a reference");
    return std::move(*object);
}

bool isPlainAbsolutePath(std::string_view path)
{
    return path == "/" || (path.starts_with('/') && isPlainRelativePath(path.substr(1)));
}

} // namespace

bool isPlainRelativePath(std::string_view path)
{
    if (path.empty() || path.size() > longestPath || path.find('\0') != std::string_view::npos)
        return false;
    while (true) {
        const auto slash = path.find('/');
        const auto name = path.substr(0, slash);
        if (name.empty() || name == "." || name == "..")
            return false;
        if (slash == std::string_view::npos)
            return true;
        path.remove_prefix(slash + 1);
    }
}

std::string referenceJson(const std::string& container, const std::string& path)
{
    return json{{"version", 1}, {"container", container}, {"path", path}}.dump(2) + '\n';
}

std::string aliasJson(const std::string& path)
{
    return json{{"version", 1}, {"path", path}}.dump(2) + '\n';
}

Result<Url> readReference(const std::string& path, const DriveLayout& layout)
{
    const auto object = readObject(path);
    if (!object)
        return *object.error;
    const auto container = textMember(*object, "container");
    const auto target = textMember(*object, "path");
    if (!isPlainRelativePath(container) || container.find('/') != std::string::npos)
        return damagedRecord(path, "it names no container");
    if (!isPlainRelativePath(target))
        return damagedRecord(path, "it leads out of its container");
    return Url::fileURL(layout.containerDocuments(container) + '/' + target);
}

Result<Url> readAlias(const std::string& path, const DriveLayout& layout)
{
    const auto object = readObject(path);
    if (!object)
        return *object.error;
    const auto target = textMember(*object, "path");
    if (isPlainAbsolutePath(target))
        return Url::fileURL(target);
    if (!isPlainRelativePath(target))
        return damagedRecord(path, "it leads out of the documents area");
    return Url::fileURL(layout.documents() + '/' + target);
}

} // namespace host::drive
