// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <optional>
#include <string>
#include <variant>
#include <vector>

namespace host::gtk {

/// The request that a start of the program makes.
struct OpenUrl {
    std::string url; ///< as it was written, without decoding
    bool operator==(const OpenUrl&) const = default;
};
struct OpenSearch {
    std::optional<std::string> query; ///< absent: the search shortcut
    bool operator==(const OpenSearch&) const = default;
};
/// The launcher's shortcut to the document that was opened last.
struct OpenRecentDocument {
    bool operator==(const OpenRecentDocument&) const = default;
};
using LaunchRequest = std::variant<OpenUrl, OpenSearch, OpenRecentDocument>;

/// The program's arguments.
struct CommandLine {
    enum class Mode { Run, Service, Help, Version, Invalid };

    Mode mode = Mode::Run;
    std::vector<LaunchRequest> requests;
    std::string complaint; ///< of Invalid: the error, in the user's language

    static CommandLine parse(int argc, const char* const* argv);
    /// Answers the text of --help in the user's language.
    static std::string helpText();
};

} // namespace host::gtk
