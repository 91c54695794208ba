// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/PromiseRecord.h"

#include "host/drive/records/JsonScanner.h"
#include "host/system/files/ItemPaths.h"

#include <nlohmann/json.hpp>

namespace host::drive {

namespace {

using platform::Date;
using platform::SharedItemRole;

// Nanoseconds in 64 bits reach from 1677 to 2262; a year beyond does not fit and is unknown.
std::optional<Date> date(std::optional<std::int64_t> nanoseconds)
{
    return nanoseconds ? std::optional(Date{*nanoseconds}) : std::nullopt;
}

std::optional<std::uint64_t> plausibleSize(std::optional<std::int64_t> size)
{
    return size && *size >= 0 ? std::optional(static_cast<std::uint64_t>(*size)) : std::nullopt;
}

PromiseRecord::Kind kindNamed(std::string_view name)
{
    return name == "directory" ? PromiseRecord::Kind::Directory
        : name == "package"    ? PromiseRecord::Kind::Package
                               : PromiseRecord::Kind::File;
}

std::vector<std::string> readTags(JsonScanner& scanner)
{
    std::vector<std::string> tags;
    if (scanner.peek() != '[') {
        scanner.skip();
        return tags;
    }
    scanner.beginArray();
    while (scanner.nextElement()) {
        if (auto tag = scanner.text(); tag && !tag->empty())
            tags.push_back(std::move(*tag));
    }
    return tags;
}

void readMember(PromiseRecord& record, std::string_view key, JsonScanner& scanner)
{
    if (key == "size")
        record.size = plausibleSize(scanner.integer());
    else if (key == "created")
        record.created = date(scanner.integer());
    else if (key == "modified")
        record.modified = date(scanner.integer());
    else if (key == "kind")
        record.kind = kindNamed(scanner.text().value_or(""));
    else if (key == "type")
        record.type = scanner.text().value_or("");
    else if (key == "shared")
        record.shared = scanner.boolean().value_or(false);
    else if (key == "role")
        record.role = roleNamed(scanner.text().value_or(""));
    else if (key == "extensionHidden")
        record.extensionHidden = scanner.boolean().value_or(false);
    else if (key == "documentIdentifier") {
        const auto identifier = scanner.integer().value_or(0);
        record.documentIdentifier =
            identifier > 0 && identifier <= UINT32_MAX ? static_cast<std::uint32_t>(identifier) : 0;
    } else if (key == "tags")
        record.tags = readTags(scanner);
    else if (key == "content")
        record.content = scanner.text().value_or("");
    else
        scanner.skip();
}

} // namespace

std::optional<SharedItemRole> roleNamed(std::string_view name)
{
    if (name == "owner")
        return SharedItemRole::Owner;
    return name == "participant" ? std::optional(SharedItemRole::Participant) : std::nullopt;
}

const char* nameOf(SharedItemRole role)
{
    return role == SharedItemRole::Owner ? "owner" : "participant";
}

std::optional<PromiseRecord> PromiseRecord::parse(std::string_view text)
{
    JsonScanner scanner(text);
    PromiseRecord record;
    if (!scanner.beginObject())
        return std::nullopt;
    while (const auto key = scanner.nextMember())
        readMember(record, *key, scanner);
    if (scanner.failed() || !scanner.atEnd())
        return std::nullopt;
    return record;
}

std::string PromiseRecord::toJson() const
{
    static constexpr const char* kinds[] = {"file", "directory", "package"};
    nlohmann::json promise{{"version", 1}, {"kind", kinds[static_cast<int>(kind)]}};
    if (size)
        promise["size"] = *size;
    if (created)
        promise["created"] = created->nanoseconds;
    if (modified)
        promise["modified"] = modified->nanoseconds;
    if (!type.empty())
        promise["type"] = type;
    if (shared)
        promise["shared"] = true;
    if (role)
        promise["role"] = nameOf(*role);
    if (extensionHidden)
        promise["extensionHidden"] = true;
    if (documentIdentifier != 0)
        promise["documentIdentifier"] = documentIdentifier;
    if (!tags.empty())
        promise["tags"] = tags;
    if (!content.empty())
        promise["content"] = content;
    return promise.dump(-1, ' ', false, nlohmann::json::error_handler_t::replace) + '\n';
}

std::string PromiseRecord::pathFor(std::string_view itemPath)
{
    return system::promisePath(itemPath);
}

std::optional<std::string> PromiseRecord::itemPathFor(std::string_view promisePath)
{
    const auto promise = system::lastName(promisePath);
    const auto name = system::itemName(promise);
    return name == promise ? std::nullopt : std::optional(system::siblingPath(promisePath, name));
}

} // namespace host::drive
