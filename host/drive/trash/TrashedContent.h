// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"

#include <optional>
#include <string>

namespace host::drive {

/// Answers the content that an identifier of the trash stands for, or nothing when it stands for an item.
std::optional<std::string> contentIn(const std::string& identifier);
/// Answers the error for an identifier that the trash does not know: FileErrorCode::NoSuchItem.
platform::Error notInTrash();

} // namespace host::drive
