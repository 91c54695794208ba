// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/app/CommandLine.h"

#include "platform/Localization.h"

#include <string_view>

namespace host::gtk {

namespace {

CommandLine alone(CommandLine::Mode mode)
{
    CommandLine line;
    line.mode = mode;
    return line;
}

CommandLine invalid(const std::string& argument)
{
    auto line = alone(CommandLine::Mode::Invalid);
    line.complaint = platform::localized("Unknown option %@", {argument});
    return line;
}

} // namespace

CommandLine CommandLine::parse(int argc, const char* const* argv)
{
    CommandLine line;
    bool onlyUrls = false;
    for (int i = 1; i < argc; ++i) {
        const std::string argument = argv[i];
        if (onlyUrls || argument.empty() || argument.front() != '-') {
            line.requests.emplace_back(OpenUrl{argument});
        } else if (argument == "--") {
            onlyUrls = true;
        } else if (argument == "--help" || argument == "-h") {
            return alone(Mode::Help);
        } else if (argument == "--version") {
            return alone(Mode::Version);
        } else if (argument == "--gapplication-service") {
            line.mode = Mode::Service;
        } else if (argument == "--search") {
            OpenSearch search;
            if (i + 1 < argc)
                search.query = argv[++i];
            line.requests.emplace_back(std::move(search));
        } else if (argument == "--recent") {
            line.requests.emplace_back(OpenRecentDocument{});
        } else {
            return invalid(argument);
        }
    }
    return line;
}

std::string CommandLine::helpText()
{
    const auto option = [](const char* syntax, const char* meaning) {
        std::string text = std::string("  ") + syntax;
        text.resize(std::max<std::size_t>(text.size() + 2, 24), ' ');
        return text + platform::localized(meaning) + "\n";
    };
    return platform::localized("Usage:") + " tarrow-drive [URL...]\n"
        + option("URL", "Show a document of the drive")
        + option("--recent", "Show the document that was opened last")
        + option("--search [QUERY]", "Search the drive") + option("--help", "Show this help")
        + option("--version", "Show the version");
}

} // namespace host::gtk
