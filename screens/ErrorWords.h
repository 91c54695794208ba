// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"
#include "screens/PlatformNames.h"

#include <string>

namespace screens {

/// Answers a sentence that tells the user why something cannot be shown. It is the error's own text where it
/// has one.
std::string errorWords(const Error& error);

/// Answers whether an error says that the item does not exist any more.
bool saysItemIsGone(const Error& error);

} // namespace screens
