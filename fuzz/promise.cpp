// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "fuzz/support/Fuzzing.h"
#include "host/drive/records/PromiseRecord.h"

using host::drive::PromiseRecord;

void fuzzing::tryInput(std::string_view input)
{
    if (const auto record = PromiseRecord::parse(input))
        require(PromiseRecord::parse(record->toJson()) == record, "a promise that is written reads the same");
    if (const auto item = PromiseRecord::itemPathFor(input))
        require(PromiseRecord::pathFor(*item) == input, "a promise and its item name each other");
}
