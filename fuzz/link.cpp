// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "fuzz/support/Fuzzing.h"
#include "host/drive/records/LinkRecords.h"

using host::drive::DriveLayout;

void fuzzing::tryInput(std::string_view input)
{
    static const auto layout = DriveLayout::at("/home/mira/drive");
    const auto path = writeFile(folder() + "/link", input);
    const auto reference = host::drive::readReference(path, layout);
    require(!reference || reference->isWithin(layout.documentsURL()), "a reference stays in the drive");
    if (const auto alias = host::drive::readAlias(path, layout))
        require(alias->path().find('\0') == std::string::npos, "a path has no NUL");
}
