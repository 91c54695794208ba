// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "fuzz/support/Fuzzing.h"
#include "host/drive/records/AccountRecord.h"

using host::drive::AccountRecord;

void fuzzing::tryInput(std::string_view input)
{
    const auto record = AccountRecord::parse(std::string(input), "account.json");
    if (!record)
        return;
    require(!record->identity.empty(), "an account has an identity");
    const auto again = AccountRecord::parse(record->toJson(), "account.json");
    require(again && *again == *record, "an account that is written reads the same");
}
