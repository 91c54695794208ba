// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>

namespace host::system {

/// Answers whether a file is a JPEG picture that lies in it row by row, as cameras write it. The decoder
/// makes such a picture smaller while it reads, and never holds all of it. A progressive picture, or one with
/// a scan for each colour, is held whole. The call reads the segments before the picture.
bool isJpegInRows(const std::string& path);

} // namespace host::system
