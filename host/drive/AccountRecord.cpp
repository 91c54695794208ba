#include "host/drive/AccountRecord.h"

#include "host/drive/SmallFile.h"

#include <glib.h>
#include <nlohmann/json.hpp>

namespace host::drive {

namespace {

using nlohmann::json;
using platform::Result;
using platform::StorageOffer;

std::string text(const json& object, const char* key)
{
    const auto found = object.find(key);
    return found != object.end() && found->is_string() ? found->get<std::string>() : std::string();
}

int integer(const json& object, const char* key)
{
    const auto found = object.find(key);
    return found != object.end() && found->is_number_integer() ? found->get<int>() : 0;
}

bool flag(const json& object, const char* key)
{
    const auto found = object.find(key);
    return found != object.end() && found->is_boolean() && found->get<bool>();
}

std::optional<StorageOffer> offer(const json& account)
{
    const auto found = account.find("storageOffer");
    if (found == account.end() || !found->is_object())
        return std::nullopt;
    StorageOffer result;
    result.level = integer(*found, "level");
    result.storageIsLow = flag(*found, "storageIsLow");
    result.buttonTitle = text(*found, "buttonTitle");
    if (const auto link = found->find("link"); link != found->end() && link->is_object())
        result.link = {integer(*link, "action"), text(*link, "target")};
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
    const auto account = json::parse(content, nullptr, false);
    if (!account.is_object())
        return damagedRecord(path, "it does not hold an account");
    AccountRecord record{text(account, "identity"), text(account, "displayName"), offer(account)};
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
