// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"

#include <nlohmann/json_fwd.hpp>

#include <cstddef>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace host::system {

/// The limits for a JSON text. A text beyond them is not parsed.
struct JsonLimits {
    std::size_t bytes = 4 * 1024 * 1024;
    int depth = 64; ///< arrays and objects within each other
};

/// Parses a text as JSON. Answers null for a malformed text or one beyond the limits. It never throws.
std::unique_ptr<nlohmann::json> parseJson(std::string_view text, JsonLimits limits = {});
/// Answers JSON as text. Bytes that are not UTF-8 become replacement characters. It never throws.
std::string jsonText(const nlohmann::json& value);

/// A small JSON file of the program. Any thread, one at a time for each file.
class JsonFile {
public:
    enum class State {
        Read, ///< it exists and is well-formed
        Absent, ///< it is missing, or was damaged and renamed away, so it may be written
        Unreadable, ///< it exists but cannot be read now, so it must not be written
    };
    struct Content {
        State state;
        std::unique_ptr<nlohmann::json> value; ///< set when the state is Read
    };

    explicit JsonFile(std::string path, JsonLimits limits = {})
        : _path(std::move(path))
        , _limits(limits)
    {
    }

    const std::string& path() const { return _path; }

    /// Reads the file. A damaged file is renamed to "NAME.damaged" (or ".damaged-2" and so on), and one line
    /// with the reason is logged. A line is also logged for a file that cannot be read.
    Content read() const;
    /// Renames a file away, like read() does, whose JSON is well-formed but whose content is damaged.
    State setAside(std::string_view reason) const;
    /// Replaces the file (see writeFileAtomically). Missing folders above it are made, for the user alone.
    std::optional<platform::Error> write(const nlohmann::json& value) const;

private:
    std::string _path;
    JsonLimits _limits;
};

} // namespace host::system
