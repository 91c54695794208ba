// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/values/AttributedText.h"

namespace kit {

AttributedText::AttributedText(std::string text, TextAttributes attributes)
{
    append(std::move(text), attributes);
}

void AttributedText::append(std::string text, TextAttributes attributes)
{
    if (!text.empty())
        _runs.push_back({std::move(text), std::nullopt, attributes});
}

void AttributedText::append(Image attachment, TextAttributes attributes)
{
    _runs.push_back({{}, std::move(attachment), attributes});
}

std::string AttributedText::plainText() const
{
    std::string text;
    for (const auto& run : _runs)
        text += run.text;
    return text;
}

} // namespace kit
