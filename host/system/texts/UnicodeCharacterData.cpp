// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/texts/UnicodeCharacterData.h"

#include <unicode/uchar.h>

namespace host::system {

// Non-characters are in the category of unassigned code points as well.
bool UnicodeCharacterData::isIllegal(char32_t point) const
{
    return u_charType(static_cast<UChar32>(point)) == U_UNASSIGNED;
}

bool UnicodeCharacterData::isControlOrFormat(char32_t point) const
{
    const auto type = u_charType(static_cast<UChar32>(point));
    return type == U_CONTROL_CHAR || type == U_FORMAT_CHAR;
}

} // namespace host::system
