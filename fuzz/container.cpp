// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "fuzz/support/Fuzzing.h"
#include "host/drive/records/ContainerRecord.h"

using host::drive::ContainerRecord;

void fuzzing::tryInput(std::string_view input)
{
    const auto record = ContainerRecord::parse(std::string(input));
    if (!record)
        return;
    const auto again = ContainerRecord::parse(record->toJson());
    require(again && again->toJson() == record->toJson(), "a description that is written reads the same");
    require(record->nameIn({"de_AT", ""}).empty() == record->names.empty(), "any name is better than none");
}
