// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <cstdio>
#include <map>
#include <string>

namespace testing_support {

/// Answers a PDF document of two pages of 200 by 300 points with an index. The first page has the text "Hello
/// wonderful" and a form: a name (called "Your name"), a check box, a choice of three towns, two radio
/// buttons of which the first is pressed, a field that must not be changed, a hidden field, and a note by
/// another person. The second page has a field for several lines.
inline std::string formPdf()
{
    const std::string widget = "<</Type/Annot/Subtype/Widget/P 4 0 R";
    const std::string text = "/DA(/Helv 12 Tf 0 g)", tick = "0 0 m 20 20 l S";
    const std::string drawing = "BT /F 20 Tf 30 40 Td (Hello wonderful) Tj ET";
    const auto stream = [](const std::string& dictionary, const std::string& content) {
        return "<<" + dictionary + "/Length " + std::to_string(content.size()) + ">>stream\n" + content
            + "\nendstream ";
    };
    const std::map<int, std::string> objects{
        {1,
            "<</Type/Catalog/Pages 2 0 R/AcroForm<</Fields[10 0 R 11 0 R 12 0 R 15 0 R 16 0 R 17 0 "
            "R]/DR<</Font"
            "<</Helv 3 0 R>>>>/DA(/Helv 12 Tf 0 g)>>>>"},
        {2, "<</Type/Pages/Kids[4 0 R 5 0 R]/Count 2>>"},
        {3, "<</Type/Font/Subtype/Type1/BaseFont/Helvetica>>"},
        {4,
            "<</Type/Page/Parent 2 0 R/MediaBox[0 0 200 300]/Contents 6 0 R/Annots[10 0 R 11 0 R 12 0 R 13 0 "
            "R "
            "14 0 R 16 0 R 17 0 R 18 0 R]/Resources<</Font<</F 3 0 R>>>>>>"},
        {5, "<</Type/Page/Parent 2 0 R/MediaBox[0 0 200 300]/Annots[19 0 R]/Resources<<>>>>"},
        {6, stream("", drawing)},
        {10, widget + "/FT/Tx/T(name)/TU(Your name)/Rect[20 250 180 270]/F 4" + text + ">>"},
        {11,
            widget
                + "/FT/Btn/T(agree)/Rect[20 220 40 240]/F 4/AS/Off/V/Off/AP<</N<</Yes 20 0 R/Off 21 0 "
                  "R>>>>>>"},
        {12,
            widget + "/FT/Ch/Ff 131072/T(town)/Opt[(Rome)(Oslo)(Bern)]/V(Rome)/Rect[20 190 100 210]/F 4"
                + text + ">>"},
        {13, widget + "/Parent 15 0 R/Rect[20 160 40 180]/F 4/AS/A/AP<</N<</A 20 0 R/Off 21 0 R>>>>>>"},
        {14, widget + "/Parent 15 0 R/Rect[50 160 70 180]/F 4/AS/Off/AP<</N<</B 20 0 R/Off 21 0 R>>>>>>"},
        {15, "<</FT/Btn/Ff 49152/T(size)/V/A/Kids[13 0 R 14 0 R]>>"},
        {16, widget + "/FT/Tx/Ff 1/T(total)/Rect[20 130 180 150]/F 4" + text + ">>"},
        {17, widget + "/FT/Tx/T(secret)/Rect[20 100 180 120]/F 2" + text + ">>"},
        {18, "<</Type/Annot/Subtype/Text/Rect[160 20 180 40]/F 28/T(Ada)/Contents(Seen by Ada)>>"},
        {19,
            "<</Type/Annot/Subtype/Widget/P 5 0 R/FT/Tx/Ff 4096/T(remarks)/Rect[20 200 180 270]/F 4" + text
                + ">>"},
        {20, stream("/Type/XObject/Subtype/Form/BBox[0 0 20 20]", tick)},
        {21, stream("/Type/XObject/Subtype/Form/BBox[0 0 20 20]", " ")},
    };
    std::string pdf = "%PDF-1.4\n", index = "xref\n0 22\n0000000000 65535 f \n";
    for (int number = 1; number < 22; ++number) {
        const auto object = objects.find(number);
        char entry[24];
        std::snprintf(entry, sizeof entry, "%010zu 00000 %c \n", object == objects.end() ? 0 : pdf.size(),
            object == objects.end() ? 'f' : 'n');
        index += entry;
        if (object != objects.end())
            pdf += std::to_string(number) + " 0 obj" + object->second + "endobj\n";
    }
    return pdf + index + "trailer<</Root 1 0 R/Size 22>>\nstartxref\n" + std::to_string(pdf.size())
        + "\n%%EOF\n";
}

} // namespace testing_support
