// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/Error.h"

namespace platform {

Error::Error(std::string_view domain, int code, PropertyDictionary userInfo)
    : _data(std::make_shared<Data>(Data{std::string(domain), code, std::move(userInfo)}))
{
}

std::optional<std::string> Error::text(std::string_view key) const
{
    const auto* value = find(_data->userInfo, key);
    const auto* text = value ? value->get<std::string>() : nullptr;
    return text ? std::optional(*text) : std::nullopt;
}

bool Error::is(FileErrorCode code) const
{
    return _data->domain == errorDomain::file && _data->code == static_cast<int>(code);
}

std::string Error::debugDescription() const
{
    return _data->domain + " code " + std::to_string(_data->code) + ": "
        + text(errorKey::localizedDescription).value_or("no description");
}

bool Error::operator==(const Error& other) const
{
    return _data == other._data
        || (_data->domain == other._data->domain && _data->code == other._data->code
            && _data->userInfo == other._data->userInfo);
}

} // namespace platform
