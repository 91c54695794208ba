// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/texts/DisplayableText.h"

#include <glib.h>

#include <memory>

namespace host::system {

std::string displayableText(std::string_view bytes)
{
    const std::unique_ptr<char, decltype(&g_free)> valid(
        g_utf8_make_valid(bytes.empty() ? "" : bytes.data(), static_cast<gssize>(bytes.size())), g_free);
    return valid.get();
}

} // namespace host::system
