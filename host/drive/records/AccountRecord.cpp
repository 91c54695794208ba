// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/AccountRecord.h"

#include "host/drive/records/JsonObject.h"
#include "host/drive/records/SmallFile.h"

#include <glib.h>

namespace host::drive {

namespace {

using nlohmann::json;
using platform::Result;
using platform::StorageOffer;

int integer(const json& object, const char* key)
{
    const auto& value = member(object, key);
    return value.is_number_integer() ? value.get<int>() : 0;
}

bool flag(const json& object, const char* key)
{
    const auto& value = member(object, key);
    return value.is_boolean() && value.get<bool>();
}

std::optional<StorageOffer> offer(const json& account)
{
    const auto& found = member(account, "storageOffer");
    if (!found.is_object())
        return std::nullopt;
    StorageOffer result;
    result.level = integer(found, "level");
    result.storageIsLow = flag(found, "storageIsLow");
    result.buttonTitle = textMember(found, "buttonTitle");
    if (const auto& link = member(found, "link"); link.is_object())
        result.link = {integer(link, "action"), textMember(link, "target")};
    return result;
}

} // namespace

Result<AccountRecord> AccountRecord::read(const DriveLayout& layout)
{
    const auto content = readSmallFile(layout.account(), maximumFileSize);
    if (content.error && content.error->is(platform::FileErrorCode::NoSuchItem))
        return {};
    return content ? parse(*content, layout.account()) : Result<AccountRecord>(*content.error);
}

Result<AccountRecord> AccountRecord::parse(const std::string& content, const std::string& path)
{
    const auto account = parseJsonObject(content);
    if (!account)
        return damagedRecord(path, "it does not hold an account");
    AccountRecord record{
        textMember(*account, "identity"), textMember(*account, "displayName"), offer(*account)};
    if (record.identity.empty())
        return damagedRecord(path, "it names no account");
    return record;
}

std::string AccountRecord::toJson() const
{
    json account{{"version", 1}, {"identity", identity}, {"displayName", displayName}};
    if (storageOffer) {
        account["storageOffer"] = {{"level", storageOffer->level},
            {"storageIsLow", storageOffer->storageIsLow}, {"buttonTitle", storageOffer->buttonTitle},
            {"link", {{"action", storageOffer->link.action}, {"target", storageOffer->link.target}}}};
    }
    return account.dump(2, ' ', false, json::error_handler_t::replace) + '\n';
}

std::string localIdentity(const std::string& displayName)
{
    const std::unique_ptr<char, decltype(&g_free)> digest(
        g_compute_checksum_for_data(
            G_CHECKSUM_SHA256, reinterpret_cast<const guchar*>(displayName.data()), displayName.size()),
        &g_free);
    return "local-" + std::string(digest.get()).substr(0, 32);
}

} // namespace host::drive
