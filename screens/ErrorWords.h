// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"
#include "screens/PlatformNames.h"

#include <string>

namespace screens {

/// Why something cannot be shown, in a sentence for the person: the error's own words where it has some.
std::string errorWords(const Error& error);

/// Whether an error says that the item is not there any more.
bool saysItemIsGone(const Error& error);

} // namespace screens
