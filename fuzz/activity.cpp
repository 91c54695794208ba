// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "fuzz/support/Fuzzing.h"
#include "host/drive/records/ActivityRecord.h"

using host::drive::ActivityRecord;

void fuzzing::tryInput(std::string_view input)
{
    const auto record = ActivityRecord::parse(input);
    if (!record)
        return;
    require(ActivityRecord::fileName(record->device).find('/') == std::string::npos, "a device is one file");
    const auto text = record->toJson();
    require(text.size() > ActivityRecord::maximumFileSize || ActivityRecord::parse(text) == record,
        "an activity that is written reads the same");
}
