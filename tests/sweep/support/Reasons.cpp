// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/sweep/support/Reasons.h"

#include "platform/Error.h"

#include <algorithm>
#include <cerrno>
#include <iterator>

namespace sweep_tests {

namespace {

/// What a sentence for an error must contain.
constexpr struct {
    int errorNumber;
    const char* words;
} meanings[] = {
    {ENOSPC, "There isn’t enough space for "},
    {EIO, "The storage that holds "},
    {EACCES, "You don’t have permission to use "},
    {EMFILE, "because too many files are open"},
};

/// The beginning of the domains of all errors.
constexpr std::string_view platformDomains = "app.tarrow.Drive.";

/// Answers the last line in which the program names the domain of an error; the others are its log.
std::string lastReport(const std::string& said)
{
    std::string found;
    for (std::size_t start = 0; start < said.size();) {
        const auto end = std::min(said.find('\n', start), said.size());
        if (said.compare(start, platformDomains.size(), platformDomains) == 0)
            found = said.substr(start, end - start);
        start = end + 1;
    }
    return found;
}

} // namespace

std::string faultOfReason(const Ending& ending, int errorNumber)
{
    const auto report = lastReport(ending.said);
    const auto* meaning =
        std::ranges::find(meanings, errorNumber, [](const auto& m) { return m.errorNumber; });
    const auto hasCode = [&](std::string_view domain, int code) {
        return report.starts_with(std::string(domain) + " code " + std::to_string(code) + ": ");
    };
    const bool isCode = hasCode(platform::errorDomain::system, errorNumber)
        || hasCode(platform::errorDomain::file, static_cast<int>(platform::FileErrorCode::Cancelled));
    // That the drive's own files cannot be used is true of every error of one of them.
    if (report.starts_with(std::string(platform::errorDomain::system))
        && report.find("The drive’s own files") != std::string::npos && report.ends_with("can’t be used."))
        return {};
    const bool isMeant = meaning != std::end(meanings) && report.find(meaning->words) != std::string::npos;
    return isCode && isMeant ? std::string() : "it says \"" + report + '"';
}

} // namespace sweep_tests
