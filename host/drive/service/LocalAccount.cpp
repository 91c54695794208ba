// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/service/LocalAccount.h"

#include "host/drive/records/AccountRecord.h"
#include "host/drive/records/SmallFile.h"
#include "host/drive/records/StorageSpace.h"
#include "platform/Log.h"

namespace host::drive {

std::optional<platform::PropertyValue> LocalAccount::identityToken() const
{
    static constexpr platform::Operation op{"-[LocalAccount identityToken]"};
    const auto record = AccountRecord::read(_layout);
    if (record.error)
        op.error("Cannot use the account in %@: %@", _layout.account(), reasonOf(*record.error));
    if (!record)
        return std::nullopt;
    platform::Data token;
    for (const char c : record->identity)
        token.push_back(static_cast<std::byte>(c));
    return platform::PropertyValue(std::move(token));
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
