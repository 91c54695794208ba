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

/// What a JSON text may be at most; a text beyond it is not parsed.
struct JsonLimits {
    std::size_t bytes = 4 * 1024 * 1024;
    int depth = 64; ///< arrays and objects within each other
};

/// A text as JSON; null for anything malformed or beyond the limits. Never throws.
std::unique_ptr<nlohmann::json> parseJson(std::string_view text, JsonLimits limits = {});
/// JSON as text. Bytes that are no UTF-8 become replacement characters; never throws.
std::string jsonText(const nlohmann::json& value);

/// A small JSON file that the program keeps. Any thread, one at a time for each file.
class JsonFile {
public:
    enum class State {
        Read, ///< there, and well
        Absent, ///< not there, or damaged and kept aside: the file may be written
        Unreadable, ///< there, but not for us now: it must not be written
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

    /// Reads the file. A damaged one is renamed to "NAME.damaged" (or ".damaged-2" and so on) and named in
    /// one line of the log, with the reason; so is one that cannot be read.
    Content read() const;
    /// Renames a file away whose JSON is well but whose meaning is damaged, as read() does.
    State setAside(std::string_view reason) const;
    /// Replaces the file (see writeFileAtomically), after making the folders that lead to it, for the user
    /// alone.
    std::optional<platform::Error> write(const nlohmann::json& value) const;

private:
    std::string _path;
    JsonLimits _limits;
};

} // namespace host::system
