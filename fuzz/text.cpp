// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "fuzz/support/Fuzzing.h"
#include "host/previews/UchardetDecoder.h"
#include "host/system/texts/DisplayableText.h"
#include "platform/Url.h"
#include "screens/preview/TextDecoding.h"

using platform::TextEnd;

/// The first byte says whether the text is cut, and how long a line may be.
void fuzzing::tryInput(std::string_view input)
{
    Bytes bytes(input);
    const auto choice = bytes.byte();
    static const host::previews::UchardetDecoder decoder;
    const auto end = choice % 2 == 0 ? TextEnd::Whole : TextEnd::Cut;
    const auto text = screens::decodedText(bytes.rest(), end, decoder);
    require(platform::isValidUtf8(text), "a decoded text is UTF-8");
    require(text.find('\0') == std::string::npos, "a decoded text has no NUL");
    require(platform::isValidUtf8(screens::withoutLongLines(text, choice / 2)), "a cut line is UTF-8");
    require(platform::isValidUtf8(host::system::displayableText(input)), "what is shown is UTF-8");
}
