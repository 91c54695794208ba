// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/texts/Translate.h"

#include <libintl.h>

namespace host::system {

std::string translated(const char* key)
{
    return dgettext(textDomain, key);
}

} // namespace host::system
