// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PropertyValue.h"

#include <optional>
#include <string>

namespace host::system {

std::string base64Encoded(const platform::Data& data);
/// Nothing for a text that base64Encoded() would not have made.
std::optional<platform::Data> base64Decoded(const std::string& text);

} // namespace host::system
