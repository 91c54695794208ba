// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "fuzz/support/Fuzzing.h"
#include "host/system/desktop/GifFrames.h"
#include "host/system/desktop/JpegEnd.h"
#include "host/system/desktop/JpegRows.h"

void fuzzing::tryInput(std::string_view input)
{
    host::system::JpegEnd atOnce, inPieces;
    atOnce.feed(input);
    for (auto rest = input; !rest.empty(); rest.remove_prefix(std::min<std::size_t>(3, rest.size())))
        inPieces.feed(rest.substr(0, 3));
    require(atOnce.isMissing() == inPieces.isMissing(), "a picture ends alike, however it arrives");
    host::system::gifFrameCount(input);
    host::system::isJpegInRows(writeFile(folder() + "/picture", input));
}
