// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <nlohmann/json.hpp>

#include <optional>
#include <string>
#include <string_view>

namespace host::drive {

/// A text as a JSON object; nothing for anything else, and for what is nested too deep.
std::optional<nlohmann::json> parseJsonObject(std::string_view text);

/// A member of an object; null when there is none.
const nlohmann::json& member(const nlohmann::json& object, const char* key);
/// A value as text; nothing for any other kind.
std::optional<std::string> textOf(const nlohmann::json& value);
/// A member as text; empty when there is none or it is of another kind.
std::string textMember(const nlohmann::json& object, const char* key);

} // namespace host::drive
