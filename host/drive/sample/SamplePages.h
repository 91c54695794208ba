// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>
#include <vector>

namespace host::drive::sample {

/// A document of A4 pages as PDF. Each page has a heading and lines of text; a line that begins with "- " is
/// a list item, "|" separates columns.
struct Page {
    std::string heading;
    std::vector<std::string> lines;
};
std::string pagesPdf(const std::string& title, const std::vector<Page>& pages);

/// A ticket with a pattern of squares to be scanned.
std::string ticketPdf(const std::string& title, const std::vector<std::string>& lines, unsigned seed);

} // namespace host::drive::sample
