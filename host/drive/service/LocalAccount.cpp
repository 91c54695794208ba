// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/service/LocalAccount.h"

#include "host/drive/records/AccountRecord.h"
#include "host/drive/records/SmallFile.h"
#include "host/drive/records/StorageSpace.h"
#include "platform/Log.h"

namespace host::drive {

namespace {

platform::PropertyValue tokenOf(const std::string& identity)
{
    platform::Data token;
    for (const char c : identity)
        token.push_back(static_cast<std::byte>(c));
    return platform::PropertyValue(std::move(token));
}

} // namespace

std::optional<platform::PropertyValue> LocalAccount::identityToken() const
{
    static constexpr platform::Operation op{"-[LocalAccount identityToken]"};
    const auto record = AccountRecord::read(_layout);
    if (record.error)
        op.error("Cannot use the account in %@: %@", _layout.account(), reasonOf(*record.error));
    auto token = record ? std::optional(tokenOf(record->identity)) : std::nullopt;
    const std::lock_guard lock(_mutex);
    _known = token;
    return token;
}

std::optional<platform::PropertyValue> LocalAccount::knownIdentityToken() const
{
    {
        const std::lock_guard lock(_mutex);
        if (_known)
            return *_known;
    }
    return identityToken();
}

platform::Work LocalAccount::makeQuotaFetchOperation(
    std::function<void(platform::Result<std::int64_t>)> completion) const
{
    return [home = _layout.home(), completion = std::move(completion)] {
        const auto space = StorageSpace::of(home);
        completion(space ? platform::Result<std::int64_t>(space->free) : *space.error);
    };
}

} // namespace host::drive
