// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>
#include <vector>

namespace testing_support {

/// Answers a PDF document with a line of text on each page of 200 by 300 points, 50 points from the left and
/// 200 from the bottom. It has no index, so readers rebuild one.
inline std::string simplePdf(const std::vector<std::string>& pages, const std::string& trailer = {})
{
    std::string objects = "%PDF-1.4\n1 0 obj<</Type/Catalog/Pages 2 0 R>>endobj\n"
                          "3 0 obj<</Type/Font/Subtype/Type1/BaseFont/Helvetica>>endobj\n",
                kids;
    for (std::size_t i = 0; i < pages.size(); ++i) {
        const auto page = std::to_string(10 + 2 * i), content = std::to_string(11 + 2 * i);
        const std::string drawing = "BT /F 20 Tf 50 200 Td (" + pages[i] + ") Tj ET";
        kids += page + " 0 R ";
        objects += page + " 0 obj<</Type/Page/Parent 2 0 R/MediaBox[0 0 200 300]/Contents " + content
            + " 0 R/Resources<</Font<</F 3 0 R>>>>>>endobj\n" + content + " 0 obj<</Length "
            + std::to_string(drawing.size()) + ">>stream\n" + drawing + "\nendstream endobj\n";
    }
    objects += "2 0 obj<</Type/Pages/Kids[" + kids + "]/Count " + std::to_string(pages.size()) + ">>endobj\n";
    return objects + "trailer<</Root 1 0 R" + trailer + ">>\n%%EOF\n";
}

/// Answers a PDF document that opens only with a password.
inline std::string passwordPdf()
{
    const std::string hash(64, '1');
    return simplePdf({"secret"},
        "/Encrypt<</Filter/Standard/V 1/R 2/Length 40/P -4/O<" + hash + ">/U<" + hash
            + ">>>/ID[<00112233445566778899AABBCCDDEEFF><00112233445566778899AABBCCDDEEFF>]");
}

} // namespace testing_support
