// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <nlohmann/json.hpp>

#include <optional>
#include <string>
#include <string_view>

namespace host::drive {

/// Parses a text as a JSON object. Answers nothing for any other text, and for one that is nested too deep.
std::optional<nlohmann::json> parseJsonObject(std::string_view text);

/// Answers a member of an object, or null when there is none.
const nlohmann::json& member(const nlohmann::json& object, const char* key);
/// Answers a value as text, or nothing for any other type.
std::optional<std::string> textOf(const nlohmann::json& value);
/// Answers a member as text; empty when there is none or it has another type.
std::string textMember(const nlohmann::json& object, const char* key);

} // namespace host::drive
