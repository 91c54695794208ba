// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "fuzz/support/Fuzzing.h"
#include "host/system/files/JsonKeyedArchiver.h"

void fuzzing::tryInput(std::string_view input)
{
    const auto* begin = reinterpret_cast<const std::byte*>(input.data());
    const host::system::JsonKeyedArchiver archiver;
    const auto value = archiver.unarchive({begin, begin + input.size()});
    if (!value)
        return;
    // A value that is not a number never equals itself, so the archives are compared.
    const auto archive = archiver.archive(*value);
    const auto again = archiver.unarchive(archive);
    require(archive.size() > 65'536 || (again && archiver.archive(*again) == archive),
        "a value that is archived reads the same");
}
