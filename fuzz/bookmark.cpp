// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/identity/Bookmark.h"
#include "fuzz/support/Fuzzing.h"
#include "host/drive/records/LinkRecords.h"
#include "host/system/files/Base64.h"

using host::drive::Bookmark;

/// The input is a bookmark as it arrives, or what it encodes.
void fuzzing::tryInput(std::string_view input)
{
    for (const auto& text : {std::string(input), host::system::base64UrlEncoded(input)}) {
        const auto bookmark = Bookmark::decode(text);
        if (!bookmark)
            continue;
        require(host::drive::isPlainRelativePath(bookmark->path), "a bookmark stays in its container");
        require(Bookmark::decode(bookmark->encoded()) == bookmark, "a bookmark that is made reads the same");
    }
}
