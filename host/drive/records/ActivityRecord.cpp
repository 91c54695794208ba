// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/ActivityRecord.h"

#include "host/drive/records/JsonObject.h"
#include "host/system/files/JsonFile.h"

#include <algorithm>

namespace host::drive {

using nlohmann::json;

namespace {

constexpr std::size_t longestIdentifier = 64;
constexpr std::int64_t second = 1'000'000'000;
/// The year 2262, at which nanoseconds in 64 bits end.
constexpr std::int64_t lastSecond = INT64_MAX / second;

bool isIdentifierCharacter(char c)
{
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') || c == '-';
}

std::optional<platform::Date> time(const json& record)
{
    const auto& seconds = member(record, "time");
    if (!seconds.is_number_integer() || seconds.get<std::int64_t>() < 0
        || seconds.get<std::int64_t>() > lastSecond)
        return std::nullopt;
    return platform::Date{seconds.get<std::int64_t>() * second};
}

} // namespace

bool ActivityRecord::isDevice(std::string_view identifier)
{
    return !identifier.empty() && identifier.size() <= longestIdentifier
        && std::ranges::all_of(identifier, isIdentifierCharacter);
}

std::string ActivityRecord::toJson() const
{
    json information = json::object();
    for (const auto& [key, value] : activity.userInfo) {
        if (const auto* text = value.get<std::string>())
            information[key] = *text;
    }
    return host::system::jsonText({{"v", 1}, {"device", device}, {"name", deviceName}, {"account", account},
        {"type", activity.type}, {"userInfo", std::move(information)}, {"time", time.nanoseconds / second}});
}

std::optional<ActivityRecord> ActivityRecord::parse(std::string_view text)
{
    const auto object = text.size() <= maximumFileSize ? parseJsonObject(text) : std::nullopt;
    if (!object || member(*object, "v") != 1)
        return std::nullopt;
    const auto written = drive::time(*object);
    ActivityRecord record;
    record.device = textMember(*object, "device");
    record.deviceName = textMember(*object, "name");
    record.account = textMember(*object, "account");
    record.activity.type = textMember(*object, "type");
    record.activity.isEligibleForHandOff = true;
    const auto& information = member(*object, "userInfo");
    if (!written || !isDevice(record.device) || record.account.empty() || record.activity.type.empty()
        || !information.is_object())
        return std::nullopt;
    record.time = *written;
    for (const auto& [key, value] : information.items()) {
        if (auto entry = textOf(value))
            record.activity.userInfo.emplace(key, std::move(*entry));
    }
    return record;
}

} // namespace host::drive
